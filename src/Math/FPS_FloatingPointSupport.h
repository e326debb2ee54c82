// Arithmetic on doubles as the simulation does it: tolerant comparison,
// rounding, saturating conversion, modulo, logarithms, powers of two, divisors.
//
//   ModInit_FPS_FloatingPointSupport();                   // once, by the host
//   if (FPS_IsIntegerValue(period / base)) {
//     const long long count = FPS_SatCastToInt64(FPS_Round(period / base));
//   }
//
// Values are IEEE 754 binary64. "Special" means not finite: NaN, +Inf, -Inf.
// Truncation means toward zero. Every result is the same, bit for bit, on every
// machine, compiler and word length; only sign and payload of a NaN are open,
// and a signalling NaN comes back quiet. The rounding mode must be to nearest,
// as the library sets it when it is loaded (on 32-bit x86 it also sets the
// precision of the floating-point unit to 53 bits).
//
// NaN:
//   comparisons, FPS_ConvertSpecialValueToInteger   accept NaN, see below
//   casts, and roundings that end in a cast         take NaN as a large value
//   other operations with a double as result        return NaN
// No operation faults or loops for any argument.
//
// The bounds of integers are those of the data type server. No operation
// reports an error, apart from the internal assertions that are named.

#ifndef MATH_FPS_FLOATINGPOINTSUPPORT_H
#define MATH_FPS_FLOATINGPOINTSUPPORT_H

#include <cstdint>

#include "HX_Export.h"

/// Sets the four values below; may be called again. Asserts that the NaN is a
/// NaN and that the infinities are not finite.
HX_UTILS_API void ModInit_FPS_FloatingPointSupport();

/// A quiet NaN, the infinities and pi; 0.0 before the initialisation.
HX_UTILS_API double FPS_GetFlNaN();
HX_UTILS_API double FPS_GetPosInf();
HX_UTILS_API double FPS_GetNegInf();
HX_UTILS_API double FPS_GetPi();

// --- Comparison --------------------------------------------------------------

/// False for 0.0 and -0.0, true for everything else, NaN included.
HX_UTILS_API bool FPS_CastFloatToBool(double x);

/// a == b, and NaN equals NaN. An infinity equals only itself; 0.0 and -0.0
/// are equal.
HX_UTILS_API bool FPS_ValuesAreEqual(double a, double b);

/// True if |a - b| is strictly below tol * max(1, |a|, |b|): the tolerance is
/// absolute up to magnitude 1 and relative above. Special values as in
/// FPS_ValuesAreEqual, whatever the tolerance; a tolerance of 0 or NaN makes no
/// two finite values equal.
HX_UTILS_API bool FPS_ValuesAreApproxEqual(double a, double b, double tol);

/// The same with the tolerance 2^-26, the square root of the double epsilon.
HX_UTILS_API bool FPS_ValuesAreApproxEqual(double a, double b);

/// True if \p x is approximately equal, with the tolerance 2^-26, to the
/// nearest integer of 64 bits.
///
/// | |x|                       | result |
/// |---------------------------|-----------------------------------------------|
/// | [0, 2^25]                 | true near an integer | | (2^25, 2^63) | true:
/// half a unit is within the tolerance     | | [2^63, 2^63 (1 + 2^-26))  |
/// true: within the tolerance of the largest one | | above, special values |
/// false                                         |
HX_UTILS_API bool FPS_IsIntegerValue(double x);

// --- Rounding to a number of places ------------------------------------------

/// \p x with its mantissa rounded to \p bits bits, ties upward (also below 0).
///
/// With 53 bits an odd mantissa already counts as a tie and moves up, with more
/// nothing changes; more than 1024 give an infinity of the sign of \p x.
/// 0 bits leave 0 or a power of two, fewer leave 0. Special values are returned
/// unchanged; -0.0 gives 0.0.
HX_UTILS_API double FPS_RoundOffBits(double x, int bits);

/// \p x rounded to 13 decimal places, ties upward. Special values are returned
/// unchanged; above about 1.8e295 the scaled value overflows and the result is
/// infinite. From magnitude 450 on a double has no 13 places: the last bit may
/// change.
HX_UTILS_API double FPS_RoundOffDigits(double x);

// --- Conversion to integers --------------------------------------------------

/// Truncates; the result saturates at the bounds of a 32-bit integer.
HX_UTILS_API int FPS_SatCastToInt(double x);

/// Truncates; the result saturates at the bounds of a 64-bit integer. Every
/// value from 2^63 on gives 9223372036854775807.
HX_UTILS_API long long FPS_SatCastToInt64(double x);

/// Truncates; the result saturates at 4294967295. A negative \p x, even one
/// that truncates to 0, raises an internal assertion and gives the low 32 bits
/// of its 64-bit truncation (0 below -2^63).
HX_UTILS_API std::uint32_t FPS_SatCastToULong(double x);

/// Truncates, as a double; the result saturates at -2^63 and 2^63. Never -0.0.
HX_UTILS_API double FPS_SatCutOffAfterPointDecimals(double x);

/// True if \p x lies in the range of a 32-bit integer, signed or unsigned.
///
/// The range is closed: [-2147483648, 4294967295]; fractions are allowed. NaN
/// violates neither bound and gives true.
/// \param[out] limit  the violated bound; written only when the result is
/// false.
HX_UTILS_API bool FPS_Fits32Bit(double x, double& limit);

/// True if \p x is special; \p out is then 2^63 for +Inf and NaN and -2^63 for
/// -Inf. Otherwise \p out is 0.0, not \p x.
HX_UTILS_API bool FPS_ConvertSpecialValueToInteger(double x, double* out);

// --- Rounding to integers ----------------------------------------------------

/// Rounds half away from zero; saturates as FPS_SatCutOffAfterPointDecimals.
/// The half is added in double: 0.49999999999999994 gives 1, and from 2^52 on
/// an odd value may move to its even neighbour.
HX_UTILS_API double FPS_Round(double x);

/// Ceiling and floor, but a value for which FPS_IsIntegerValue holds snaps to
/// the nearest integer above or below; from magnitude 2^25 on every value
/// snaps. Just below a power of two the sum of value and 1 rounds, and the
/// result is 1 too far: 1 - 2^-53 gives 2. The result saturates at -2^63 and
/// 2^63, also for the infinities.
HX_UTILS_API double FPS_RoundUp(double x);
HX_UTILS_API double FPS_RoundDown(double x);

// --- Arithmetic of the simulation --------------------------------------------

/// x - floor(x / y) * y, with the sign of \p y; \p x if \p y is 0. Quotient and
/// product are rounded: the result may miss the exact remainder, may reach \p
/// y, and just below a multiple of \p y may be tiny with the opposite sign.
HX_UTILS_API double FPS_SimulinkAlikeModulo(double x, double y);

/// x - t * y with t = x / y truncated and saturated to 64 bits, with the sign
/// of \p x, rounded as above; 0.0 if \p y is 0. A quotient beyond 2^63 leaves a
/// large remainder.
HX_UTILS_API double FPS_SimulinkAlikeRem(double x, double y);

/// The square root of |x| with the sign of \p x.
HX_UTILS_API double FPS_SimulinkAlikeSqrt(double x);

/// ln(x + sqrt(x^2 + 1)), ln(x + sqrt(x^2 - 1)) and 0.5 ln((x + 1) / (1 - x)),
/// as these formulas round: the area sine loses all digits for large negative
/// values (-Inf at about -6.7e7) and all three near their zero.
HX_UTILS_API double FPS_ASinh(double x);
HX_UTILS_API double FPS_ACosh(double x);
HX_UTILS_API double FPS_ATanh(double x);

// --- Powers of two -----------------------------------------------------------

/// ln(x) / 0.69314718055995. The divisor is a little larger than ln 2, so
/// every result is too near to 0, by 7e-15 of its value: FPS_Log2(8.0) is
/// 2.9999999999999796.
///
/// The logarithm is the library's own, because the logarithms of run-times
/// differ in the last bit. Error: below 0.51 units in the last place. -Inf for
/// 0, NaN below 0.
HX_UTILS_API double FPS_Log2(double x);
HX_UTILS_API double FPS_Log2(int n);

/// FPS_Log2(x) truncated. Because of the divisor the result is 1 too near to 0
/// for every power of two but 1, and just beyond the power: FPS_Log2Int(8.0) is
/// 2, FPS_Log2Int(0.25) is -1.
///
/// -2147483648 for 0, 2147483647 for +Inf and where the logarithm is a NaN.
HX_UTILS_API int FPS_Log2Int(double x);

/// FPS_Log2(x) rounded half away from zero, with the bounds of FPS_Log2Int.
HX_UTILS_API int FPS_GetPowerOf2(double x);

/// True if the 52 fraction bits of \p x are 0 and \p x is not 0.
///
/// Looks at the bits alone: the sign does not matter, an infinity is a power
/// with the exponent 1024, a value below 2^-1022 is no power.
/// \param[out] exponent  the exponent, 0 if the result is false; may be null.
HX_UTILS_API bool FPS_PowerOf2(double x, int* exponent);

/// The exponent of the smallest power of two not below \p x; that of |x| for a
/// negative power.
///
/// For all other values the result comes from FPS_Log2. The error of FPS_Log2
/// makes the result 1 too small just above the powers 2, 4, 8, ..., and 1 too
/// large just below the powers 1/2, 1/4, ... For 0 and negative values that are
/// no powers as FPS_Log2Int.
HX_UTILS_API int FPS_GetGreaterPowerOf2(double x);

// --- Divisors and multiples --------------------------------------------------

/// Euclid's algorithm with fmod on the two values of \p pair; the values stay
/// unchanged. Exact, without tolerance; the sign follows the remainders. NaN if
/// a remainder is NaN (NaN or an infinity in the pair).
///
/// Raises an internal assertion in every call and again in every step: message
/// 7 with this source file. IMS_FindGreatestCommonDivisor does not.
HX_UTILS_API double FPS_FindGreatestCommonDivisor(double* pair);

/// The least common multiple of \p n values; the values stay unchanged. No
/// check of overflow; NaN if all values are 0. Raises the assertions of
/// FPS_FindGreatestCommonDivisor.
/// REQUIRES: \p n is at least 2.
HX_UTILS_API double FPS_FindLeastCommonMultiple(int n, double* values);

#endif  // MATH_FPS_FLOATINGPOINTSUPPORT_H
