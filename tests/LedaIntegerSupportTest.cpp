#include "LedaIntegerSupport.h"

#include <random>

#include "Math/HX_ExactNumbers.h"
#include "support/HX_TestFixture.h"

namespace {

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
  EXPECT_THAT(kBeforeBoot, testing::ElementsAre(kMax64, 0, kMin64, kMin64));
  const auto& reports = recordDebugReports();
  for (long long v : boundaryValues()) {
    const auto pattern = static_cast<unsigned long long>(v);
    EXPECT_EQ(toInt64(toInteger(v)), v);
    EXPECT_EQ(toInteger(v).to_string(), Integer(v).str());
    EXPECT_EQ(toInteger(pattern).to_string(), Integer(pattern).str());
    EXPECT_EQ(toInt64(toInteger(pattern)), v < 0 ? kMax64 : v);
  }
  const leda::integer one(1);
  EXPECT_EQ(toInt64(toInteger(kMin64) - one), kMin64);
  EXPECT_EQ(toInt64(toInteger(kMin64) + one), kMin64 + 1);
  EXPECT_EQ(toInt64(one << 70), kMax64);
  EXPECT_EQ(toInt64(-(one << 70)), kMin64);
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
