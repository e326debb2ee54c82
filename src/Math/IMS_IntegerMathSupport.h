// Arithmetic on 64-bit integers as the simulation does it: the counterparts of
// FPS_FloatingPointSupport.
//
//   long long rates[] = {48000, 44100};
//   IMS_FindGreatestCommonDivisor(rates);                // 300
//   IMS_FindLeastCommonMultiple(2, rates, 1e9);          // 7056000
//   IMS_FindLeastCommonMultiple(2, rates, 1e6);          // 0: above the limit
//
// No operation reports anything or faults for any argument. IMS_Log2 is part of
// the module and comes with this header.

#ifndef MATH_IMS_INTEGERMATHSUPPORT_H
#define MATH_IMS_INTEGERMATHSUPPORT_H

#include <bit>
#include <cstdint>

#include "HX_Export.h"
#include "Math/IMS_Log2.h"

class HX_NumericalType;

namespace hx_detail {

template <class Unsigned>
constexpr Unsigned withoutTrailingZeros(Unsigned v) {
  return v >> std::countr_zero(v);
}

// Both odd. Branches on the order of a and b, because the processor learns the
// order; a step is then a subtraction and a shift.
template <class Unsigned>
constexpr Unsigned oddGcdBySubtraction(Unsigned a, Unsigned b) {
  while (a != b) {
    if (a > b) {
      a = withoutTrailingZeros(a - b);
    } else {
      b = withoutTrailingZeros(b - a);
    }
  }
  return a;
}

HX_UTILS_API long long gcdOfAny(long long a, long long b);

}  // namespace hx_detail

/// |v|; the smallest value saturates to 9223372036854775807.
HX_UTILS_API long long IMS_AbsInt64(long long v);

/// True if \p v is in [-2^31, 2^31 - 1], in [0, 2^32 - 1], in [-2^31, 2^32 -
/// 1].
HX_UTILS_API bool IMS_FitsInt32(long long v);
HX_UTILS_API bool IMS_FitsUInt32(long long v);
HX_UTILS_API bool IMS_Fits32Bit(long long v);

/// The low word, never negative, and the high word, with the sign of \p v:
/// v == upper * 2^32 + lower.
HX_UTILS_API long long IMS_GetLower32Bit(long long v);
HX_UTILS_API long long IMS_GetUpper32Bit(long long v);

/// True for 0 and for negative even values too.
HX_UTILS_API bool IMS_IsEven(long long v);

/// Rounds half away from zero; saturates at the bounds of the type. NaN gives
/// the largest value. The half is added in double, as in FPS_Round.
HX_UTILS_API long long IMS_RoundDouble(double x);

/// The low 32 bits of IMS_RoundDouble(x): wraps, does not saturate.
HX_UTILS_API std::uint32_t IMS_RoundDoubleToULong(double x);

/// The square root of |v|, truncated, with the sign of \p v. Computed in
/// double: above 2^52 the result is 1 too large for some values just below a
/// square.
HX_UTILS_API long long IMS_SimulinkAlikeSqrt(long long v);

/// The last divisor of Euclid's algorithm with truncating division on the two
/// values of \p pair; the values stay unchanged.
///
/// (a, 0) gives a. No absolute value is taken: for operands of equal sign the
/// result has the same sign, for operands of different signs the number of
/// steps decides the sign. The smallest value is divided like any other value,
/// also by -1. COST: about one subtraction per bit for operands of equal sign,
/// by the binary algorithm of J. Stein (J. Comp. Phys. 1, 1967).
// NOLINTNEXTLINE(readability-non-const-parameter): callers pass long long*
HX_UTILS_INLINE_API inline long long IMS_FindGreatestCommonDivisor(
    long long* pair) {
  const auto a = static_cast<unsigned long long>(pair[0]);
  const auto b = static_cast<unsigned long long>(pair[1]);
  // One test for the sign, for 0 and for the size: 1 to 2^32.
  if (((a - 1) | (b - 1)) >> 32 != 0) {
    return hx_detail::gcdOfAny(pair[0], pair[1]);
  }
  const std::uint64_t divisor = hx_detail::oddGcdBySubtraction(
      static_cast<std::uint32_t>(hx_detail::withoutTrailingZeros(a)),
      static_cast<std::uint32_t>(hx_detail::withoutTrailingZeros(b)));
  const std::uint64_t result = divisor << std::countr_zero(a | b);
  return static_cast<long long>(result);
}

/// RETURNS: the least common multiple of \p n values, or 0 if one of these
/// holds:
///   - the multiple is above \p limit (NaN limits nothing; a negative multiple
///     is never above a positive limit);
///   - the product of the first two values reaches 2^63 in magnitude, computed
///     in double;
///   - a value after the first is a proper divisor of the multiple of the
///   values
///     before: 3, 6 gives 6, but 6, 3 gives 0;
///   - a value is 0.
/// Products after the first are not checked and wrap to 64 bits.
/// REQUIRES: \p n is at least 2.
HX_UTILS_API long long IMS_FindLeastCommonMultiple(int n, long long* values,
                                                   double limit);

/// \p v wrapped into the range of \p type: 40000 becomes -25536 in a signed
/// 16-bit type.
///
/// A value in the range, compared in double, stays unchanged, and every value
/// if the type has more than 32 bits. A type of less than one bit gives 0. A
/// value in [0, 127] is cut, but never becomes negative: in a signed 4-bit type
/// 124 wraps to 12, and 140 to -4.
HX_UTILS_API long long IMS_ShrinkValueToBaseType(long long v,
                                                 HX_NumericalType* type);

/// True if \p x is not above the range of an integer with that signedness and
/// bit width; fractions are allowed, and NaN is above no range.
///
/// An unsigned range has no lower bound here: negative values pass. Bounds are
/// doubles and from 54 bits on rounded up: 2^63 passes for a signed 64-bit
/// type.
HX_UTILS_API bool IMS_ValueMatchesSignednessAndWidth(double x, bool isSigned,
                                                     int width);

#endif  // MATH_IMS_INTEGERMATHSUPPORT_H
