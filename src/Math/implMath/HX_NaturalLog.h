// The natural logarithm of this library: the same bits on every machine.
//
// The logarithms of C run-times differ in the last bit from each other, and one
// run-time's from itself on another processor. This one is a fixed sequence of
// additions and multiplications of doubles, which IEEE 754 rounds in one way
// only. It carries enough of the rounding errors along to be correctly rounded
// for nearly all arguments, as a good run-time is.
//
// Method: P. T. P. Tang, "Table-driven implementation of the logarithm function
// in IEEE floating-point arithmetic", ACM TOMS 16 (1990).

#ifndef MATH_IMPLMATH_HX_NATURALLOG_H
#define MATH_IMPLMATH_HX_NATURALLOG_H

#include <bit>
#include <cmath>
#include <cstdint>
#include <limits>

#include "Math/implMath/HX_NaturalLogTable.h"

namespace hx_detail {

inline constexpr double kInfinity = std::numeric_limits<double>::infinity();
inline constexpr std::uint64_t kInfinityBits = std::uint64_t{0x7FF} << 52;
inline constexpr std::uint64_t kSmallestNormalBits = std::uint64_t{1} << 52;
// The reduced argument z lies in [0.6875, 1.375); this is its lower end.
inline constexpr std::uint64_t kLowestReducedBits = std::uint64_t{0x3FE6} << 48;

// ln(x) for zeros, negative values, infinity and NaN.
inline double logOutsideDomain(double x) {
  if (x == 0.0) return -kInfinity;
  if (x > 0.0 || std::isnan(x)) return x + x;
  return std::numeric_limits<double>::quiet_NaN();
}

// (ln(1 + r) - r) / r^2 = -1/2 + r/3 - r^2/4 + ... ; the first term left out is
// below 2^-66 of ln(1 + r).
inline double tailOfSeries(double r, double r2) {
#if defined(__GNUC__)  // the two halves side by side in one register
  using Pair = double __attribute__((vector_size(16)));
  const Pair halves =
      (Pair{-1.0 / 2, -1.0 / 6} + r * Pair{1.0 / 3, 1.0 / 7}) +
      r2 * (Pair{-1.0 / 4, -1.0 / 8} + r * Pair{1.0 / 5, 1.0 / 9});
  const double low = halves[0];
  const double high = halves[1];
#else
  const double low =
      (-1.0 / 2 + r * (1.0 / 3)) + r2 * (-1.0 / 4 + r * (1.0 / 5));
  const double high =
      (-1.0 / 6 + r * (1.0 / 7)) + r2 * (-1.0 / 8 + r * (1.0 / 9));
#endif
  return low + r2 * r2 * high;
}

// ln of the positive finite number with the bits \p bits, times 2^\p exponent.
inline double logOfNormal(std::uint64_t bits, int exponent) {
  const std::uint64_t offset = bits - kLowestReducedBits;
  const HX_NaturalLogRow& row = kNaturalLogRows[(offset >> 45) & 127];
  const double k =
      exponent + static_cast<int>(static_cast<std::int64_t>(offset) >> 52);
  const std::uint64_t zBits = bits - (offset & (std::uint64_t{0xFFF} << 52));

  // ln(x) = k ln(2) - ln(reciprocal) + ln(1 + r), r = z * reciprocal - 1, with
  // |r| <= 2^-7. Both parts of r are exact: 24 and 29 bits of z times 10. The
  // high part is rounded, so that it is at most 2 |r|.
  constexpr std::uint64_t kHalfOfHigh = std::uint64_t{1} << 28;
  const double z = std::bit_cast<double>(zBits);
  const double zHigh = std::bit_cast<double>((zBits + kHalfOfHigh) >> 29 << 29);
  const double rHigh = zHigh * row.reciprocal - 1.0;
  const double rLow = (z - zHigh) * row.reciprocal;
  const double r = rHigh + rLow;

  // The sum is exact but for its last step, whose error is carried along.
  const double sum = (k * kLn2High + row.lnHigh) + rHigh;
  const double high = sum + rLow;
  const double lowError = rLow - (high - sum);
  const double r2 = r * r;
  return high +
         (((k * kLn2Low + row.lnLow) + lowError) + r2 * tailOfSeries(r, r2));
}

}  // namespace hx_detail

/// ln(x), with an error below 0.51 units in the last place. Minus infinity for
/// both zeros, a NaN below zero and for a NaN, infinity for infinity. Leaves
/// errno alone. Needs round-to-nearest.
inline double HX_NaturalLog(double x) {
  const std::uint64_t bits = std::bit_cast<std::uint64_t>(x);
  if (bits - hx_detail::kSmallestNormalBits <
      hx_detail::kInfinityBits - hx_detail::kSmallestNormalBits) [[likely]] {
    return hx_detail::logOfNormal(bits, 0);
  }
  if (!(x > 0.0 && x < hx_detail::kInfinity))
    return hx_detail::logOutsideDomain(x);
  return hx_detail::logOfNormal(std::bit_cast<std::uint64_t>(x * 0x1p52), -52);
}

#endif  // MATH_IMPLMATH_HX_NATURALLOG_H
