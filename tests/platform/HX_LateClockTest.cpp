// The process clock of a library loaded late counts from the start of
// the process all the same.
#include <dlfcn.h>
#include <gtest/gtest.h>

#include <chrono>
#include <thread>

#include "platform/os/HX_OsClock.h"

namespace {

TEST(LateClockTest, CountsFromTheStartOfTheProcess) {
  constexpr std::int64_t kWait = 300;
  std::this_thread::sleep_for(std::chrono::milliseconds(kWait));
  void* module = dlopen(HX_LATE_MODULE, RTLD_NOW | RTLD_LOCAL);
  ASSERT_NE(module, nullptr) << dlerror();
  const auto clock = reinterpret_cast<std::int64_t (*)()>(
      dlsym(module, "HX_LateProcessClock"));
  ASSERT_NE(clock, nullptr);
  const std::int64_t early = HX_ProcessClock();
  const std::int64_t late = clock();
  EXPECT_GE(late, kWait);
  // Both clocks read the start in steps of up to 10 ms.
  EXPECT_NEAR(static_cast<double>(late), static_cast<double>(early), 1000.0);
  EXPECT_GE(HX_ProcessClock() + 10, late);
}

}  // namespace
