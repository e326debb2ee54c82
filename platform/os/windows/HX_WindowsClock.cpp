// The calls of the system take other arguments than ours: both stand here side
// by side as overloads.

#include <windows.h>

#include <algorithm>

#include "platform/os/HX_ClockSource.h"
#include "platform/os/HX_OsClock.h"

namespace {

constexpr std::int64_t kFileTimePerMillisecond = 10'000;  // units of 100 ns

std::int64_t systemFrequency() {
  LARGE_INTEGER frequency{};
  return QueryPerformanceFrequency(&frequency) != 0 ? frequency.QuadPart : 0;
}

std::int64_t systemTicks() {
  LARGE_INTEGER ticks{};
  QueryPerformanceCounter(&ticks);
  return ticks.QuadPart;
}

std::int64_t asNumber(const FILETIME& time) {
  return static_cast<std::int64_t>(std::uint64_t{time.dwHighDateTime} << 32 |
                                   time.dwLowDateTime);
}

// Milliseconds since the start of the process; 0 if the system does not tell.
std::int64_t age() {
  FILETIME start{}, end{}, kernel{}, user{}, now{};
  if (GetProcessTimes(GetCurrentProcess(), &start, &end, &kernel, &user) == 0)
    return 0;
  GetSystemTimeAsFileTime(&now);
  const std::int64_t age =
      (asNumber(now) - asNumber(start)) / kFileTimePerMillisecond;
  return std::max<std::int64_t>(age, 0);
}

std::int64_t systemMilliseconds() {
  const std::int64_t frequency = std::max<std::int64_t>(systemFrequency(), 1);
  const std::int64_t ticks = systemTicks();
  return ticks / frequency * 1000 + ticks % frequency * 1000 / frequency;
}

// The first call fixes the origin, because a static object of a different file
// may ask before the static objects of this file exist.
std::int64_t processStart() {
  static const std::int64_t s_start = systemMilliseconds() - age();
  return s_start;
}

// Where the system does not tell the start, the load of the library counts.
[[maybe_unused]] const std::int64_t s_atLoad = processStart();

}  // namespace

std::int64_t HX_ProcessClock() {
  if (HX_ClockSource* source = HX_ClockSource::installed())
    return source->processClock();
  const std::int64_t start = processStart();
  return systemMilliseconds() - start;
}

int QueryPerformanceFrequency(std::int64_t* frequency) {
  HX_ClockSource* source = HX_ClockSource::installed();
  const std::int64_t found =
      source != nullptr ? source->counterFrequency() : systemFrequency();
  if (found == 0) return 0;
  *frequency = found;
  return 1;
}

int QueryPerformanceCounter(std::int64_t* ticks) {
  HX_ClockSource* source = HX_ClockSource::installed();
  if (source == nullptr) {
    *ticks = systemTicks();
    return 1;
  }
  if (source->counterFrequency() == 0) return 0;
  *ticks = source->counter();
  return 1;
}
