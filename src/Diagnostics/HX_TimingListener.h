// Lets the host follow the runs that stop watches and the debug server time.
//
// The servers' own files hold sums; a host that draws a time line listens to
// each run as it ends:
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

/// Listening changes no time that is accounted: the clock is not read again.
class HX_UTILS_API HX_TimingListener {
 public:
  virtual ~HX_TimingListener();

  /// A run of a stop watch or a run time of the debug server has ended; called
  /// once per run, in the order of the ends, so that a nested run comes before
  /// the one around it.
  ///
  /// Must not start, stop, create or destroy what is timed.
  /// \param name  valid during the call
  /// \param start  microseconds since an arbitrary origin, the same for all
  ///     runs timed by one clock: a debug server that is not booted takes the
  ///     process clock, also where stop watches take the counter; the start of
  ///     a run time during which it is booted tells nothing
  /// \param duration  microseconds, as it is accounted
  virtual void runEnded(const char* name, std::int64_t start,
                        std::int64_t duration) = 0;

  /// Makes \p listener, which is not owned, the only one; null for none, as at
  /// load.
  static void install(HX_TimingListener* listener) { s_pListener = listener; }
  static HX_TimingListener* installed() { return s_pListener; }

 private:
  static HX_TimingListener* s_pListener;
};

#endif  // DIAGNOSTICS_HX_TIMINGLISTENER_H
