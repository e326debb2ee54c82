#include <stdlib.h>
#include <sys/resource.h>
#include <unistd.h>

#include <algorithm>
#include <memory>
#include <thread>

#include "SystemServices/HX_SystemCall.h"
#include "SystemServices/HX_SystemFileIo.h"
#include "SystemServices/HX_SystemServiceEnv.h"
#include "support/HX_TestFixture.h"

namespace {

using testing::ElementsAre;
using testing::MatchesRegex;

class SystemServicesTest : public HX_TestFixture {
 protected:
  HX_SystemCall m_System;
};

TEST_F(SystemServicesTest, TimeIsReadInMillisecondsAndStandardForm) {
  HX_ManualClock clock;
  clock.milliseconds = 1500;
  const double start = m_System.getTimeStamp();
  clock.milliseconds = 4000;
  EXPECT_EQ(m_System.getDeltaTimeInSec(start, m_System.getTimeStamp()), 2.5);
  const std::unique_ptr<KyCXString> date(m_System.getStandardDateString());
  const std::unique_ptr<KyCXString> time(m_System.getStandardTimeString());
  EXPECT_THAT((*date + " " + *time).cstring(),
              MatchesRegex("[0-9]{4}-[0-1][0-9]-[0-3][0-9] "
                           "[0-2][0-9]:[0-5][0-9]:[0-6][0-9]"));
}

TEST_F(SystemServicesTest, PriorityIsThatOfTheCallingThreadAlone) {
  const int before = getpriority(PRIO_PROCESS, 0);
  std::thread([this, before] {
    EXPECT_FALSE(m_System.setCurrentThreadPriority(7));  // no such level
    EXPECT_EQ(getpriority(PRIO_PROCESS, 0), before);
    int previous = 99;
    EXPECT_TRUE(m_System.setLowestThreadPriorityToCurrentThread(previous));
    if (before == 0) {
      EXPECT_EQ(previous, 0);
    }
    EXPECT_EQ(getpriority(PRIO_PROCESS, 0), std::max(before, 10));
    EXPECT_TRUE(m_System.setLowestThreadPriorityToCurrentThread(previous));
    EXPECT_EQ(previous, before > 10 ? -15 : -2);
    EXPECT_TRUE(m_System.setCurrentThreadPriority(-15));  // idle
    EXPECT_EQ(getpriority(PRIO_PROCESS, 0), 19);
  }).join();
  EXPECT_EQ(getpriority(PRIO_PROCESS, 0), before);
}

TEST_F(SystemServicesTest, HolderCreatesOnDemandAndClosesItsFiles) {
  HX_CountingController controller;
  HX_SystemServiceEnv env;
  EXPECT_EQ(controller.allocated(), 0);
  HX_SystemCall* call = env.getSystemCall();
  EXPECT_EQ(env.getSystemCall(), call);
  HX_SystemFileIo* io = env.getSystemFileIo();
  EXPECT_EQ(env.getSystemFileIo(), io);
  {
    HX_SystemServiceEnv copy(env);
    EXPECT_EQ(copy.getSystemFileIo(), io);
    copy.disown();
  }
  EXPECT_EQ(controller.liveBlocks(), 2);

  std::FILE* files[3] = {};
  for (std::FILE*& file : files) ASSERT_TRUE(io->open("/dev/null", "w", file));
  EXPECT_TRUE(io->close(files[1]));
  EXPECT_FALSE(io->close(nullptr));
  EXPECT_FALSE(io->close(stdin));
  std::FILE* untouched = stdin;
  EXPECT_FALSE(io->open("/none/x", "r", untouched));
  EXPECT_EQ(untouched, stdin);
  EXPECT_THAT(messages(), ElementsAre("90/3 Cannot create file: /none/x."));

  const int open = fileno(files[2]);
  env.releaseSystemFileIo();
  env.releaseSystemCall();
  env.releaseSystemCall();
  EXPECT_EQ(controller.liveBlocks(), 0);
  EXPECT_EQ(lseek(open, 0, SEEK_CUR), -1) << "the file is still open";
}

}  // namespace
