#include <clocale>
#include <cmath>
#include <limits>
#include <random>
#include <tuple>
#include <utility>

#include "Naming/HX_NamingFixture.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class MultirateTest : public HX_NamingFixture {
 protected:
  std::string time(const std::string& form, double period, double offset,
                   bool cyclic = true) {
    Id id((form + ":" + form).c_str());
    id.setSourceRef(gain.getSrcRef());
    names.replaceMultirateTimeName(id, period, offset, cyclic);
    names.createNameFromForm(id, nullptr, 0, 0, true);
    return formal(id);
  }
};

TEST_F(MultirateTest, ExactTimesGiveNoMessage) {
  const std::tuple<const char*, double, double, const char*> rows[] = {
      {"$(Offset1ms)", 0.01, 0, "0"},
      {"$(Time1ms)_$(Time10ms)", 0.01, 0.02, "10_20_1_2"},
      {"$(Time)", 0.01, 0.005, "10ms_5ms"},
      {"$(Period)$(Offset)", 0.01, -0.005, "10ms5ms"},
      {"$(Time)", 90, 0, "90s"},
      {"$(Time)", 0.00000101, 3599.99999, "1us_60m"},
      {"$(Time1us)", 100.0000003, 0, "100000000"},
      {"$(time1ms)", 0.01, 0, "__time1ms_"}};
  for (const auto& [form, period, offset, result] : rows) {
    EXPECT_EQ(time(form, period, offset), result);
    EXPECT_THAT(messages(), IsEmpty()) << form;
  }
}

TEST_F(MultirateTest, ImpreciseTimesAreReportedWhereTheyAreUsed) {
  // Its decimal comma must not show; nothing happens where it is not installed.
  std::setlocale(LC_NUMERIC, "de_DE.UTF-8");
  EXPECT_EQ(time("$(Period10ms)_$(Offset10ms)", 0.01, 0.005), "1_1");
  EXPECT_EQ(time("$(Time10ms)", 0.01, -0.005), "1_1");
  EXPECT_EQ(time("$(Time)", 0.0000005, 0), "1us");
  EXPECT_EQ(time("$(Offset)", 0.0000005, 0), "0us");
  EXPECT_EQ(time("$(Offset)x$(Time)", 1, 0.0000025), "3usx1s_3us");
  std::setlocale(LC_NUMERIC, "C");
  const auto fixed = [](const char* kind) {
    return std::string("1206/1 A time name macro '") + kind +
           "' with the time base 10ms is used. The period time 0.010000 or "
           "offset 0.005000 cannot be represented precisely with this time "
           "base. [car/Ctrl/Speed Gain]";
  };
  const auto generic = [](const char* value) {
    return std::string("1207/1 The ") + value +
           " cannot be represented precisely with the $(Time) name macro. "
           "[car/Ctrl/Speed Gain]";
  };
  EXPECT_THAT(messages(), ElementsAre(fixed("Offset"), fixed("Time"),
                                      generic("period 0.0000005000"),
                                      generic("offset 0.0000025000")));
}

// Whole microseconds, exact as integers: the text times its unit must give the
// value back, and the message must be there exactly when it does not.
TEST_F(MultirateTest, TimesAgreeWithExactArithmetic) {
  struct Unit {
    std::string text;
    std::int64_t microseconds;
  };
  const Unit units[] = {{"d", 86400000000}, {"h", 3600000000}, {"m", 60000000},
                        {"s", 1000000},     {"ms", 1000},      {"us", 1}};
  std::vector<Unit> bases;
  for (const Unit& unit : units)
    for (int factor : {100, 10, 1})
      if (factor == 1 || unit.microseconds <= 1000)
        bases.push_back(
            {std::to_string(factor) + unit.text, factor * unit.microseconds});
  constexpr unsigned kSeed = 20;
  SCOPED_TRACE(kSeed);
  std::mt19937 random(kSeed);
  for (int round = 0; round < 400; ++round) {
    std::int64_t value = static_cast<std::int64_t>(random() % 2000);
    for (const Unit& unit : bases)
      if (random() % 3 == 0 && value < 1000000000 / unit.microseconds)
        value *= unit.microseconds;
    const double seconds = static_cast<double>(value) / 1e6;
    SCOPED_TRACE(seconds);
    for (const Unit& base : bases) {
      clearMessages();
      const std::string form = "$(Period" + base.text + ")";
      const std::int64_t count =
          (value + base.microseconds / 2) / base.microseconds;
      const bool isTie = value % base.microseconds * 2 == base.microseconds;
      const std::string text = time(form, seconds, 0);
      // The quotient of a tie may lie a rounding error below it.
      const bool isBelowTie = isTie && text == std::to_string(count - 1);
      ASSERT_EQ(text, std::to_string(isBelowTie ? count - 1 : count))
          << base.text;
      // Near zero the tolerance of the comparison is absolute: 2^-26 units.
      const bool exact =
          value % base.microseconds == 0 ||
          static_cast<double>(value % base.microseconds) <
              std::ldexp(static_cast<double>(base.microseconds), -26);
      ASSERT_EQ(messages().empty(), exact) << base.text;
    }
    clearMessages();
    const Unit* largest = units;
    while (value % largest->microseconds != 0 ||
           (value < largest->microseconds && largest->microseconds > 1))
      ++largest;
    ASSERT_EQ(time("$(Period)", seconds, 0),
              std::to_string(value / largest->microseconds) + largest->text);
    ASSERT_THAT(messages(), IsEmpty());
  }
}

TEST_F(MultirateTest, CountsBeyondTheRangeAreSaturated) {
  EXPECT_EQ(time("$(Period1us)", 1e6, 0), "2147483647");
  EXPECT_EQ(time("$(Time)", 86400.0 * 1e10, 0), "2147483647d");
  constexpr double kLargest = std::numeric_limits<double>::max();
  for (double value : {kLargest, HUGE_VAL, std::nan("")}) {
    for (const char* macro : {"$(Time1d)", "$(Time)"}) {
      clearMessages();
      const bool isGeneric = std::string(macro) == "$(Time)";
      const std::string count = isGeneric ? "2147483647us" : "2147483647";
      EXPECT_EQ(time(macro, value, -value), count + "_" + count) << value;
      EXPECT_EQ(messages().size(), isGeneric ? 2U : 1U) << macro << value;
    }
  }
}

TEST_F(MultirateTest, NoncyclicTasksHaveNoTime) {
  EXPECT_EQ(time("$(Period10ms)_$(Time)$(Offset1d)x$(Task)", 1, 0, false),
            "ACYCLIC_ACYCLICACYCLICx__Task_");
  EXPECT_THAT(messages(),
              ElementsAre("1205/2 A time/period/offset name macro is used in a "
                          "noncyclic task. Name template: "
                          "$(Period10ms)_$(Time)$(Offset1d)x$(Task) "
                          "[car/Ctrl/Speed Gain]"));
  clearMessages();
  time("$(Task)", 1, 0, false);
  EXPECT_THAT(messages(), IsEmpty());
}

TEST_F(MultirateTest, TasksAndIsrsStandInForEachOther) {
  const Id task("fast task:fast task");
  const Id isr("irq-1:irq-1");
  const auto replace = [&](const Id& used, bool isTaskName) {
    Id id = identifier("$(Task)/$(ISR):x", gain.getSrcRef());
    names.replaceMultirateTaskISRName(id, used, isr, isTaskName);
    return formal(id);
  };
  EXPECT_EQ(replace(task, false), "fast_task/irq_1");
  EXPECT_EQ(replace(Id(), false), "irq_1/irq_1");
  EXPECT_THAT(messages(), IsEmpty());
  Id own("$(Task)/$(ISR):x");
  names.replaceMultirateTaskISRName(own, task, own, false);
  EXPECT_EQ(formal(own), "fast_task/__Task____ISR_");
  EXPECT_EQ(replace(task, true), "__Task_/irq_1");
  EXPECT_THAT(messages(),
              ElementsAre("1204/2 The $Task name macro is used in the task "
                          "name template $(Task)/$(ISR). This is not allowed. "
                          "[car/Ctrl/Speed Gain]"));
}

TEST_F(MultirateTest, ObjectsAreMadeCIdentifiers) {
  const Id value("a b:a b");
  Id id("$(PObj)$(Event)$(ISR)$(Msg)$(Ctr)$(MsgVar):x");
  names.replaceMultirateObjName(id, value);
  names.replaceMultirateEventName(id, value);
  names.replaceMultirateISRName(id, value);
  names.replaceMultirateMsgName(id, value);
  names.replaceMultirateCtrName(id, value);
  EXPECT_EQ(formal(id), "a_ba_ba_ba_ba_b$(MsgVar)");
  const std::pair<const char*, const char*> rows[] = {
      {"abc", "<1>"}, {"msg#7;", "<7>"},  {"a#b#12x", "<12>"},
      {"a#", "<>"},   {"#a b;", "<a b>"}, {"", "<1>"}};
  for (const auto& [message, result] : rows) {
    Id variable("<$(MsgVar)>:x");
    names.replaceMultirateMsgVarName(variable, message);
    EXPECT_EQ(formal(variable), result) << message;
  }
  Id unused("none");
  names.replaceMultirateMsgVarName(unused, "a#$N;");
  unused.setCookLevel(Id::eCookLevelFull);
  EXPECT_TRUE(unused.getDollarNUsed(Id::eFormalName));
}

TEST_F(MultirateTest, BaseTimeUnitChangesAtAThousandAndAMillion) {
  const std::tuple<double, int, const char*> rows[] = {
      {999, 1, "us"}, {1000, 4, "ms"}, {999999, 4, "ms"}, {1000000, 0, "?"}};
  for (const auto& [value, expected, name] : rows) {
    auto base = static_cast<HxCNames::tagHxEOsekTimeBase>(0);
    KyCXString unit("?");
    HxCNamesTestAccess::osekBaseTime(value, base, unit);
    EXPECT_EQ(base, expected);
    EXPECT_EQ(unit, name);
  }
}

}  // namespace
