#include <time.h>

#include "platform/os/HX_ClockSource.h"
#include "platform/os/HX_OsClock.h"

namespace {

constexpr std::int64_t kTicksPerMillisecond = kSystemCounterFrequency / 1000;
constexpr std::int64_t kNanosecondsPerSecond = 1'000'000'000;
constexpr std::int64_t kNanosecondsPerTick = 64;
static_assert(kNanosecondsPerTick * kSystemCounterFrequency ==
              kNanosecondsPerSecond);

std::int64_t monotonicTicks() {
  timespec now{};
  clock_gettime(CLOCK_MONOTONIC, &now);
  // Unsigned, so that the division is a shift; the clock is never negative.
  const auto nanoseconds = static_cast<std::uint64_t>(
      std::int64_t{now.tv_sec} * kNanosecondsPerSecond + now.tv_nsec);
  return static_cast<std::int64_t>(nanoseconds / kNanosecondsPerTick);
}

// Whoever asks first sets it: static objects may be constructed before this
// file's, and the clock must not run backwards for them.
std::int64_t processStart() {
  static const std::int64_t s_start = monotonicTicks();
  return s_start;
}

// The library is loaded as part of the process start.
[[maybe_unused]] const std::int64_t s_atLoad = processStart();

}  // namespace

std::int64_t HX_ProcessClock() {
  if (HX_ClockSource* source = HX_ClockSource::installed())
    return source->processClock();
  const std::int64_t start = processStart();
  return (monotonicTicks() - start) / kTicksPerMillisecond;
}

int QueryPerformanceFrequency(std::int64_t* frequency) {
  std::int64_t found = kSystemCounterFrequency;
  if (HX_ClockSource* source = HX_ClockSource::installed())
    found = source->counterFrequency();
  if (found == 0) return 0;
  *frequency = found;
  return 1;
}

int QueryPerformanceCounter(std::int64_t* ticks) {
  HX_ClockSource* source = HX_ClockSource::installed();
  if (source == nullptr) {
    *ticks = monotonicTicks();
    return 1;
  }
  if (source->counterFrequency() == 0) return 0;
  *ticks = source->counter();
  return 1;
}
