#include "Control/HxCControl.h"

#include <cmath>
#include <limits>

#include "Control/ERR_Messages.h"
#include "Control/HX_SelfCheck.h"
#include "Control/HxCUtilsControl.h"
#include "SourceRef/HxCSrcRef.h"
#include "SourceRef/HxCSrcRefCompare.h"
#include "Strings/HX_StringParser.h"
#include "SystemServices/HX_SystemCall.h"
#include "Trace/HxCTraceFallThrough.h"
#include "platform/messages/ERR_MessageHandler.h"
#include "support/HX_TestFixture.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class ControlTest : public HX_TestFixture {
 protected:
  ~ControlTest() override { HxCControl::setProductionCodeBehaviour(); }

  void stop(const char* label) {
    KyCXString text(label);
    m_Control.stopTimeAndEmitMessage(text);
  }

  HX_ManualClock m_Clock;
  HxCUtilsControl m_Control;
};

TEST_F(ControlTest, ProfilingIsOffForZeroAndNaNOnly) {
  for (double value : {0.5, -1.0, std::numeric_limits<double>::infinity()}) {
    HxCControl::setProfiling(value);
    clearMessages();
    stop("x");
    EXPECT_EQ(messages().size(), 1U) << value;
  }
  for (double value : {0.0, -0.0, std::nan("")}) {
    HxCControl::setProfiling(value);
    clearMessages();
    stop("x");
    EXPECT_THAT(messages(), IsEmpty()) << value;
  }
}

TEST_F(ControlTest, TimersNestAndSurviveTheSwitch) {
  HxCControl::setDevelopBehaviour();
  m_Clock.milliseconds = 1000;
  m_Control.startTimer();
  m_Clock.milliseconds = 1500;
  m_Control.startTimer();
  HxCControl::setProductionCodeBehaviour();
  m_Control.startTimer();
  stop("ignored");
  HxCControl::setDevelopBehaviour();
  HxCUtilsControl copy(m_Control);
  m_Clock.milliseconds = 1750;
  stop("inner");
  m_Clock.milliseconds = 4000;
  stop("outer");
  stop("no start");
  KyCXString label("copied");
  copy.stopTimeAndEmitMessage(label);
  EXPECT_THAT(
      messages(),
      ElementsAre("2/0 inner                          in   0.250 seconds.",
                  "2/0 outer                          in   3.000 seconds.",
                  "2/0 no start                       in   4.001 seconds.",
                  "2/0 copied                         in   2.500 seconds."));
}

TEST_F(ControlTest, ErrorLevelFallsWithTheFirstError) {
  const int severities[] = {0, 4, 1, 5, 2};
  for (int severity : severities) {
    EXPECT_TRUE(m_Control.checkErrorLevel());
    ERR_EmitErrorMessage(severity, nullptr, 1292, "x");
  }
  EXPECT_FALSE(m_Control.checkErrorLevel());
}

TEST_F(ControlTest, AssertionReportsCodeAndLineAndGoesOn) {
  EXPECT_TRUE(HX_Assert(true, "a_"));
  EXPECT_FALSE(HX_DebugCheck(false, "quiet"));
  EXPECT_FALSE(HX_Assert(false, "code_", "f.cpp", 12));
  ASSERT_EQ(messages().size(), 1U);
  EXPECT_THAT(messages()[0],
              testing::StartsWith("7/3 Internal error. Error code: code_12."));

  const auto& reports = recordDebugReports();
  HX_DebugCheck(false, "success");
  HX_Assert(false, "code_");
  EXPECT_THAT(reports, ElementsAre("success", "0"));
  EXPECT_EQ(messages().size(), 2U);
}

TEST_F(ControlTest, MessagesCarryTheTextOfTheirSource) {
  const HxCSrcRef source;
  ERR_Msg1206(&source, "Time", "1ms", 0.01, 0.5);
  EXPECT_THAT(
      messages(),
      ElementsAre(
          "1206/1 A time name macro 'Time' with the time base 1ms is used. The "
          "period time 0.010000 or offset 0.500000 cannot be represented "
          "precisely with this time base. [Unknown source]"));
}

TEST_F(ControlTest, NewGoesToTheInstalledController) {
  HX_CountingController controller;
  auto* control = new HxCUtilsControl;
  EXPECT_TRUE(control->boot());
  EXPECT_EQ(controller.liveBlocks(), 1);
  EXPECT_TRUE(control->shutdown());
  delete control;
  delete new HX_StringParser{};
  delete new HX_SystemCall{};
  delete new HxCSrcRefCompare{};
  delete new HxCTraceFallThrough{};
  EXPECT_EQ(controller.allocated(), 5) << "classes without data as well";
  EXPECT_EQ(controller.liveBlocks(), 0);
  controller.fail();
  EXPECT_EQ(new HxCSrcRef, nullptr);
}

}  // namespace
