// Clocks of the operating system.

#ifndef PLATFORM_OS_HX_OSCLOCK_H
#define PLATFORM_OS_HX_OSCLOCK_H

#include <cstdint>

#include "platform/HX_PlatformExport.h"

/// Milliseconds of elapsed time since the start of the process, however late
/// the library was loaded. Where the system does not tell the start of the
/// process, the load of the library counts as the start.
HX_PLATFORM_API std::int64_t HX_ProcessClock();

#if defined(_WIN32)
/// Ticks per second of the high-resolution counter of most systems. Code that
/// divides by a constant frequency compares with this constant first.
inline constexpr std::int64_t kSystemCounterFrequency = 10'000'000;
#else
/// Ticks per second of the high-resolution counter of the system. A tick is 64
/// ns: nanoseconds become ticks by a shift, and an interval of six days times
/// 1000000 still fits into 64 bits.
inline constexpr std::int64_t kSystemCounterFrequency = 1'000'000'000 / 64;
#endif

/// Ticks per second of the high-resolution counter.
/// RETURNS: 1; without a counter 0, with \p frequency untouched.
HX_PLATFORM_API int QueryPerformanceFrequency(std::int64_t* frequency);

/// The ticks of the high-resolution counter. The counter never runs backwards.
/// RETURNS: 1; without a counter 0, with \p ticks untouched.
HX_PLATFORM_API int QueryPerformanceCounter(std::int64_t* ticks);

#endif  // PLATFORM_OS_HX_OSCLOCK_H
