#include <cmath>
#include <limits>
#include <tuple>
#include <utility>

#include "Naming/HX_NamingFixture.h"
#include "support/HX_ForeignLocale.h"

namespace {

using testing::ElementsAre;
using testing::EndsWith;
using testing::HasSubstr;

class MultirateTest : public HX_NamingFixture {
 protected:
  std::string time(const std::string& form, double period, double offset,
                   bool cyclic = true) {
    Id id = identifier(form);
    names.replaceMultirateTimeName(id, period, offset, cyclic);
    quiet = true;
    return expandId(id);
  }
};

TEST_F(MultirateTest, TimesAreRoundedAndReportedWhereTheyAreUsed) {
  constexpr double kLargest = std::numeric_limits<double>::max();
  const std::tuple<const char*, double, double, const char*> rows[] = {
      {"$(Period10ms)_$(Offset10ms)", 0.01, 0.005, "1_1 1206"},
      {"$(Time10ms)", 0.01, -0.005, "1_1 1206"},
      {"$(Time)", 0.0000005, 0, "1us 1207"},
      {"$(Offset)", 0.0000005, 0, "0us"},
      {"$(Offset)x$(Time)", 1, 0.0000025, "3usx1s_3us 1207"},
      {"$(Offset1ms)", 0.01, 0, "0"},
      {"$(Time1ms)_$(Time10ms)", 0.01, 0.02, "10_20_1_2"},
      {"$(Time)", 0.01, 0.005, "10ms_5ms"},
      {"$(Period)$(Offset)", 0.01, -0.005, "10ms5ms"},
      {"$(Time)", 90, 0, "90s"},
      {"$(Time)", 0.00000101, 3599.99999, "1us_60m"},
      {"$(Time1us)", 100.0000003, 0, "100000000"},
      {"$(time1ms)", 0.01, 0, "__time1ms_"},
      // Counts beyond the range are saturated.
      {"$(Period1us)", 1e6, 0, "2147483647"},
      {"$(Time)", 86400.0 * 1e10, 0, "2147483647d"},
      {"$(Period)", kLargest, 0, "2147483647us 1207"},
      {"$(Offset)", 0, -HUGE_VAL, "2147483647us 1207"},
      {"$(Period)", std::nan(""), 0, "2147483647us 1207"},
      {"$(Period1d)", kLargest, 0, "2147483647 1206"},
      {"$(Offset1d)", 0, -HUGE_VAL, "2147483647 1206"},
      {"$(Period1d)", std::nan(""), 0, "2147483647 1206"}};
  {
    const HX_ForeignLocale foreign;
    for (const auto& [form, period, offset, result] : rows)
      EXPECT_EQ(time(form, period, offset), result) << form;
  }
  auto reported = messages();
  reported.resize(4);  // of the first five rows
  EXPECT_THAT(
      reported,
      ElementsAre("1206/1 A time name macro 'Offset' with the time base 10ms "
                  "is used. The period time 0.010000 or offset 0.005000 cannot "
                  "be represented precisely with this time base. "
                  "[car/Ctrl/Speed Gain]",
                  HasSubstr("'Time' with the time base 10ms"),
                  "1207/1 The period 0.0000005000 cannot be represented "
                  "precisely with the $(Time) name macro. "
                  "[car/Ctrl/Speed Gain]",
                  HasSubstr("The offset 0.0000025000 cannot")));
}

TEST_F(MultirateTest, EachUnitHasItsMacros) {
  const std::pair<std::string, double> units[] = {
      {"1us", 1e-6},  {"10us", 1e-5}, {"100us", 1e-4}, {"1ms", 1e-3},
      {"10ms", 0.01}, {"100ms", 0.1}, {"1s", 1},       {"1m", 60},
      {"1h", 3600},   {"1d", 86400}};
  for (const auto& [unit, seconds] : units) {
    const std::string form =
        "$(Period" + unit + ")/$(Offset" + unit + ")/$(Time" + unit + ")";
    for (int count = 1; count < 24; ++count) {
      const std::string text = std::to_string(count);
      const std::string all = text + "/1/" + text + "_1";
      const double period = count * seconds;
      EXPECT_EQ(time(form, period, seconds), all);
      for (const double off : {-0.49 * seconds, 0.49 * seconds}) {
        EXPECT_EQ(time(form, period + off, seconds), all + " 1206 1206");
        EXPECT_THAT(messages().back(),
                    HasSubstr("'Period' with the time base " + unit + " is"));
        clearMessages();
      }
      if (unit.find('0') != unit.npos) continue;
      EXPECT_EQ(time("$(Period)", period, 0), text + unit.substr(1));
    }
  }
}

TEST_F(MultirateTest, NoncyclicTasksHaveNoTime) {
  EXPECT_EQ(time("$(Task)", 1, 0, false), "__Task_");
  EXPECT_EQ(time("$(Period10ms)_$(Time)$(Offset1d)x", 1, 0, false),
            "ACYCLIC_ACYCLICACYCLICx 1205");
  EXPECT_THAT(messages(),
              ElementsAre("1205/2 A time/period/offset name macro is used in a "
                          "noncyclic task. Name template: "
                          "$(Period10ms)_$(Time)$(Offset1d)x "
                          "[car/Ctrl/Speed Gain]"));
}

TEST_F(MultirateTest, MessagesShowTheActiveRawNameAndSomeReference) {
  const HxCDdSrcRef ddRef(HX_DdTree::instance().add("//DD0/Pool/K"));
  Id id("$(Time)$(Task):$(Task)_$(Time1s)$(Period)");
  id.setDdSourceRef(&ddRef);
  id.activateActualName();
  for (const bool cyclic : {false, true}) {
    Id named(id);
    names.replaceMultirateTaskISRName(named, Id(), Id(), true);
    names.replaceMultirateTimeName(named, 0.1234567, 0, cyclic);
  }
  const std::string raw = "$(Task)_$(Time1s)$(Period)";
  const std::string ofTask =
      "1204/2 The $Task name macro is used in the task "
      "name template " +
      raw +
      ". This is not allowed. "
      "[//DD0/Pool/K]";
  EXPECT_THAT(messages(),
              ElementsAre(ofTask,
                          "1205/2 A time/period/offset name macro is used in a "
                          "noncyclic task. Name template: " +
                              raw + " [//DD0/Pool/K]",
                          ofTask, EndsWith("time base. [//DD0/Pool/K]"),
                          EndsWith("$(Time) name macro. [//DD0/Pool/K]")));
}

TEST_F(MultirateTest, TasksAndIsrsStandInForEachOther) {
  const Id task("fast task:fast task"), isr("irq-1:irq-1");
  const auto replace = [&](const Id& used, bool isTaskName) {
    Id id = identifier("$(Task)/$(ISR):x");
    names.replaceMultirateTaskISRName(id, used, isr, isTaskName);
    return shown(id);
  };
  EXPECT_EQ(replace(task, false), "fast_task/irq_1:x");
  EXPECT_EQ(replace(Id(), false), "irq_1/irq_1:x");
  Id half("fast task:");  // the active name decides
  EXPECT_EQ(replace(half, false), "fast_task/irq_1:x");
  half.activateActualName();
  EXPECT_EQ(replace(half, false), "irq_1/irq_1:x");
  EXPECT_EQ(replace(task, true), "__Task_/irq_1:x 1204");
  EXPECT_THAT(messages(),
              ElementsAre("1204/2 The $Task name macro is used in the task "
                          "name template $(Task)/$(ISR). This is not allowed. "
                          "[car/Ctrl/Speed Gain]"));
  Id own("$(Task)/$(ISR):x");
  names.replaceMultirateTaskISRName(own, task, own, false);
  EXPECT_EQ(shown(own), "fast_task/__Task____ISR_:x");
}

TEST_F(MultirateTest, ObjectsAreMadeCIdentifiers) {
  const Id value("a b:a b");
  Id id("$(PObj)$(Event)$(ISR)$(Msg)$(Ctr)$(MsgVar):x");
  names.replaceMultirateObjName(id, value);
  names.replaceMultirateEventName(id, value);
  names.replaceMultirateISRName(id, value);
  names.replaceMultirateMsgName(id, value);
  names.replaceMultirateCtrName(id, value);
  EXPECT_EQ(shown(id), "a_ba_ba_ba_ba_b$(MsgVar):x");
  // Text, text of $(MsgVar), notes of the macros in the text.
  const std::tuple<const char*, std::string, const char*> rows[] = {
      {"abc", "1", ":"},    {"msg#7;", "7", ":"},  {"a#b#12x", "12", ":"},
      {"a#", "", ":"},      {"#a b;", "a b", ":"}, {"", "1", ":"},
      {"a#$N;", "$N", "N:"}};
  for (const auto& [message, text, notes] : rows) {
    Id variable("<$(MsgVar)>:$(MsgVar)");
    names.replaceMultirateMsgVarName(variable, message);
    EXPECT_EQ(shown(variable), "<" + text + ">:" + text + "$R") << message;
    variable.setCookLevel(Id::eCookLevelFull);
    EXPECT_EQ(notedOf(variable), notes);
  }
}

TEST_F(MultirateTest, BaseTimeUnitChangesAtAThousandAndAMillion) {
  EXPECT_EQ(HxCNamesTestAccess::osekBaseTime(999), "1us");
  EXPECT_EQ(HxCNamesTestAccess::osekBaseTime(1000), "4ms");
  EXPECT_EQ(HxCNamesTestAccess::osekBaseTime(999999), "4ms");
  EXPECT_EQ(HxCNamesTestAccess::osekBaseTime(1000000), "0?");
}

}  // namespace
