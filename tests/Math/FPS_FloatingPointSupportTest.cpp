#include "Math/FPS_FloatingPointSupport.h"

#include <bit>
#include <boost/multiprecision/cpp_bin_float.hpp>
#include <cfenv>
#include <random>

#include "Math/HX_ExactNumbers.h"
#include "support/HX_TestFixture.h"

#if defined(__i386__)
#include <fpu_control.h>
#endif

namespace {

namespace mp = boost::multiprecision;
using Rational =
    mp::number<mp::rational_adaptor<mp::cpp_int_backend<>>, mp::et_off>;
using Values = std::vector<double>;

constexpr double kMax = std::numeric_limits<double>::max();
constexpr double kTiny = std::numeric_limits<double>::denorm_min();
constexpr double kTwo31 = 2147483648.0;
constexpr double kTwo32 = 4294967296.0;
constexpr double kTwo63 = 9223372036854775808.0;
constexpr double kTolerance = 0x1p-26;

// The bits of a double; all NaNs count as one.
std::uint64_t bitsOf(double x) {
  return std::isnan(x) ? 0x7FF8000000000000 : std::bit_cast<std::uint64_t>(x);
}

// Spoils the state before any library is initialised.
void spoilFloatingPointState() {
  std::fesetround(FE_UPWARD);
#if defined(__i386__)
  fpu_control_t control = 0x0B7F;  // extended precision, upward
  _FPU_SETCW(control);
#endif
}
[[gnu::section(".preinit_array"),
  gnu::used]] void (*const kSpoiler)() = spoilFloatingPointState;

const Values kBeforeInitialisation = {FPS_GetFlNaN(), FPS_GetPosInf(),
                                      FPS_GetNegInf(), FPS_GetPi()};

class FloatingPointSupportTest : public HX_TestFixture {};

TEST_F(FloatingPointSupportTest, LoadingSetsTheFloatingPointState) {
  EXPECT_EQ(std::fegetround(), FE_TONEAREST);
#if defined(__i386__)
  fpu_control_t control = 0;
  _FPU_GETCW(control);
  EXPECT_EQ(control & 0x0F00, 0x0200) << "53 bits, to nearest";
#endif
  EXPECT_THAT(kBeforeInitialisation, testing::Each(0.0));
  ModInit_FPS_FloatingPointSupport();
  EXPECT_TRUE(std::isnan(FPS_GetFlNaN()));
  EXPECT_EQ(FPS_GetPosInf(), kInf);
  EXPECT_EQ(FPS_GetNegInf(), -kInf);
  EXPECT_EQ(bitsOf(FPS_GetPi()), 0x400921FB54442D18);
  EXPECT_THAT(messages(), testing::IsEmpty());
}

// Values of all magnitudes, of those near the integers and of small ones.
double draw(std::mt19937_64& random) {
  const std::uint64_t bits = random();
  const double part =
      std::ldexp(static_cast<double>(static_cast<std::int64_t>(random())), -63);
  const double choices[] = {
      std::bit_cast<double>(bits),
      std::ldexp(part, static_cast<int>(bits % 70)),
      std::floor(std::ldexp(part, 20)) + std::ldexp(part, -24),
      std::floor(std::ldexp(part, 8)) / 4.0};
  return choices[random() % 4];
}

// The exponent, -9999 if x is no power of two.
double exponentOf(double x) {
  int exponent = 77;
  EXPECT_EQ(FPS_PowerOf2(x, &exponent), FPS_PowerOf2(x, nullptr));
  return FPS_PowerOf2(x, nullptr) ? exponent : exponent - 9999;
}
// The violated bound, 0 if there is none.
double violated32(double x) {
  double limit = 77.0;
  return FPS_Fits32Bit(x, limit) ? limit - 77.0 : limit;
}
// The integer that stands for a special value, 1 if x is none.
double specialAsInteger(double x) {
  double out = 77.0;
  return FPS_ConvertSpecialValueToInteger(x, &out) ? out : out + 1.0;
}

// An operation of two arguments or, with b empty, one that looks at x only, and
// its results at its boundaries.
struct Operation {
  const char* text;
  double (*of)(double x, double b);
  std::uint64_t recorded;  // sum of many results in a 64-bit build; 0: no sum
  Values x, expected, b;
};

Operation row(const char* text, double (*of)(double, double),
              std::uint64_t recorded, Values x, Values expected,
              Values b = {}) {
  return {text, of, recorded, x, expected, b};
}

#define HX_OF(expression) \
#expression,            \
      [](double x, [[maybe_unused]] double b) -> double { return expression; }

const Operation kOperations[] = {
    row(HX_OF(FPS_CastFloatToBool(x)), 0xB9FF98AB98233825, {-0.0, kTiny, kNaN},
        {0, 1, 1}),
    row(HX_OF(FPS_SatCastToInt(x)), 0xD680866D96A33825, {-2.7, -kInf, kNaN},
        {-2, -kTwo31, 2147483647}),
    // Below zero it asserts.
    row(HX_OF(FPS_SatCastToULong(x)), 0, {kInf, -1.5, -kTwo32 - 2.0, -kInf},
        {4294967295, 4294967295, 4294967294, 0}),
    row(HX_OF(FPS_SatCutOffAfterPointDecimals(x)), 0x83A58C91F0593822,
        {kMax, -0.9}, {kTwo63, 0.0}),
    row(HX_OF(violated32(x)), 0xF45880F425633825,
        {kTwo32 - 1, above(kTwo32 - 1), -kTwo31, below(-kTwo31), kNaN},
        {0, kTwo32 - 1, 0, -kTwo31, 0}),
    row(HX_OF(specialAsInteger(x)), 0x39FF98AB98233825,
        {kInf, kNaN, -kInf, kMax}, {kTwo63, kTwo63, -kTwo63, 1}),
    // Strictly nearer than the tolerance.
    row(HX_OF(FPS_IsIntegerValue(x)), 0x977F98AB98233825,
        {1.0 - kTolerance, above(1.0 - kTolerance), kTolerance, 0x1p25 - 0.5,
         0x1p25 + 0.5, kTwo63, 1e300, kInf, kNaN},
        {0, 1, 0, 0, 1, 1, 0, 0, 0}),
    // Adding 1 rounds up the value below 1.
    row(HX_OF(FPS_RoundDown(x)), 0x17404CFEF5FB9A9C,
        {2.9999999999, below(3.0), below(1.0), -2.5, 3.00000001, 0x1p25 + 0.5,
         0x1p25 + 0.25, -0x1p25 - 0.5, 0x1p51 + 0.5, 1e300},
        {3, 3, 2, -3, 3, 0x1p25 + 1, 0x1p25, -0x1p25, 0x1p51 + 1, kTwo63}),
    // From 2^25 on all values are near, halves move up, as 2^52 + 1 does.
    row(HX_OF(FPS_RoundUp(x)), 0xEDC1FD04D5FB9A9C,
        {above(-1.0), -2.5, 2.00000001, -2.00000001, -2.99999999, 0x1p25 + 0.25,
         -0x1p25 - 0.5, -0x1p51 - 0.5, 0x1p52 + 1, -0.4, -kInf},
        {-2, -2, 2, -2, -3, 0x1p25, -0x1p25, -0x1p51, 0x1p52 + 2, 0.0,
         -kTwo63}),
    row(HX_OF(FPS_Round(x)), 0x085F81F263F18458, {2.5, -2.5, below(2.5), -0.4},
        {3, -3, 2, 0.0}),
    row(HX_OF(FPS_RoundOffDigits(x)), 0x309537D69A6E6DEE,
        {0.12345678901234567, -0x1p-14, 1.8e295, -kInf, kNaN},
        {0.1234567890123, -0.0000610351562, kInf, -kInf, kNaN}),
    row(HX_OF(FPS_SimulinkAlikeSqrt(x)), 0xF5141C392D40D54A, {-4.0, -0.0},
        {-2.0, -0.0}),
    row(HX_OF(FPS_Log2(x)), 0x8986B89898067F94, {8.0, 2.0, -0.0, kInf, -kTiny},
        {2.9999999999999796, 0.9999999999999932, -kInf, kInf, kNaN}),
    row(HX_OF(FPS_Log2(1.0 + std::remainder(x, 0.3))), 0x03D2D73F7887163C,
        {0.0}, {0.0}),
    row(HX_OF(FPS_Log2(FPS_SatCastToInt(x))), 0x55B215D4A74B2610, {8.0},
        {2.9999999999999796}),
    row(HX_OF(FPS_Log2Int(x)), 0xF70517B4A8633825, {8.0, 0.25, 0.0, -1.0},
        {2, -1, -kTwo31, kTwo31 - 1}),
    row(HX_OF(FPS_GetPowerOf2(x)), 0x3323F7B4A8633825, {5.0, 6.0, 0.3},
        {2, 3, -2}),
    row(HX_OF(exponentOf(x)), 0x0F63502B98233825,
        {0.25, -4.0, 3.0, 0.0, 0x1p-1022, 0x1p-1023, kInf},
        {-2, 2, -9999, -9999, -1022, -9999, 1024}),
    // Above 8 the error of the logarithm shows.
    row(HX_OF(FPS_GetGreaterPowerOf2(x)), 0xA294CFCD09233825,
        {5.0, 8.0, above(8.0), 0.3}, {3, 3, 3, -1}),
    row(HX_OF(FPS_ASinh(x)), 0x93DB1D61E3159F84, {1.0}, {0.88137358701954294}),
    row(HX_OF(FPS_ACosh(x)), 0x582250D339B9DF56, {2.0, 0.5},
        {1.3169578969248166, kNaN}),
    row(HX_OF(FPS_ATanh(x)), 0x5EFA3C86D6B55F43, {0.5, 1.0},
        {0.54930614433405489, kInf}),
    row(HX_OF(FPS_ValuesAreEqual(x, b)), 0x0CCF98AB98233825,
        {kNaN, kNaN, kInf, kInf, 0.0, 1.0}, {1, 0, 0, 1, 1, 0},
        {-kNaN, 1.0, -kInf, kInf, -0.0, above(1.0)}),
    row(HX_OF(FPS_ValuesAreApproxEqual(x, b)), 0xCD4F98AB98233825,
        {1.0, 1e9, 0.0, 0.0, 0.0, -4.0, -4.0, kMax, kMax, kNaN},
        {1, 1, 0, 0, 1, 0, 1, 0, 0, 1},
        {1.0 + 1e-9, 1e9 + 1.0, 2e-8, kTolerance, below(kTolerance),
         -4.0 + 4 * kTolerance, below(-4.0 + 4 * kTolerance), -kMax, kInf,
         kNaN}),
    row(HX_OF(FPS_ValuesAreApproxEqual(x, b, 0)), 0xBECF98AB98233825, {1.0},
        {0}, {1.0}),
    row(HX_OF(FPS_ValuesAreApproxEqual(x, b, 1)), 0x15CF98AB98233825,
        {3.0, 0.0}, {1, 0}, {5.0, 5.0}),
    // A tie moves up; with 53 bits the added half rounds.
    row(HX_OF(FPS_RoundOffBits(x, FPS_SatCastToInt(b))), 0xDB503CBE87C1D01D,
        {0x1.2p0, -0x1.2p0, below(0x1.2p0), above(1.0), above(1.0), -kMax, -1.0,
         1.5, -1.5, -kInf},
        {0x1.4p0, -0x1p0, 0x1p0, above(above(1.0)), above(1.0), -kMax, -kInf,
         2.0, 0.0, -kInf},
        {3, 3, 3, 53, 54, 1024, kTwo31 - 1, 0, -kTwo31, 8}),
    row(HX_OF(FPS_RoundOffBits(x, static_cast<int>(bitsOf(b) % 64))),
        0x9676B81054692057, {1.5}, {2.0}, {1.0}),
    // The quotient of the tiny value is -0.
    row(HX_OF(FPS_SimulinkAlikeModulo(x, b)), 0xA89686C2229AD553,
        {-7.0, 7.0, 5.0, -1e-300, -kTiny, 1.0},
        {2.0, -2.0, 5.0, 3.0, -kTiny, kNaN}, {3.0, -3.0, -0.0, 3.0, 3.0, kInf}),
    row(HX_OF(FPS_SimulinkAlikeRem(x, b)), 0xC9DF848BF21AA200,
        {-7.0, 7.0, kInf, 0x1p70}, {-1.0, 1.0, 0.0, 0x1p70 - 0x1p63},
        {3.0, -3.0, 0.0, 1.0})};

// No build may differ in any bit of any result.
TEST_F(FloatingPointSupportTest, OperationsGiveTheSameBitsInEveryBuild) {
  Values values = {
      0.0,    -0.0,   kNaN,      std::bit_cast<double>(0x7FF0000000000001),
      kInf,   -kInf,  kMax,      -kMax,
      kTiny,  -kTiny, 0x1p-1022, 0x1p63,
      -0x1p63};
  std::mt19937_64 random(20240229);
  while (values.size() < 200) values.push_back(draw(random));
  for (const auto& [text, of, recorded, x, expected, b] : kOperations) {
    SCOPED_TRACE(text);
    for (std::size_t i = 0; i < expected.size(); ++i) {
      const double result = of(x.at(i), b.empty() ? 0.0 : b.at(i));
      EXPECT_EQ(bitsOf(result), bitsOf(expected[i]))
          << testing::PrintToString(x) << "[" << i << "] gave " << result
          << " instead of " << expected[i];
    }
    if (recorded == 0) continue;
    std::uint64_t sum = 14695981039346656037U;
    for (double first : values) {
      for (double second : values) {
        const double result = of(b.empty() ? first * second : first, second);
        sum = (sum ^ bitsOf(result)) * 1099511628211U;
      }
    }
    EXPECT_EQ(sum, recorded);
  }
  EXPECT_EQ(messages().size(), 3U);
}

TEST_F(FloatingPointSupportTest, EveryStepOfADivisorAsserts) {
  const struct {
    Values values;
    double divisor, multiple;
    std::size_t assertions;
  } rows[] = {{{12, 8}, 4, 24, 6},         {{5, 0}, 5, 0, 2},
              {{0, 0}, 0, kNaN, 2},        {{-12, 8}, -4, 24, 6},
              {{0.75, 0.5}, 0.25, 1.5, 6}, {{kNaN, 1}, kNaN, kNaN, 4},
              {{1, kNaN}, kNaN, kNaN, 2},  {{kInf, 2}, kNaN, kNaN, 4},
              {{2, kInf}, kNaN, kNaN, 6},  {{0.5, 0.75, 1.0}, 0.25, 3.0, 11}};
  for (const auto& [given, divisor, multiple, assertions] : rows) {
    SCOPED_TRACE(testing::PrintToString(given));
    Values values = given;
    clearMessages();
    EXPECT_EQ(bitsOf(FPS_FindGreatestCommonDivisor(values.data())),
              bitsOf(divisor));
    EXPECT_EQ(bitsOf(FPS_FindLeastCommonMultiple(
                  static_cast<int>(values.size()), values.data())),
              bitsOf(multiple));
    EXPECT_EQ(messages().size(), assertions);
    EXPECT_THAT(messages(), testing::Each(testing::HasSubstr(
                                "Math/FPS_FloatingPointSupport.cpp_")));
    EXPECT_TRUE(std::isnan(multiple) || values == given);
  }
}

TEST_F(FloatingPointSupportTest, SaturationAndRoundingMatchExactArithmetic) {
  SCOPED_TRACE("seed 20240229");
  std::mt19937_64 random(20240229);
  Values values;
  for (double bound : {kTwo31 - 1, -kTwo31, kTwo32 - 1, kTwo63, -kTwo63})
    values.insert(values.end(), {below(bound), bound, above(bound)});
  while (values.size() < 6000) values.push_back(draw(random));
  for (double x : values) {
    if (!std::isfinite(x)) continue;
    SCOPED_TRACE(x);
    const Integer cut(x);  // truncates
    const auto saturated = [&](long long low, long long high) {
      return std::clamp(cut, Integer(low), Integer(high));
    };
    const Integer int64 = saturated(kMin64, kMax64);
    EXPECT_EQ(Integer(FPS_SatCastToInt64(x)), int64);
    EXPECT_EQ(FPS_SatCutOffAfterPointDecimals(x), int64.convert_to<double>());
    EXPECT_EQ(FPS_SatCastToInt(x), saturated(-2147483648LL, 2147483647));
    if (x >= 0) {
      EXPECT_EQ(FPS_SatCastToULong(x), saturated(0, 4294967295));
    }
    if (std::fabs(x) >= 0x1p25) continue;

    const Rational exact(x);
    const Integer doubled(mp::abs(exact) * 2);
    const Integer half = (doubled + 1) / 2 * (x < 0 ? -1 : 1);
    const Rational scale = std::max(
        {Rational(1), Rational(mp::abs(exact)), Rational(mp::abs(half))});
    const bool isNear = mp::abs(exact - half) < scale * Rational(kTolerance);
    EXPECT_EQ(Integer(FPS_Round(x)), half);
    EXPECT_EQ(FPS_IsIntegerValue(x), isNear);
    EXPECT_EQ(Integer(FPS_RoundUp(x)),
              isNear ? half : cut + (exact > cut ? 1 : 0));
    EXPECT_EQ(Integer(FPS_RoundDown(x)),
              isNear ? half : cut - (exact < cut ? 1 : 0));
  }
}

// The logarithm itself has no name outside, so its quotient is compared: with
// that of the correctly rounded logarithm, from which it rarely may differ.
TEST_F(FloatingPointSupportTest, LogarithmIsAlmostAlwaysCorrectlyRounded) {
  SCOPED_TRACE("seed 20240229");
  std::mt19937_64 random(20240229);
  int differences = 0;
  for (int i = 0; i < 3000; ++i) {
    // Every second value near 1 or an odd power of its root of 2, at all
    // distances from it.
    const double near = 1 + std::ldexp(i - 1500.5, -11 - i % 47);
    const double nearRoot = std::ldexp(near * 0x1.6a09e667f3bcdp0, i / 2 - 750);
    const double x = i % 2 == 0   ? std::fabs(draw(random))
                     : i % 4 == 1 ? near
                                  : nearRoot;
    if (!(x > 0.0 && x < kInf)) continue;
    SCOPED_TRACE(x);
    const double log = FPS_Log2(x);  // decides the integer logarithms
    EXPECT_EQ(FPS_Log2Int(x), static_cast<int>(log));
    EXPECT_EQ(FPS_GetPowerOf2(x),
              static_cast<int>(log + (log < 0 ? -0.5 : 0.5)));
    if (!FPS_PowerOf2(x, nullptr)) {
      EXPECT_EQ(FPS_GetGreaterPowerOf2(x),
                static_cast<int>(log < 0 ? log : log + 1));
    }
    const double ln = mp::log(mp::cpp_bin_float_50(x)).convert_to<double>();
    const double exact = ln / 0.69314718055995;
    EXPECT_NEAR(log, exact, std::fabs(exact) * 0x1p-51);
    if (bitsOf(log) != bitsOf(exact)) ++differences;
  }
  EXPECT_LE(differences, 6);
}

}  // namespace
