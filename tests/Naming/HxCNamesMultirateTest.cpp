#include <cmath>
#include <limits>
#include <tuple>

#include "Naming/HX_NamingFixture.h"
#include "support/HX_ForeignLocale.h"

namespace {

using testing::ElementsAre;
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

TEST_F(MultirateTest, BaseTimeUnitChangesAtAThousandAndAMillion) {
  EXPECT_EQ(HxCNamesTestAccess::osekBaseTime(999), "1us");
  EXPECT_EQ(HxCNamesTestAccess::osekBaseTime(1000), "4ms");
  EXPECT_EQ(HxCNamesTestAccess::osekBaseTime(999999), "4ms");
  EXPECT_EQ(HxCNamesTestAccess::osekBaseTime(1000000), "0?");
}

}  // namespace
