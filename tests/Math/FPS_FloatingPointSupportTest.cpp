#include "Math/FPS_FloatingPointSupport.h"

#include <bit>
#include <boost/multiprecision/cpp_bin_float.hpp>
#include <cfenv>
#include <random>

#include "Math/HX_ExactNumbers.h"
#include "platform/messages/HX_MessageHandler.h"
#include "support/HX_RecordedResults.h"
#include "support/HX_TestFixture.h"

#if defined(__i386__)
#include <fpu_control.h>
#endif

namespace {

namespace mp = boost::multiprecision;
using Rational =
    mp::number<mp::rational_adaptor<mp::cpp_int_backend<>>, mp::et_off>;
using Values = std::vector<double>;

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

// Values of all magnitudes, values near integers, and small values.
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

// The result and the number of assertions by the source file.
std::string asserting(double result) {
  HX_MessageHandler& handler = HX_MessageHandler::instance();
  int count = 0;
  for (const HX_Message& message : handler.messages())
    if (message.text.find(": Math/FPS_FloatingPointSupport.cpp_") !=
        message.text.npos)
      ++count;
  handler.clear();
  return HX_TextOf(result) + ", assertions: " + std::to_string(count);
}
// Divisor of the values of a row; the values stay unchanged.
std::string divisor(const HX_Arguments& row) {
  double pair[] = {row.real(0), row.real(1)};
  const double result = FPS_FindGreatestCommonDivisor(pair);
  EXPECT_EQ(bitsOf(pair[0]) + bitsOf(pair[1]),
            bitsOf(row.real(0)) + bitsOf(row.real(1)));
  return asserting(result);
}
std::string multiple(const HX_Arguments& row) {
  double values[] = {row.real(0), row.real(1), row.real(2)};
  return asserting(
      FPS_FindLeastCommonMultiple(static_cast<int>(row.size()), values));
}

const HX_Operations kOperations = {
    HX_OF(FPS_CastFloatToBool(x)),
    HX_OF(FPS_SatCastToInt(x)),
    HX_OF(asserting(FPS_SatCastToULong(x))),
    HX_OF(FPS_SatCutOffAfterPointDecimals(x)),
    HX_OF(violated32(x)),
    HX_OF(specialAsInteger(x)),
    HX_OF(FPS_IsIntegerValue(x)),
    HX_OF(FPS_RoundDown(x)),
    HX_OF(FPS_RoundUp(x)),
    HX_OF(FPS_Round(x)),
    HX_OF(FPS_RoundOffDigits(x)),
    HX_OF(FPS_SimulinkAlikeSqrt(x)),
    HX_OF(FPS_Log2(x)),
    HX_OF(FPS_Log2(FPS_SatCastToInt(x))),
    HX_OF(FPS_Log2Int(x)),
    HX_OF(FPS_GetPowerOf2(x)),
    HX_OF(exponentOf(x)),
    HX_OF(FPS_GetGreaterPowerOf2(x)),
    HX_OF(FPS_ASinh(x)),
    HX_OF(FPS_ACosh(x)),
    HX_OF(FPS_ATanh(x)),
    HX_OF(FPS_ValuesAreEqual(x, b)),
    HX_OF(FPS_ValuesAreApproxEqual(x, b)),
    HX_OF(FPS_ValuesAreApproxEqual(x, b, 0)),
    HX_OF(FPS_ValuesAreApproxEqual(x, b, 1)),
    HX_OF(FPS_RoundOffBits(x, FPS_SatCastToInt(b))),
    HX_OF(FPS_SimulinkAlikeModulo(x, b)),
    HX_OF(FPS_SimulinkAlikeRem(x, b)),
    HX_OF(divisor(row)),
    HX_OF(multiple(row))};

// No build may differ in any bit of any result.
TEST_F(FloatingPointSupportTest, OperationsGiveTheRecordedResults) {
  HX_ExpectRecorded("FPS_results.txt", kOperations);
  EXPECT_THAT(messages(), testing::IsEmpty());
}

TEST_F(FloatingPointSupportTest, SaturationAndRoundingMatchExactArithmetic) {
  SCOPED_TRACE("seed 20240229");
  std::mt19937_64 random(20240229);
  Values values;
  for (double bound : {0x1p31 - 1, -0x1p31, 0x1p32 - 1, 0x1p63, -0x1p63})
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

// The natural logarithm has no name outside: the test compares quotients, of
// our logarithm and of the correctly rounded logarithm. Few may differ.
TEST_F(FloatingPointSupportTest, LogarithmIsAlmostAlwaysCorrectlyRounded) {
  SCOPED_TRACE("seed 20240229");
  std::mt19937_64 random(20240229);
  int differences = 0;
  for (int i = 0; i < 3000; ++i) {
    // Every second value near 1 or near an odd power of the root of 2, at all
    // distances.
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
