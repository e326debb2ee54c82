#include "Control/HxCControl.h"

#include <cmath>
#include <csignal>
#include <limits>
#include <new>
#include <optional>
#include <string>
#include <tuple>
#include <type_traits>
#include <utility>
#include <vector>

#include "Control/ERR_Messages.h"
#include "Control/HX_Memory.h"
#include "Control/HX_SelfCheck.h"
#include "Control/HxCUtilsControl.h"
#include "SourceRef/HxCSrcRef.h"
#include "SourceRef/HxCSrcRefCompare.h"
#include "Strings/HX_StringParser.h"
#include "SystemServices/HX_SystemCall.h"
#include "Trace/HxCTraceFallThrough.h"
#include "platform/messages/HX_MessageHandler.h"
#include "support/HX_HeapCount.h"
#include "support/HX_TestFixture.h"

namespace {

using testing::ElementsAre;
using testing::EndsWith;
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

// Calls an emitter with the texts a, b, ..., the integer 3 and numbers from
// 0.5.
template <class... Args>
void callWithSamples(void (*emitter)(Args...), const HxCSrcRef* srcRef) {
  static const char* const kTexts[] = {"a", "b", "c", "d"};
  const char* const* text = kTexts;
  double number = -0.5;
  const auto sample = [&]<class T>(T) -> T {
    if constexpr (std::is_same_v<T, const HxCSrcRef*>)
      return srcRef;
    else if constexpr (std::is_same_v<T, const char*>)
      return *text++;
    else if constexpr (std::is_same_v<T, double>)
      return number += 1;
    else
      return 3;
  };
  std::tuple<Args...> arguments{sample(Args{})...};
  std::apply(emitter, arguments);
}

TEST_F(ControlTest, EachMessageHasItsIdGroupSeverityAndText) {
  const HxCSrcRef item;
#define HX_CALL(number, ...) callWithSamples(&ERR_Msg##number, &item);
  ERR_MESSAGES(HX_CALL)
#undef HX_CALL
  std::vector<std::string> reported;
  for (const HX_Message& m : HX_MessageHandler::instance().messages())
    reported.push_back(std::to_string(m.row) + " " + std::to_string(m.id) +
                       " " + ERR_FindRow(m.row)->category + ", " +
                       HX_MessageHandler::severityName(m.severity) +
                       (m.srcRef == &item ? ", of an item: " : ": ") + m.text);
  const std::string macros = " Naming Macros Messages, ";
  EXPECT_THAT(
      reported,
      ElementsAre(
          "2 10002 General Messages, note: a                              in   "
          "0.500 seconds.",
          "7 10007 General Messages, fatal error: Internal error. Error code: "
          "a3. Please report it to the support, with the model if you can.",
          "90 10651 Operating System Messages, fatal error: Cannot create "
          "file: a.",
          "403 17051 Compile Time Messages, error: Found unresolvable "
          "dependencies between the following a : b. Modify your modeling.",
          "408 17056 Compile Time Messages, error: C keyword a used as "
          "identifier.",
          "409 17057 Compile Time Messages, error: Base type name a used as "
          "identifier.",
          "410 17058 Compile Time Messages, error: User data type name a used "
          "as identifier.",
          "503 17260 Variables Messages, warning, of an item: A template name "
          "is empty.",
          "1202 30303" + macros +
              "warning, of an item: The a name macro in the b name template is "
              "not supported here. It is ignored.",
          "1203 30304" + macros +
              "warning, of an item: The a name macro in the b name template is "
              "unknown. It is ignored.",
          "1204 30305" + macros +
              "error, of an item: The $Task name macro is used in the task "
              "name template a. This is not allowed.",
          "1205 30306" + macros +
              "error, of an item: A time/period/offset name macro is used in a "
              "noncyclic task. Name template: a",
          "1206 30307" + macros +
              "warning, of an item: A time name macro 'a' with the time base b "
              "is used. The period time 0.500000 or offset 1.500000 cannot be "
              "represented precisely with this time base.",
          "1207 30308" + macros +
              "warning, of an item: The a b cannot be represented precisely "
              "with the $(Time) name macro.",
          "1209 30310" + macros +
              "warning, of an item: The $(Component) name macro could not "
              "substitute",
          "1210 30311" + macros +
              "error, of an item: The variable was referenced first through "
              "the RelatedVariables property a of software component b and "
              "second by the RelatedVariables property c of software component "
              "d.",
          "1272 99000 Internals message, internal note, of an item: a.",
          "1273 99001 Internals message, internal warning, of an item: a.",
          "1274 99002 Internals message, internal error, of an item: a.",
          "1275 99003 Internals message, internal fatal error, of an item: a.",
          "1292 99023 Internals message, internal warning: INTERNAL: a"));
}

TEST_F(ControlTest, AssertionReportsCodeAndLineAndGoesOn) {
  EXPECT_TRUE(HX_Assert(true, "a_"));
  EXPECT_FALSE(HX_DebugCheck(false, "quiet"));
  EXPECT_FALSE(HX_Assert(false, "code_", "f.cpp", 12));
  recordDebugReports();
  std::vector<std::string> reports;
  HX_MessageHandler::instance().setDebugReport([&](const char* file, int line,
                                                   const char* expression) {
    reports.push_back(file + (":" + std::to_string(line)) + " " + expression);
    return 0;
  });
  HX_Assert(false, "code_", "f.cpp", 13);
  HX_DebugCheck(false, "success", "g.cpp", 14);
  EXPECT_THAT(reports, ElementsAre("f.cpp:13 0", "g.cpp:14 success"));
  reports.clear();
  // Without a place: the place of the caller.
  const int line = __LINE__ + 1;
  HX_Assert(false, "here_");
  HX_DebugCheck(false, "here");
  const std::string place = __FILE__ ":";
  EXPECT_THAT(reports, ElementsAre(place + std::to_string(line) + " 0",
                                   place + std::to_string(line + 1) + " here"));
  const std::string start = "7/3 Internal error. Error code: ";
  EXPECT_THAT(messages(), ElementsAre(StartsWith(start + "code_12."),
                                      StartsWith(start + "code_13."),
                                      StartsWith(start + "here_" +
                                                 std::to_string(line) + ".")));
}

#if !defined(_WIN32)  // a break is no signal there
volatile std::sig_atomic_t s_Breaks = 0;

TEST_F(ControlTest, ADebugReportBreaksOnTheAnswer1Alone) {
  const auto before =
      std::signal(SIGTRAP, [](int) { s_Breaks = s_Breaks + 1; });
  recordDebugReports();
  for (const auto& [answer, breaks] : {std::pair(0, 0), {1, 2}, {2, 2}}) {
    HX_MessageHandler::instance().setDebugReport(
        [answer = answer](const char*, int, const char*) { return answer; });
    HX_DebugCheck(false, "x");
    HX_Assert(false, "x_");
    EXPECT_EQ(s_Breaks, breaks) << answer;
  }
  std::signal(SIGTRAP, before);
}
#endif

TEST_F(ControlTest, WithoutMemoryTimersStayAndNothingIsThrown) {
  HX_NEEDS_HEAP_OF_LIBRARY();
  HxCControl::setProfiling(1.0);
  HxCControl control, assigned;
  std::optional<HxCControl> copy;
  m_Clock.milliseconds = 1000;
  assigned.startTimer();
  m_Clock.milliseconds = 2000;
  control.startTimer();
  {
    const HX_FailingHeap heap(0, true);
    for (int i = 0; i < 9; ++i) control.startTimer();
    assigned = control;
    copy.emplace(control);
  }
  m_Clock.milliseconds = 4000;
  for (HxCControl* each : {&control, &assigned, &*copy}) stop(*each, "");
  EXPECT_THAT(messages(), ElementsAre(EndsWith(" in   2.000 seconds."),
                                      EndsWith(" in   3.000 seconds."),
                                      EndsWith(" in   4.001 seconds.")));
}

// A container as the library uses them.
bool appendWithinMemory(std::vector<int, HX_ControllerAllocator<int>>& values,
                        int value) {
  return HX_WithinMemory([&] { values.push_back(value); });
}

TEST_F(ControlTest, ContainersOfTheControllerFailWithoutAnException) {
  HX_CountingController memory;
  {
    std::vector<int, HX_ControllerAllocator<int>> values;
    EXPECT_TRUE(appendWithinMemory(values, 1));
    EXPECT_EQ(memory.liveBlocks(), 1);
    memory.fail();
    EXPECT_FALSE(appendWithinMemory(values, 2));
    EXPECT_THAT(values, ElementsAre(1));
    const auto tooMany = [&] {
      values.reserve(std::numeric_limits<std::size_t>::max());
      return 1;
    };
    EXPECT_EQ(HX_WithinMemory(-1, tooMany), -1) << "std::length_error";
    EXPECT_THROW(HX_ControllerAllocator<int>().allocate(
                     std::numeric_limits<std::size_t>::max() / 2),
                 std::bad_alloc)
        << "the size overflows";
  }
  EXPECT_EQ(memory.liveBlocks(), 0);
  EXPECT_EQ(HX_WithinMemory(-1, [] { return 1; }), 1);
  EXPECT_THROW(HX_WithinMemory([] { throw 7; }), int) << "of the host";
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
  delete[] new HxCSrcRef[3];
  delete new (std::nothrow) HxCSrcRef;
  delete[] new (std::nothrow) HxCSrcRef[3];
  EXPECT_EQ(controller.allocated(), 8) << "every form of new";
  EXPECT_EQ(controller.liveBlocks(), 0);
  controller.fail();
  EXPECT_EQ(new HxCSrcRef, nullptr);
  EXPECT_EQ(new HxCSrcRef[3], nullptr);
  EXPECT_EQ(new (std::nothrow) HxCSrcRef, nullptr);
  EXPECT_EQ(new (std::nothrow) HxCSrcRef[3], nullptr);
  alignas(HxCSrcRef) unsigned char place[sizeof(HxCSrcRef)];
  auto* const placed = new (place) HxCSrcRef;
  EXPECT_EQ(static_cast<void*>(placed), place);
  placed->~HxCSrcRef();
}

}  // namespace
