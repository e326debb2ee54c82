// The fixture of all tests and the fakes at the boundary of the library.

#ifndef SUPPORT_HX_TESTFIXTURE_H
#define SUPPORT_HX_TESTFIXTURE_H

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <climits>
#include <cstdint>
#include <ostream>
#include <string>
#include <vector>

#include "platform/memory/HxCMemController.h"
#include "platform/os/HX_ClockSource.h"
#include "platform/strings/KyCXString.h"

/// Lets GoogleTest print texts.
void PrintTo(const KyCXString& text, std::ostream* stream);

/// Seed of a random test: HX_TEST_SEED of the build, 1 unless changed.
inline unsigned HX_Seed() {
  return static_cast<unsigned>(testing::UnitTest::GetInstance()->random_seed());
}

/// True if \p pattern describes all of \p text. GoogleTest's own matcher knows
/// no [0-9] on Windows.
bool HX_FitsPattern(const std::string& text, const std::string& pattern);
MATCHER_P(HX_Fits, pattern, "fits " + std::string(pattern)) {
  return HX_FitsPattern(arg, pattern);
}

/// Starts each test with an empty message handler that shows nothing, internal
/// information off, no memory controller and the system's clocks.
class HX_TestFixture : public testing::Test {
 protected:
  HX_TestFixture();
  ~HX_TestFixture() override;

  /// Messages since the start of the test or the last clearMessages(), as
  /// "row/severity text" or, with a source, "row/severity text [source]".
  static std::vector<std::string> messages();
  static void clearMessages();

  /// Shows internal information from now on and records the expressions of
  /// debug reports instead of printing reports; every answer is 0.
  std::vector<std::string>& recordDebugReports();

 private:
  static void reset();

  std::vector<std::string> m_DebugReports;
};

/// Controller that counts the blocks of the library; installed while alive.
class HX_CountingController : public HxCMemController {
 public:
  HX_CountingController() { pHXMemory = this; }
  ~HX_CountingController() override { pHXMemory = nullptr; }

  void* allocMemBlock(unsigned long size) override;
  void freeMemBlock(void* block) override;

  int liveBlocks() const { return m_Live; }
  /// Allocations asked for, failed ones included.
  int allocated() const { return m_Asked; }
  /// From now on every allocation fails.
  void fail() { failAt(m_Asked, true); }
  /// The allocation with the given number fails (the first is 0), with
  /// \p allAfter all later allocations as well.
  void failAt(int number, bool allAfter) {
    m_FirstFailure = number;
    m_LastFailure = allAfter ? INT_MAX : number;
  }

 private:
  int m_Asked = 0;
  int m_Live = 0;
  int m_FirstFailure = INT_MAX;
  int m_LastFailure = INT_MAX;
};

/// Runs \p job again and again without block 0, 1, 2, ... of the controller,
/// until no block was missing; then the same without block n and all later
/// blocks. Expects of \p job: gives back all blocks in every run, returns false
/// without block 0, returns true in the run that misses none.
void HX_WithoutEachBlock(const char* why, bool (*job)());

/// The same with blocks of the global operator new, without a controller.
/// \p job must not use assertions of GoogleTest, because assertions allocate.
void HX_WithoutEachHeapBlock(const char* why, bool (*job)());

/// Clock that stands still until a test sets the time; installed while alive.
class HX_ManualClock : public HX_ClockSource {
 public:
  HX_ManualClock() { install(this); }
  ~HX_ManualClock() override { install(nullptr); }

  std::int64_t processClock() override { return milliseconds; }
  std::int64_t counterFrequency() override { return frequency; }
  std::int64_t counter() override { return ticks; }

  std::int64_t milliseconds = 0;
  std::int64_t frequency = 1'000'000;
  std::int64_t ticks = 0;
};

#endif  // SUPPORT_HX_TESTFIXTURE_H
