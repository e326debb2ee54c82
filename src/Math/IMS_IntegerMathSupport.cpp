// Divisors, multiples and ranges of 64-bit integers.
//
// Greatest common divisor
// -----------------------
// Problem: the last divisor of Euclid's algorithm, signs included. Plain form:
// while (b != 0) { rest = a % b; a = b; b = rest; }. COST: one 64-bit division
// per step, up to 90 steps.
//
// Idea (J. Stein, "Computational problems associated with Racah algebra", J.
// Comp. Phys. 1, 1967): factors of two are counted apart; the difference of two
// odd numbers is even, so a step is a subtraction and a shift.
//
// Example, 48 and 18: common factor 2, odd parts 3 and 9
//   9 - 3 = 6, without factors of two 3;   3 and 3: equal, result 3 * 2 = 6
//
// Invariants:
//   1. Both operands of a step are odd and keep the odd common divisor.
//   2. Operands of one sign: Euclid's result has the same sign and the
//   magnitude
//      of the binary algorithm. Operands of two signs take the plain form,
//      because the number of steps decides the sign.
//
// Test: DivisorsMatchThePlainRemainders.

#include "Math/IMS_IntegerMathSupport.h"

#include <algorithm>
#include <bit>
#include <cmath>
#include <limits>
#include <utility>

#include "Control/HX_ExportInline.h"
#include "Math/FPS_FloatingPointSupport.h"
#include "platform/datatypes/HX_NumericalType.h"
#include "platform/datatypes/HX_TypeSupport.h"

namespace {

using hx_detail::oddGcdBySubtraction;
using hx_detail::withoutTrailingZeros;
using Unsigned = unsigned long long;
constexpr long long kSmallest = std::numeric_limits<long long>::min();
constexpr long long kLargest = std::numeric_limits<long long>::max();

// Without the trap of the smallest value divided by -1.
long long remainder(long long a, long long b) { return b == -1 ? 0 : a % b; }

// The product may have wrapped to the smallest value.
long long wrappedQuotient(Unsigned product, long long divisor) {
  if (divisor == -1) return static_cast<long long>(0 - product);
  return static_cast<long long>(product) / divisor;
}

Unsigned magnitude(long long v) {
  return v < 0 ? 0 - static_cast<Unsigned>(v) : static_cast<Unsigned>(v);
}

// Both odd. For operands in random order, one division removes more bits than
// the subtractions of the same time.
Unsigned oddGcdByDivision(Unsigned a, Unsigned b) {
  if (a < b) std::swap(a, b);
  while (b > 1) {
    const Unsigned rest = a % b;
    if (rest == 0) return b;
    const Unsigned x = withoutTrailingZeros(rest);
    const Unsigned y = withoutTrailingZeros(b - rest);
    a = std::max(x, y);
    b = std::min(x, y);
  }
  return b;
}

// REQUIRES: both above 0. For operands beyond the inline part.
Unsigned binaryGcd(Unsigned a, Unsigned b) {
  constexpr int kSizeGapBits = 6;  // from here a division replaces many steps
  constexpr int kLargeBits = 60;   // from here the order of operands is random
  const int shift = std::countr_zero(a | b);
  const Unsigned x = withoutTrailingZeros(a);
  const Unsigned y = withoutTrailingZeros(b);
  const Unsigned high = std::max(x, y);
  const Unsigned low = std::min(x, y);
  if (low >> kLargeBits != 0) return oddGcdByDivision(high, low) << shift;
  if (high >> kSizeGapBits <= low) return oddGcdBySubtraction(x, y) << shift;
  const Unsigned rest = high % low;
  if (rest == 0) return low << shift;
  return oddGcdBySubtraction(withoutTrailingZeros(rest), low) << shift;
}

// 2^exponent; 0 or infinity beyond the range of a double.
double powerOf2(int exponent) { return std::ldexp(1.0, exponent); }

}  // namespace

template struct HX_ExportInline<
    &IMS_FindGreatestCommonDivisor, static_cast<int (*)(unsigned)>(&IMS_Log2),
    static_cast<int (*)(int)>(&IMS_Log2), static_cast<int (*)(long)>(&IMS_Log2),
    static_cast<int (*)(long long)>(&IMS_Log2)>;

long long hx_detail::gcdOfAny(long long a, long long b) {
  if (a == 0) return b;
  if (b == 0) return a;
  if ((a < 0) == (b < 0)) {
    const Unsigned divisor = binaryGcd(magnitude(a), magnitude(b));
    return static_cast<long long>(a < 0 ? 0 - divisor : divisor);
  }
  while (b != 0) {
    const long long rest = remainder(a, b);
    a = b;
    b = rest;
  }
  return a;
}

long long IMS_AbsInt64(long long v) {
  if (v == kSmallest) return kLargest;
  return v < 0 ? -v : v;
}

bool IMS_FitsInt32(long long v) {
  return v >= -2147483648LL && v <= 2147483647LL;
}

bool IMS_FitsUInt32(long long v) { return v >= 0 && v <= 4294967295LL; }

bool IMS_Fits32Bit(long long v) {
  return IMS_FitsInt32(v) || IMS_FitsUInt32(v);
}

long long IMS_GetLower32Bit(long long v) { return v & 4294967295LL; }

long long IMS_GetUpper32Bit(long long v) { return v >> 32; }

bool IMS_IsEven(long long v) { return (v & 1) == 0; }

long long IMS_RoundDouble(double x) {
  if (FPS_ValuesAreEqual(x, 0.0)) return 0;
  return FPS_SatCastToInt64(x > 0.0 ? x + 0.5 : x - 0.5);
}

std::uint32_t IMS_RoundDoubleToULong(double x) {
  return static_cast<std::uint32_t>(IMS_RoundDouble(x));
}

long long IMS_SimulinkAlikeSqrt(long long v) {
  return FPS_SatCastToInt64(FPS_SimulinkAlikeSqrt(static_cast<double>(v)));
}

// NOLINTNEXTLINE(readability-non-const-parameter): callers pass long long*
long long IMS_FindLeastCommonMultiple(int n, long long* values, double limit) {
  const double product =
      static_cast<double>(values[0]) * static_cast<double>(values[1]);
  if (!(std::fabs(product) < 0x1p63)) return 0;

  long long multiple = values[0];
  for (int i = 1; i < n; ++i) {
    const long long value = values[i];
    if (multiple == 0 || value == 0) return 0;
    long long pair[] = {multiple, value};
    const long long divisor = IMS_FindGreatestCommonDivisor(pair);
    if (divisor == value && remainder(value, multiple) != 0) return 0;
    multiple = wrappedQuotient(
        static_cast<Unsigned>(multiple) * static_cast<Unsigned>(value),
        divisor);
    if (static_cast<double>(multiple) > limit) return 0;
  }
  return multiple;
}

long long IMS_ShrinkValueToBaseType(long long v, HX_NumericalType* type) {
  const auto asDouble = static_cast<double>(v);
  if (!(asDouble > type->getMaximum()) && !(asDouble < type->getMinimum())) {
    return v;
  }
  const int width = type->getBitWidth();
  if (width > 32) return v;
  if (width < 1) return 0;

  const Unsigned mask = (Unsigned{1} << width) - 1;
  Unsigned masked = static_cast<Unsigned>(v) & mask;
  const bool isSignSet = (masked >> (width - 1) & 1) != 0;
  if (HX_TypeSupport::findHighestBitSetInInt64Value(v) > 7 &&
      type->isSigned() && isSignSet) {
    masked |= ~mask;
  }
  return static_cast<long long>(masked);
}

bool IMS_ValueMatchesSignednessAndWidth(double x, bool isSigned, int width) {
  // Powers beyond are 0 or infinite; the minimum of int less 1 would overflow.
  const int bits = std::clamp(width, -5000, 5000);
  if (!isSigned) return !(x > powerOf2(bits) - 1.0);
  if (x < 0.0) return !(std::fabs(x) > powerOf2(bits - 1));
  return !(x > powerOf2(bits - 1) - 1.0);
}
