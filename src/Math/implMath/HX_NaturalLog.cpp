#include "Math/implMath/HX_NaturalLog.h"

#include <bit>
#include <cmath>
#include <cstdint>
#include <limits>

#include "Math/implMath/HX_NaturalLogTable.h"

namespace {

constexpr double kInfinity = std::numeric_limits<double>::infinity();
constexpr std::uint64_t kInfinityBits = std::uint64_t{0x7FF} << 52;
constexpr std::uint64_t kSmallestNormalBits = std::uint64_t{1} << 52;
// The reduced argument z lies in [0.6875, 1.375); this is its lower end.
constexpr std::uint64_t kLowestReducedBits = std::uint64_t{0x3FE6} << 48;

// ln(x) for zeros, negative values, infinity and NaN.
double logOutsideDomain(double x) {
  if (x == 0.0) return -kInfinity;
  if (x > 0.0 || std::isnan(x)) return x + x;
  return std::numeric_limits<double>::quiet_NaN();
}

// (1/3 - r/4 + r^2/5 - ... - r^7/10), the tail of the series of ln(1 + r).
double tailOfSeries(double r, double r2) {
  const double low = (1.0 / 3 - r * (1.0 / 4)) + r2 * (1.0 / 5 - r * (1.0 / 6));
  const double high =
      (1.0 / 7 - r * (1.0 / 8)) + r2 * (1.0 / 9 - r * (1.0 / 10));
  return low + r2 * r2 * high;
}

// ln of the positive finite number with the bits \p bits, times 2^\p exponent.
double logOfNormal(std::uint64_t bits, int exponent) {
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

  // All terms above 2^-24 are exact or carry their rounding error along.
  const double base = k * kLn2High + row.lnHigh;  // exact
  const double sum = base + rHigh;                // exact
  const double withLow = sum + rLow;
  const double lowError = rLow - (withLow - sum);
  const double square = 0.5 * rHigh * rHigh;  // exact
  const double high = withLow - square;
  const double squareError = (withLow - high) - square;

  const double r2 = r * r;
  const double r3 = r * r2;
  const double low = ((k * kLn2Low + row.lnLow) + (lowError + squareError) -
                      rLow * (rHigh + 0.5 * rLow)) +
                     r3 * tailOfSeries(r, r2);

  // Four times the sum of the rounding errors of low and of what the series
  // leaves out (r^11/11).
  const double error =
      std::fabs(r) * (r2 * 0x1p-51 + 0x1p-73) + std::fabs(base) * 0x1p-76;
  const double result = high + (low - error);
  if (result == high + (low + error)) [[likely]]
    return result;
  return HX_NaturalLogInFixedPoint(
      std::ldexp(std::bit_cast<double>(bits), exponent));
}

}  // namespace

double HX_NaturalLog(double x) {
  const std::uint64_t bits = std::bit_cast<std::uint64_t>(x);
  if (bits - kSmallestNormalBits < kInfinityBits - kSmallestNormalBits)
      [[likely]] {
    return logOfNormal(bits, 0);
  }
  if (!(x > 0.0 && x < kInfinity)) return logOutsideDomain(x);
  return logOfNormal(std::bit_cast<std::uint64_t>(x * 0x1p52), -52);
}
