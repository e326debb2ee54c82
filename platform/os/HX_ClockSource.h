// The source of time of the clocks in HX_OsClock.h.
//
// A test derives a source and sets the time by hand:
//
//   MyClock clock;
//   HX_ClockSource::install(&clock);
//   ...
//   HX_ClockSource::install(nullptr);   // the system's clocks again

#ifndef PLATFORM_OS_HX_CLOCKSOURCE_H
#define PLATFORM_OS_HX_CLOCKSOURCE_H

#include <cstdint>

#include "platform/HX_PlatformExport.h"

/// Asked by the clocks of the process. A host may install a source.
class HX_PLATFORM_API HX_ClockSource {
 public:
  virtual ~HX_ClockSource();

  /// Milliseconds since the process started.
  virtual std::int64_t processClock() = 0;
  /// Ticks per second of the counter; 0 without a counter.
  virtual std::int64_t counterFrequency() = 0;
  virtual std::int64_t counter() = 0;

  /// Makes \p source the source of every clock; null stands for the system's
  /// own clocks. OWNERSHIP: the host's.
  static void install(HX_ClockSource* source) { s_pSource = source; }
  static HX_ClockSource* installed() { return s_pSource; }

 private:
  static HX_ClockSource* s_pSource;
};

#endif  // PLATFORM_OS_HX_CLOCKSOURCE_H
