#include "LedaIntegerSupport.h"

#include <boost/multiprecision/cpp_int.hpp>
#include <limits>
#include <random>

#include "support/HX_TestFixture.h"

namespace {

namespace mp = boost::multiprecision;
using Integer = mp::number<mp::cpp_int_backend<>, mp::et_off>;

constexpr long long kMin = std::numeric_limits<long long>::min();
constexpr long long kMax = std::numeric_limits<long long>::max();

// Before main() the bounds are still 0.
const std::vector<long long> kBeforeBoot = {
    toInt64(leda::integer(1)), toInt64(leda::integer(0)),
    toInt64(leda::integer(-1)),
    toInt64(leda::integer("-99999999999999999999"))};

class LedaIntegerSupportTest : public HX_TestFixture {
 protected:
  LedaIntegerSupportTest() { LedaIntegerSupportBoot(); }
};

TEST_F(LedaIntegerSupportTest, ConversionsRoundTrip) {
  EXPECT_THAT(kBeforeBoot, testing::ElementsAre(kMax, 0, kMin, kMin));
  std::mt19937_64 random(99);
  SCOPED_TRACE("seed 99");
  const auto& reports = recordDebugReports();
  for (int i = 0; i < 256; ++i) {
    const unsigned long long power = 1ULL << i / 4;
    const unsigned long long patterns[] = {power - 1, power, power + 1,
                                           random() >> i / 4};
    const unsigned long long pattern = patterns[i % 4];
    const auto v = static_cast<long long>(pattern);
    EXPECT_EQ(toInt64(toInteger(v)), v);
    EXPECT_EQ(toInteger(v).to_string(), Integer(v).str());
    EXPECT_EQ(toInteger(pattern).to_string(), Integer(pattern).str());
    EXPECT_EQ(toInt64(toInteger(pattern)), v < 0 ? kMax : v);
  }
  const leda::integer one(1);
  EXPECT_EQ(toInt64(toInteger(kMin) - one), kMin);
  EXPECT_EQ(toInt64(toInteger(kMin) + one), kMin + 1);
  EXPECT_EQ(toInt64(one << 70), kMax);
  EXPECT_EQ(toInt64(-(one << 70)), kMin);
  EXPECT_THAT(reports, testing::IsEmpty());
}

TEST_F(LedaIntegerSupportTest, ArithmeticMatchesABigIntegerLibrary) {
  std::mt19937 random(7);
  SCOPED_TRACE("seed 7");
  const auto draw = [&random] {
    Integer value = 0;
    for (auto words = random() % 5; words > 0; --words) {
      const std::uint32_t pick[] = {0, 1, 0xFFFFFFFF,
                                    static_cast<std::uint32_t>(random())};
      value = (value << 32) + pick[random() % 4];
    }
    return random() % 2 == 0 ? value : Integer(-value);
  };
  for (int i = 0; i < 3000; ++i) {
    const Integer x = draw();
    const Integer y = random() % 8 == 0 ? x : draw();
    const leda::integer a(x.str().c_str());
    leda::integer b;
    b = leda::integer(y.str().c_str());
    SCOPED_TRACE(x.str() + ", " + y.str());
    const int bits = static_cast<int>(random() % 140);
    EXPECT_EQ((a + b).to_string(), Integer(x + y).str());
    EXPECT_EQ((a - b).to_string(), Integer(x - y).str());
    EXPECT_EQ((a << bits).to_string(), Integer(x * (Integer(1) << bits)).str());
    EXPECT_EQ((-a).to_string(), Integer(-x).str());
    EXPECT_EQ(a < b, x < y);
    EXPECT_EQ(a == b, x == y);
    EXPECT_EQ(sign(a), x.sign());
    Integer words = 0;
    for (int word = a.used_words(); word >= 0; --word) {
      words = (words << 32) + a.contents(word);
    }
    EXPECT_EQ(words, abs(x));
    EXPECT_TRUE(a.used_words() == 0 || a.contents(a.used_words() - 1) != 0);
  }
}

TEST_F(LedaIntegerSupportTest, TextThatIsNoNumberGivesZero) {
  for (const char* text : {"", "-", "+", "12x", " 1", "--1", "-0", "000"}) {
    EXPECT_EQ(leda::integer(text).to_string(), "0") << text;
  }
  EXPECT_EQ(leda::integer("+007").to_string(), "7");
}

}  // namespace
