// Compares a clock of the library with the clock of the standard library.

#ifndef SUPPORT_HX_REALTIME_H
#define SUPPORT_HX_REALTIME_H

#include <gtest/gtest.h>

#include <chrono>
#include <functional>
#include <thread>

/// Reads \p clock, sleeps for 20 ms and reads \p clock again. Expects that the
/// difference in seconds agrees with the standard clock within 1 ms.
inline void HX_ExpectRealTime(const std::function<double()>& clock) {
  using std::chrono::steady_clock;
  const auto before = steady_clock::now();
  const double start = clock();
  const auto inside = steady_clock::now();
  std::this_thread::sleep_for(std::chrono::milliseconds(20));
  const std::chrono::duration<double> shortest = steady_clock::now() - inside;
  const double measured = clock() - start;
  const std::chrono::duration<double> longest = steady_clock::now() - before;
  EXPECT_GE(measured, shortest.count() - 0.001);
  EXPECT_LE(measured, longest.count() + 0.001);
}

#endif  // SUPPORT_HX_REALTIME_H
