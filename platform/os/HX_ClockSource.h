// Where the clocks of HX_OsClock.h take their time from.
//
// A test derives a source whose time it sets by hand:
//
//   MyClock clock;
//   HX_ClockSource::install(&clock);
//   ...
//   HX_ClockSource::install(nullptr);   // the system's clocks again

#ifndef PLATFORM_OS_HX_CLOCKSOURCE_H
#define PLATFORM_OS_HX_CLOCKSOURCE_H

#include <cstdint>

#include "platform/HX_PlatformExport.h"

/// What the clocks of the process ask. A host may put its own source in place.
class HX_PLATFORM_API HX_ClockSource {
 public:
  virtual ~HX_ClockSource();

  /// Milliseconds since the process started.
  virtual std::int64_t processClock() = 0;
  /// Ticks per second of the counter; 0 if there is no counter.
  virtual std::int64_t counterFrequency() = 0;
  virtual std::int64_t counter() = 0;

  /// Makes \p source the source of every clock; null stands for the system's
  /// own clocks. The source is not owned.
  static void install(HX_ClockSource* source) { s_pSource = source; }
  static HX_ClockSource* installed() { return s_pSource; }

 private:
  static HX_ClockSource* s_pSource;
};

#endif  // PLATFORM_OS_HX_CLOCKSOURCE_H
