// Tells a host of each run of a stop watch or of the debug server.
//
// The report files hold sums only. A host draws a time line from single runs:
//
//   class Timeline : public HX_TimingListener {
//     void runEnded(const char* name, std::int64_t start,
//                   std::int64_t duration) override { ... }
//   };
//   Timeline timeline;
//   HX_TimingListener::install(&timeline);
//   ...
//   HX_TimingListener::install(nullptr);

#ifndef DIAGNOSTICS_HX_TIMINGLISTENER_H
#define DIAGNOSTICS_HX_TIMINGLISTENER_H

#include <cstdint>

#include "HX_Export.h"

/// Listening changes no accounted time, because the clock is not read again.
class HX_UTILS_API HX_TimingListener {
 public:
  virtual ~HX_TimingListener();

  /// Called once at the end of each run of a stop watch and of each run time of
  /// the debug server; an inner run comes before the surrounding run.
  ///
  /// REQUIRES: the listener does not start, stop, create or destroy watches or
  /// run times.
  /// \param name  valid during the call
  /// \param start  microseconds since an arbitrary origin, equal for all runs
  ///     of one clock. Before boot() a debug server uses the process clock,
  ///     even while stop watches use the counter; the start of a run time
  ///     across boot() has no meaning.
  /// \param duration  the accounted microseconds
  virtual void runEnded(const char* name, std::int64_t start,
                        std::int64_t duration) = 0;

  /// Makes \p listener the only listener; null, as at load, for no listener.
  /// OWNERSHIP: the host keeps the listener.
  static void install(HX_TimingListener* listener) { s_pListener = listener; }
  static HX_TimingListener* installed() { return s_pListener; }

 private:
  static HX_TimingListener* s_pListener;
};

#endif  // DIAGNOSTICS_HX_TIMINGLISTENER_H
