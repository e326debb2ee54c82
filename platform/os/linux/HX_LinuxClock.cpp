#include <time.h>

#include "platform/os/HX_ClockSource.h"
#include "platform/os/HX_OsClock.h"

namespace {

constexpr std::int64_t kNanosecondsPerSecond = 1'000'000'000;
constexpr std::int64_t kNanosecondsPerMillisecond = 1'000'000;

std::int64_t monotonicNanoseconds() {
  timespec now{};
  clock_gettime(CLOCK_MONOTONIC, &now);
  return std::int64_t{now.tv_sec} * kNanosecondsPerSecond + now.tv_nsec;
}

// The library is loaded as part of the process start.
const std::int64_t s_processStart = monotonicNanoseconds();

}  // namespace

std::int64_t HX_ProcessClock() {
  if (HX_ClockSource* source = HX_ClockSource::installed())
    return source->processClock();
  return (monotonicNanoseconds() - s_processStart) / kNanosecondsPerMillisecond;
}

int QueryPerformanceFrequency(std::int64_t* frequency) {
  std::int64_t found = kNanosecondsPerSecond;
  if (HX_ClockSource* source = HX_ClockSource::installed())
    found = source->counterFrequency();
  if (found == 0) return 0;
  *frequency = found;
  return 1;
}

int QueryPerformanceCounter(std::int64_t* ticks) {
  HX_ClockSource* source = HX_ClockSource::installed();
  if (source == nullptr) {
    *ticks = monotonicNanoseconds();
    return 1;
  }
  if (source->counterFrequency() == 0) return 0;
  *ticks = source->counter();
  return 1;
}
