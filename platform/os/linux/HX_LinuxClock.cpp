// The process clock counts from the start of the process. The system tells the
// start in clock ticks since the start of the machine (proc(5), field 22 of
// /proc/self/stat), usually in steps of 10 ms.

#include <fcntl.h>
#include <time.h>
#include <unistd.h>

#include <algorithm>
#include <cstdlib>
#include <cstring>

#include "platform/os/HX_ClockSource.h"
#include "platform/os/HX_OsClock.h"

namespace {

constexpr std::int64_t kTicksPerMillisecond = kSystemCounterFrequency / 1000;
constexpr std::int64_t kNanosecondsPerSecond = 1'000'000'000;
constexpr std::int64_t kNanosecondsPerTick = 64;
static_assert(kNanosecondsPerTick * kSystemCounterFrequency ==
              kNanosecondsPerSecond);

std::int64_t ticksOf(clockid_t clock) {
  timespec now{};
  clock_gettime(clock, &now);
  // Unsigned, because the division then is a shift; no clock is negative.
  const auto nanoseconds = static_cast<std::uint64_t>(
      std::int64_t{now.tv_sec} * kNanosecondsPerSecond + now.tv_nsec);
  return static_cast<std::int64_t>(nanoseconds / kNanosecondsPerTick);
}

std::int64_t monotonicTicks() { return ticksOf(CLOCK_MONOTONIC); }

// Field 22 of /proc/self/stat; 0 if the system does not tell.
std::int64_t startInClockTicks() {
  constexpr int kStartField = 22;
  char text[1024] = "";
  const int file = open("/proc/self/stat", O_RDONLY | O_CLOEXEC);
  if (file < 0) return 0;
  const ssize_t length = read(file, text, sizeof text - 1);
  close(file);
  if (length <= 0) return 0;
  // Field 2 is the program's name in parentheses and may contain anything.
  const char* field = std::strrchr(text, ')');
  for (int i = 2; field != nullptr && i < kStartField; ++i)
    field = std::strchr(field + 1, ' ');
  return field == nullptr ? 0 : std::strtoll(field, nullptr, 10);
}

// Ticks since the start of the process; 0 if the system does not tell.
std::int64_t age() {
  const std::int64_t start = startInClockTicks();
  const std::int64_t perSecond = sysconf(_SC_CLK_TCK);
  if (start <= 0 || perSecond <= 0) return 0;
  const std::int64_t startTicks =
      start / perSecond * kSystemCounterFrequency +
      start % perSecond * kSystemCounterFrequency / perSecond;
  return std::max<std::int64_t>(ticksOf(CLOCK_BOOTTIME) - startTicks, 0);
}

// The first call fixes the origin, because a static object of a different file
// may ask before the static objects of this file exist.
std::int64_t processStart() {
  static const std::int64_t s_start = monotonicTicks() - age();
  return s_start;
}

// Where the system does not tell the start, the load of the library counts.
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
