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

/// Starts each test with an empty message handler that shows nothing, internal
/// information off, no memory controller and the system's clocks.
class HX_TestFixture : public testing::Test {
 protected:
  HX_TestFixture();
  ~HX_TestFixture() override;

  /// What was reported since the start of the test or the last clearMessages(),
  /// each as "row/severity text" or, with a source, "row/severity text
  /// [source]".
  static std::vector<std::string> messages();
  static void clearMessages();

  /// Shows internal information from now on and records debug reports (their
  /// expressions) instead of printing them; each is answered with 0.
  std::vector<std::string>& recordDebugReports();

 private:
  static void reset();

  std::vector<std::string> m_DebugReports;
};

/// Installed while it lives; counts what the library holds.
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
  /// The allocation with this number (the first is 0) fails, with \p allAfter
  /// all later ones as well.
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

/// Runs \p job again and again: without the first block that it asks for, then
/// without the second, until none was missing; then the same without that block
/// and all later ones. It must return all blocks each time, say false without
/// its first block, and true at last.
void HX_WithoutEachBlock(const char* why, bool (*job)());

/// Installed while it lives; its time stands still until it is set.
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
