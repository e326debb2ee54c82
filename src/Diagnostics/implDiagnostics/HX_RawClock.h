// Raw times of the stop watches and the debug server.
//
// A raw time counts ticks of the high-resolution counter; on a machine without
// counter, milliseconds of the process clock. Arithmetic wraps around at 64
// bits: an interval in [0, 2^63 / 1000000) ticks is exact.

#ifndef DIAGNOSTICS_IMPLDIAGNOSTICS_HX_RAWCLOCK_H
#define DIAGNOSTICS_IMPLDIAGNOSTICS_HX_RAWCLOCK_H

#include <cstdint>

#include "platform/os/HX_OsClock.h"

namespace hx_detail {

/// a + b, a - b and a * b modulo 2^64, as signed values.
inline std::int64_t wrapAdd(std::int64_t a, std::int64_t b) {
  return static_cast<std::int64_t>(static_cast<std::uint64_t>(a) +
                                   static_cast<std::uint64_t>(b));
}
inline std::int64_t wrapSubtract(std::int64_t a, std::int64_t b) {
  return static_cast<std::int64_t>(static_cast<std::uint64_t>(a) -
                                   static_cast<std::uint64_t>(b));
}
inline std::int64_t wrapMultiply(std::int64_t a, std::int64_t b) {
  return static_cast<std::int64_t>(static_cast<std::uint64_t>(a) *
                                   static_cast<std::uint64_t>(b));
}

/// Asks for the ticks per second.
/// \param[out] frequency  written when the result is true
/// RETURNS: true for a counter with a positive frequency
inline bool queryFrequency(std::int64_t& frequency) {
  std::int64_t found = 0;
  if (QueryPerformanceFrequency(&found) != 1 || found <= 0) return false;
  frequency = found;
  return true;
}

/// The current raw time; 0 if the counter has vanished.
inline std::int64_t rawTime(bool hasCounter) {
  if (!hasCounter) return HX_ProcessClock();
  std::int64_t ticks = 0;
  QueryPerformanceCounter(&ticks);
  return ticks;
}

/// A raw interval in microseconds, cut towards zero.
/// REQUIRES: \p frequency, in ticks per second, is positive if \p hasCounter.
inline std::int64_t rawToMicroseconds(std::int64_t raw, bool hasCounter,
                                      std::int64_t frequency) {
  if (!hasCounter) return wrapMultiply(raw, 1000);
  const std::int64_t scaled = wrapMultiply(raw, 1'000'000);
  // A constant divisor saves the division instruction in the common case.
  if (frequency == kSystemCounterFrequency)
    return scaled / kSystemCounterFrequency;
  return scaled / frequency;
}

/// A raw time, not an interval, in microseconds: times since the start of the
/// machine are too long for the multiplication above.
inline std::int64_t rawTimeToMicroseconds(std::int64_t raw, bool hasCounter,
                                          std::int64_t frequency) {
  if (!hasCounter) return wrapMultiply(raw, 1000);
  return wrapAdd(wrapMultiply(raw / frequency, 1'000'000),
                 rawToMicroseconds(raw % frequency, hasCounter, frequency));
}

}  // namespace hx_detail

#endif  // DIAGNOSTICS_IMPLDIAGNOSTICS_HX_RAWCLOCK_H
