#include "Math/implMath/HX_NaturalLog.h"

#include <cmath>
#include <limits>

namespace hx_detail {

double logNearOne(double x, std::uint64_t offset) {
  const HX_NaturalLogRowNearOne& row =
      kNaturalLogRowsNearOne[offset / kIntervalNearOne];
  const auto centre =
      std::bit_cast<double>(std::bit_cast<std::uint64_t>(x) -
                            offset % kIntervalNearOne + kIntervalNearOne / 2);

  // As in logFarFromOne(), but q is exact, and low carries the error of the sum
  // (invariant 3).
  const double q = (x - centre) * row.reciprocal;
  const double high = row.lnHigh + q;
  const double low = row.lnLow + (q - (high - row.lnHigh));
  const double r = q + row.rest;
  const double r2 = r * r;
  // |r| <= 1.01 / 2^9, the error below 2^-61 of ln(1 + r)
  const double tail = (-1.0 / 2 + r * 0x1.5555555551659p-2) +
                      r2 * ((-0x1.fffffffff44a3p-3 + r * 0x1.9999ff6b2fe0fp-3) +
                            r2 * -0x1.5555c42c929e3p-3);
  return high + (low + r2 * tail);
}

double logOfRareArgument(double x) {
  constexpr double kInfinity = std::numeric_limits<double>::infinity();
  if (x == 0.0) return -kInfinity;
  if (std::isnan(x) || x == kInfinity) return x + x;
  if (x < 0.0) return std::numeric_limits<double>::quiet_NaN();

  const bool isSubnormal = x < std::numeric_limits<double>::min();
  const auto bits = std::bit_cast<std::uint64_t>(isSubnormal ? x * 0x1p52 : x);
  const int exponent = static_cast<int>(bits >> 52) - 1023;
  return logFarFromOne(bits, ln2Times(isSubnormal ? exponent - 52 : exponent));
}

}  // namespace hx_detail
