#if !defined(_WIN32)
#include <sys/resource.h>
#include <sys/syscall.h>
#include <unistd.h>
#endif

#include <ctime>
#include <fstream>
#include <memory>
#include <thread>

#include "SystemServices/HX_SystemCall.h"
#include "SystemServices/HX_SystemFileIo.h"
#include "SystemServices/HX_SystemServiceEnv.h"
#include "support/HX_Environment.h"
#include "support/HX_ForeignLocale.h"
#include "support/HX_HeapCount.h"
#include "support/HX_RealTime.h"
#include "support/HX_TestFixture.h"

namespace {

using testing::ElementsAre;
using Text = std::unique_ptr<KyCXString>;

class SystemServicesTest : public HX_TestFixture {
 protected:
  HX_SystemCall m_System;
};

// In zones from 12 hours west to 14 hours east: every hour of the day, minutes
// unlike seconds, yesterday or tomorrow.
TEST_F(SystemServicesTest, DateAndTimeAreThoseOfTheLocalZone) {
  const HX_ForeignLocale foreign;
  for (int minutes = -12 * 60; minutes <= 14 * 60; minutes += 47) {
    char zone[32];
    std::snprintf(zone, sizeof zone, "HXT%c%d:%02d", minutes < 0 ? '+' : '-',
                  std::abs(minutes) / 60, std::abs(minutes) % 60);
    HX_SetVariable("TZ", zone);
    const std::time_t now = std::time(nullptr);
    const Text date(m_System.getStandardDateString());
    const Text time(m_System.getStandardTimeString());
    char expected[2][32];
    for (const std::time_t late : {0, 1}) {
      const std::time_t local = now + late + 60 * minutes;
      std::strftime(expected[late], 32, "%Y-%m-%d %H:%M:%S",
                    std::gmtime(&local));
    }
    EXPECT_THAT((*date + " " + *time).cstring(),
                testing::AnyOfArray(std::vector<std::string>(
                    std::begin(expected), std::end(expected))));
  }
  HX_SetVariable("TZ", nullptr);
}

TEST_F(SystemServicesTest, TimeStampsAreMilliseconds) {
  const double start = m_System.getTimeStamp();
  HX_ExpectRealTime([&] {
    return m_System.getDeltaTimeInSec(start, m_System.getTimeStamp());
  });
}

#if !defined(_WIN32)  // the levels of Windows: tests/platform
TEST_F(SystemServicesTest, PriorityIsThatOfTheCallingThreadAlone) {
  const auto nice = [] { return getpriority(PRIO_PROCESS, 0); };
  if (nice() != 0) GTEST_SKIP() << "the process has a priority of its own";
  std::thread([&] {
    EXPECT_FALSE(m_System.setCurrentThreadPriority(7)) << "no such level";
    int previous = 99;
    EXPECT_TRUE(m_System.setLowestThreadPriorityToCurrentThread(previous));
    EXPECT_THAT((std::array{previous, nice()}), ElementsAre(0, 10));
    // From here on this thread is the thread of an ordinary user.
    if (geteuid() == 0) syscall(SYS_setresuid, 65534, 65534, 65534);
    EXPECT_FALSE(m_System.setCurrentThreadPriority(0)) << "restored";
    EXPECT_TRUE(m_System.setCurrentThreadPriority(-15)) << "idle";
    EXPECT_TRUE(m_System.setLowestThreadPriorityToCurrentThread(previous));
    EXPECT_THAT((std::array{previous, nice()}), ElementsAre(-15, 19));
  }).join();
  EXPECT_EQ(nice(), 0);
}
#endif

TEST_F(SystemServicesTest, HolderCreatesOnDemandAndClosesItsFiles) {
  const auto content = [](const char* name) {
    std::string text;
    std::getline(std::ifstream(name), text);
    std::remove(name);
    return text;
  };
  HX_CountingController controller;
  HX_SystemServiceEnv env;
  HX_SystemCall* call = env.getSystemCall();
  EXPECT_EQ(env.getSystemCall(), call);
  EXPECT_EQ(controller.liveBlocks(), 1);
  HX_SystemFileIo* io = env.getSystemFileIo();
  HX_SystemServiceEnv copy(env);
  EXPECT_EQ(copy.getSystemFileIo(), io);
  copy.disown();

  // A text reaches the file when the file is closed.
  std::FILE *closed = nullptr, *left = nullptr, *untouched = nullptr;
  EXPECT_TRUE(io->open("closed.txt", "w", closed));
  EXPECT_TRUE(io->open("left.txt", "w", left));
  std::fputs("x", closed);
  std::fputs("y", left);
  EXPECT_TRUE(io->close(closed));
  EXPECT_EQ(content("closed.txt"), "x");
  for (std::FILE* file : {closed, untouched, stdin})
    EXPECT_FALSE(io->close(file));
  EXPECT_FALSE(io->open("/none/x", "r", untouched));
  EXPECT_EQ(untouched, nullptr);
  EXPECT_THAT(messages(), ElementsAre("90/3 Cannot create file: /none/x."));
  env.releaseSystemFileIo();
  EXPECT_EQ(content("left.txt"), "y");
  env.releaseSystemCall();
  env.releaseSystemCall();
  EXPECT_EQ(controller.liveBlocks(), 0);
}

TEST_F(SystemServicesTest, MissingMemoryGivesNothing) {
  HX_NEEDS_HEAP_OF_LIBRARY();
#if defined(_WIN32)
  static constexpr char kNull[] = "NUL";
#else
  static constexpr char kNull[] = "/dev/null";
  const int descriptor = dup(0);
#endif
  HX_WithoutEachHeapBlock("date, text and file", [] {
    HX_SystemCall system;
    HX_SystemFileIo io;
    std::FILE* file = nullptr;
    const Text date(system.getStandardDateString());
    const Text time(system.getStandardTimeString());
    const bool isOpen = io.open(kNull, "w", file);
    return date != nullptr && time != nullptr && isOpen;
  });
#if !defined(_WIN32)
  EXPECT_EQ(dup(0), descriptor + 1) << "a file stays open";
#endif
  HX_SetVariable("X", "y");
  const std::string before = "%X%" + std::string(50, 'x');
  KyCXString text(before.c_str());
  {
    const HX_FailingHeap heap(0, true);
    if (m_System.substituteEnvVariable(text)) text = "";
  }
  EXPECT_EQ(text, before.c_str());
}

}  // namespace
