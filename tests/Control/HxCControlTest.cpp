#include "Control/HxCControl.h"

#include <cmath>
#include <utility>

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
using testing::StartsWith;

class ControlTest : public HX_TestFixture {
 protected:
  ~ControlTest() override { HxCControl::setProductionCodeBehaviour(); }

  static void stop(HxCControl& control, KyCXString label) {
    control.stopTimeAndEmitMessage(label);
  }

  HX_ManualClock m_Clock;
  HxCUtilsControl m_Control;
};

TEST_F(ControlTest, ProfilingIsOffForZeroAndNaNOnly) {
  const std::pair<double, bool> rows[] = {
      {0.5, true},  {-1.0, true},  {HUGE_VAL, true},
      {0.0, false}, {-0.0, false}, {std::nan(""), false}};
  for (const auto& [value, isOn] : rows) {
    clearMessages();
    HxCControl::setProfiling(value);
    stop(m_Control, "x");
    EXPECT_EQ(messages().size(), isOn ? 1U : 0U) << value;
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
  stop(m_Control, "ignored");
  HxCControl::setDevelopBehaviour();
  HxCUtilsControl copy(m_Control);
  m_Clock.milliseconds = 1750;
  stop(m_Control, "inner");
  m_Clock.milliseconds = 4000;
  stop(m_Control, "outer");
  stop(m_Control, "no start");
  stop(copy, "copied");
  EXPECT_THAT(
      messages(),
      ElementsAre("2/0 inner                          in   0.250 seconds.",
                  "2/0 outer                          in   3.000 seconds.",
                  "2/0 no start                       in   4.001 seconds.",
                  "2/0 copied                         in   2.500 seconds."));
}

TEST_F(ControlTest, ErrorLevelFallsWithTheFirstError) {
  for (int severity : {0, 4, 1, 5, 2}) {
    EXPECT_TRUE(m_Control.checkErrorLevel());
    ERR_EmitErrorMessage(severity, nullptr, 1292, "x");
  }
  EXPECT_FALSE(m_Control.checkErrorLevel());
}

TEST_F(ControlTest, AssertionReportsCodeAndLineAndGoesOn) {
  EXPECT_TRUE(HX_Assert(true, "a_"));
  EXPECT_FALSE(HX_DebugCheck(false, "quiet"));
  EXPECT_FALSE(HX_Assert(false, "code_", "f.cpp", 12));
  const auto& reports = recordDebugReports();
  HX_DebugCheck(false, "success");
  HX_Assert(false, "code_", "f.cpp", 13);
  EXPECT_THAT(reports, ElementsAre("success", "0"));
  const std::string start = "7/3 Internal error. Error code: code_";
  EXPECT_THAT(messages(), ElementsAre(StartsWith(start + "12."),
                                      StartsWith(start + "13.")));
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
