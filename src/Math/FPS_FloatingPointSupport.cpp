// The rounding to integers, the integer logarithms and the other operations on
// doubles.
//
// Rounding up and down
// --------------------
// Problem: ceiling and floor, but a value within the tolerance 2^-26 of an
// integer snaps to the integer.
//
// Plain form, kept for magnitudes from 2^51 on: r = floor(x + 0.5), saturated
// to 64 bits; a tolerant comparison of r and x; then a saturated cast of
// x - 1, x or x + 1, chosen by the sign of x and of r - x.
// COST: two calls of floor, three casts with bounds of the data type server.
//
// Idea: below 2^51 nothing saturates and x has places for a half, so one
// truncation is enough. Round the magnitude m = |x| between cut = truncation of
// m and above = cut + 1; the rest m - cut decides (roundMagnitude). A negative
// x rounds the magnitude in the other direction.
//
// Example, FPS_RoundUp:
//   x             cut   rest          snaps       result
//   2.00000001    2     1e-8          to 2        2
//   2.25          2     0.25          no          3
//   2.9999999999  2     1 - 1e-10     to 3        3
//   -2.5          2     0.5           no          -2
//   1 - 2^-53     0     1 - 2^-53     to 1        2, because x + 1 rounds to 2
//
// Invariants:
//   1. m < 2^51, hence cut, above and rest are exact.
//   2. x snaps to the nearest integer n if 2^-26 max(1, |n|, m) > |n - m|.
//   3. On a tie the nearest integer is floor(x + 0.5): above for x > 0, cut for
//      x < 0.
//   4. A value that snaps upward takes the truncation of m + 1, also where the
//      sum rounds to the integer after next (last row of the example).
//
// Integer logarithms
// ------------------
// Problem: FPS_Log2(x) truncated or rounded, including the error of the divisor
// 0.69314718055995. Plain form: the logarithm.
//
// Idea: for x = m 2^k with m in [1, 2) the exponent k decides, unless m lies
// within kClearance of 1, of 2 or, for the rounded form, of the root of 2. Only
// values that close take the logarithm.
//
// Tests: OperationsGiveTheRecordedResults,
// LogarithmIsAlmostAlwaysCorrectlyRounded and, with rational numbers,
// SaturationAndRoundingMatchExactArithmetic.

#include "Math/FPS_FloatingPointSupport.h"

#include <algorithm>
#include <bit>
#include <cmath>

#include "Control/HX_SelfCheck.h"
#include "Math/implMath/HX_NaturalLog.h"
#include "platform/datatypes/DT_DataTypes.h"

namespace {

constexpr char kFpsErrorCode[] = __FILE__ "_";

constexpr int kUnsigned32 = 11;  // type codes of the data type server
constexpr int kSigned32 = 15;

constexpr double kDefaultTolerance = 0x1p-26;  // sqrt(2^-52)
constexpr double kShortLn2 = 0.69314718055995;
constexpr double kThirteenPlaces = 10000000000000.0;

double s_NaN = 0.0;
double s_PosInf = 0.0;
double s_NegInf = 0.0;
double s_Pi = 0.0;

// Makes a signalling NaN quiet on every machine, because the registers of the
// 32-bit convention do.
double returnSpecial(double x) { return x + x; }

bool areEqual(double a, double b) {
  return a == b || (std::isnan(a) && std::isnan(b));
}

bool areApproxEqual(double a, double b, double tolerance) {
  if (!std::isfinite(a) || !std::isfinite(b)) return areEqual(a, b);
  const double scale = std::max(1.0, std::max(std::fabs(a), std::fabs(b)));
  return tolerance * scale > std::fabs(a - b);
}

long long satCastToInt64(double x) {
  const int code = DT_GetINT64();
  if (!(x < 0.0)) {
    return DT_GetMax(code) > x ? static_cast<long long>(x)
                               : DT_GetMaxAsInt64(code);
  }
  return DT_GetMin(code) < x ? static_cast<long long>(x)
                             : DT_GetMinAsInt64(code);
}

// The truncation as a double, saturated at the 64-bit bounds.
double truncate(double x) { return static_cast<double>(satCastToInt64(x)); }

int satCastToInt(double x) {
  if (!(x < 0.0)) {
    return x < 2147483647.0 ? static_cast<int>(x) : 2147483647;
  }
  return x > -2147483648.0 ? static_cast<int>(x) : -2147483647 - 1;
}

// True if rounding never saturates and a half has a place (invariant 1); false
// for special values.
bool isModerate(double x) { return std::fabs(x) < 0x1p51; }

// Truncation of a moderate value; never -0.0.
double cutOff(double x) {
  return static_cast<double>(static_cast<long long>(x));
}

bool isNear(double x, double nearest) {
  const double scale =
      std::max(1.0, std::max(std::fabs(nearest), std::fabs(x)));
  return kDefaultTolerance * scale > std::fabs(nearest - x);
}

bool isIntegerValue(double x) {
  const double y = x + 0.5;
  if (!isModerate(x)) {
    return areApproxEqual(truncate(std::floor(y)), x, kDefaultTolerance);
  }
  const double cut = cutOff(y);
  return isNear(x, cut > y ? cut - 1.0 : cut);
}

// The integer for a value near an integer.
double snap(double x) {
  HX_Assert(isIntegerValue(x), kFpsErrorCode);
  const double nearest = std::floor(x + 0.5);
  if (x > 0.0) return truncate(nearest > x ? x + 1.0 : x);
  return truncate(nearest < x ? x - 1.0 : x);
}

// Rounds a moderate magnitude to an integer, with snapping. isNegative is the
// sign of the value and decides ties (invariant 3).
double roundMagnitude(double magnitude, bool isNegative, bool isUp) {
  const double cut = cutOff(magnitude);
  const double above = cut + 1.0;
  const double rest = magnitude - cut;
  const bool isBelowHalf = isNegative ? rest <= 0.5 : rest < 0.5;
  const bool isSnapped =
      isUp ? kDefaultTolerance > rest || kDefaultTolerance * magnitude > rest
           : kDefaultTolerance * above > above - magnitude;
  if (isUp ? isSnapped && isBelowHalf : !isSnapped || isBelowHalf) return cut;
  // Invariant 4.
  return magnitude + 1.0 < above + 1.0 ? above : above + 1.0;
}

double log2OfReal(double x) { return HX_NaturalLog(x) / kShortLn2; }

// A positive normal number split for the integer logarithms.
struct Split {
  int exponent;
  double mantissa;  // in [1, 2); 0 if the number is not positive and normal
};

Split split(double x) {
  const auto bits = std::bit_cast<std::uint64_t>(x);
  const auto exponent = static_cast<int>(bits >> 52);  // with the sign
  if (exponent < 1 || exponent > 2046) return {0, 0.0};
  constexpr std::uint64_t kFraction = (std::uint64_t{1} << 52) - 1;
  return {exponent - 1023, std::bit_cast<double>((bits & kFraction) |
                                                 std::uint64_t{1023} << 52)};
}

// Relative distance from powers of two (and from roots of powers) beyond which
// the exponent decides the integer logarithms. FPS_Log2 errs by less than
// 2^-36, 1024 times the relative error of the divisor; 2^-30 is 64 times more.
constexpr double kClearance = 0x1p-30;

bool isClearOfIntegers(double mantissa) {
  return mantissa > 1.0 + kClearance && mantissa < 2.0 - 2.0 * kClearance;
}

constexpr double kSqrt2 = 0x1.6a09e667f3bcdp+0;

bool isClearOfHalves(double mantissa) {
  return mantissa >= 1.0 && std::fabs(mantissa - kSqrt2) > 2.0 * kClearance;
}

bool isPowerOf2(double x, int& exponent) {
  const auto bits = std::bit_cast<std::uint64_t>(x);
  exponent = 0;
  if (x == 0.0 || bits << 12 != 0) return false;
  exponent = static_cast<int>(bits >> 52 & 0x7FF) - 1023;
  return true;
}

}  // namespace

void ModInit_FPS_FloatingPointSupport() {
  // The invalid operation gives the NaN.
  // cppcheck-suppress [invalidFunctionArg, wrongmathcall]
  s_NaN = std::fmod(1.0, 0.0);
  s_PosInf = HUGE_VAL;
  s_NegInf = -s_PosInf;
  s_Pi = std::atan(1.0) * 4.0;
  HX_Assert(std::isnan(s_NaN), kFpsErrorCode);
  HX_Assert(!std::isfinite(s_PosInf), kFpsErrorCode);
  HX_Assert(!std::isfinite(s_NegInf), kFpsErrorCode);
}

double FPS_GetFlNaN() { return s_NaN; }
double FPS_GetPosInf() { return s_PosInf; }
double FPS_GetNegInf() { return s_NegInf; }
double FPS_GetPi() { return s_Pi; }

bool FPS_CastFloatToBool(double x) { return x != 0.0; }

bool FPS_ValuesAreEqual(double a, double b) { return areEqual(a, b); }

bool FPS_ValuesAreApproxEqual(double a, double b, double tol) {
  return areApproxEqual(a, b, tol);
}

bool FPS_ValuesAreApproxEqual(double a, double b) {
  return areApproxEqual(a, b, kDefaultTolerance);
}

bool FPS_IsIntegerValue(double x) { return isIntegerValue(x); }

double FPS_RoundOffBits(double x, int bits) {
  if (!std::isfinite(x)) return returnSpecial(x);
  // More bits change nothing; the negated minimum of int would overflow.
  constexpr int kMostBits = 5000;
  const int places = std::clamp(bits, -kMostBits, kMostBits);
  int exponent = 0;
  const double mantissa = std::frexp(x, &exponent);
  const double rounded = std::floor(std::ldexp(mantissa, places) + 0.5);
  return std::ldexp(std::ldexp(rounded, -places), exponent);
}

double FPS_RoundOffDigits(double x) {
  if (!std::isfinite(x)) return returnSpecial(x);
  return std::floor(x * kThirteenPlaces + 0.5) / kThirteenPlaces;
}

int FPS_SatCastToInt(double x) { return satCastToInt(x); }

long long FPS_SatCastToInt64(double x) { return satCastToInt64(x); }

std::uint32_t FPS_SatCastToULong(double x) {
  if (!HX_Assert(!(x < 0.0), kFpsErrorCode) || DT_GetMax(kUnsigned32) > x) {
    return static_cast<std::uint32_t>(satCastToInt64(x));
  }
  return static_cast<std::uint32_t>(DT_GetMaxAsInt64(kUnsigned32));
}

double FPS_SatCutOffAfterPointDecimals(double x) { return truncate(x); }

bool FPS_Fits32Bit(double x, double& limit) {
  const bool isNegative = x < 0.0;
  const double bound =
      isNegative ? DT_GetMin(kSigned32) : DT_GetMax(kUnsigned32);
  if (!(isNegative ? bound > x : bound < x)) return true;
  limit = bound;
  return false;
}

bool FPS_ConvertSpecialValueToInteger(double x, double* out) {
  if (std::isfinite(x)) {
    *out = 0.0;
    return false;
  }
  *out = x < 0.0 ? DT_GetMin(DT_GetINT64()) : DT_GetMax(DT_GetINT64());
  return true;
}

double FPS_Round(double x) { return truncate(x < 0.0 ? x - 0.5 : x + 0.5); }

// A magnitude is subtracted from 0.0, because 0.0 - 0.0 is not -0.0.
double FPS_RoundUp(double x) {
  if (isModerate(x)) {
    return x < 0.0 ? 0.0 - roundMagnitude(-x, true, false)
                   : roundMagnitude(x, false, true);
  }
  if (isIntegerValue(x)) return snap(x);
  return truncate(x < 0.0 ? x : x + 1.0);
}

double FPS_RoundDown(double x) {
  if (isModerate(x)) {
    return x < 0.0 ? 0.0 - roundMagnitude(-x, true, true)
                   : roundMagnitude(x, false, false);
  }
  if (isIntegerValue(x)) return snap(x);
  return truncate(x < 0.0 ? x - 1.0 : x);
}

double FPS_SimulinkAlikeModulo(double x, double y) {
  if (y == 0.0) return std::isnan(x) ? returnSpecial(x) : x;
  return x - std::floor(x / y) * y;
}

double FPS_SimulinkAlikeRem(double x, double y) {
  if (y == 0.0) return 0.0;
  return x - truncate(x / y) * y;
}

double FPS_SimulinkAlikeSqrt(double x) {
  return x < 0.0 ? -std::sqrt(-x) : std::sqrt(x);
}

double FPS_ASinh(double x) { return HX_NaturalLog(x + std::sqrt(x * x + 1.0)); }

double FPS_ACosh(double x) { return HX_NaturalLog(x + std::sqrt(x * x - 1.0)); }

double FPS_ATanh(double x) {
  return 0.5 * HX_NaturalLog((x + 1.0) / (1.0 - x));
}

double FPS_Log2(double x) { return log2OfReal(x); }

double FPS_Log2(int n) { return log2OfReal(static_cast<double>(n)); }

int FPS_Log2Int(double x) {
  const Split parts = split(x);
  if (isClearOfIntegers(parts.mantissa)) {
    return parts.exponent + static_cast<int>(parts.exponent < 0);
  }
  return satCastToInt(log2OfReal(x));
}

int FPS_GetPowerOf2(double x) {
  const Split parts = split(x);
  if (isClearOfHalves(parts.mantissa)) {
    return parts.exponent + static_cast<int>(parts.mantissa > kSqrt2);
  }
  const double log = log2OfReal(x);
  return satCastToInt(log < 0.0 ? log - 0.5 : log + 0.5);
}

bool FPS_PowerOf2(double x, int* exponent) {
  int found = 0;
  const bool result = isPowerOf2(x, found);
  if (exponent != nullptr) *exponent = found;
  return result;
}

int FPS_GetGreaterPowerOf2(double x) {
  int exponent = 0;
  if (isPowerOf2(x, exponent)) return exponent;
  const Split parts = split(x);
  if (isClearOfIntegers(parts.mantissa)) return parts.exponent + 1;
  const double log = log2OfReal(x);
  return satCastToInt(log < 0.0 ? log : log + 1.0);
}

// NOLINTNEXTLINE(readability-non-const-parameter): callers pass double*
double FPS_FindGreatestCommonDivisor(double* pair) {
  double a = pair[0];
  double b = pair[1];
  for (;;) {
    HX_Assert(false, kFpsErrorCode);  // callers are to use the integer form
    if (b == 0.0) return std::isnan(a) ? returnSpecial(a) : a;
    if (std::isnan(b)) return returnSpecial(b);
    const double remainder = std::fmod(a, b);
    a = b;
    b = remainder;
  }
}

double FPS_FindLeastCommonMultiple(int n, double* values) {
  double multiple = values[0];
  for (int i = 1; i < n; ++i) {
    double pair[] = {multiple, values[i]};
    const double divisor = FPS_FindGreatestCommonDivisor(pair);
    multiple = multiple * values[i] / divisor;
  }
  return multiple;
}
