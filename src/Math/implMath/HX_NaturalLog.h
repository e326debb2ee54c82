// The natural logarithm of this library: the same bits on every machine.
//
// The logarithms of C run-times differ in the last bit from each other, and one
// run-time's from itself on another processor. This one is a fixed sequence of
// additions and multiplications of doubles, which IEEE 754 rounds in one way
// only. It is correctly rounded for nearly all arguments, as a good run-time's
// is.
//
// Method: P. T. P. Tang, "Table-driven implementation of the logarithm function
// in IEEE floating-point arithmetic", ACM TOMS 16 (1990). What limits the speed
// is the number of operations on doubles that wait for the argument, more than
// their order; so the multiples of ln 2 come from a table as well, and the
// arguments near 1, which need more digits, have a sequence of their own.

#ifndef MATH_IMPLMATH_HX_NATURALLOG_H
#define MATH_IMPLMATH_HX_NATURALLOG_H

#include <array>
#include <bit>
#include <cstddef>
#include <cstdint>
#include <iterator>

#include "Math/implMath/HX_NaturalLogTable.h"

namespace hx_detail {

/// ln of any double outside the range of HX_NaturalLog's inline part.
double logOfRareArgument(double x);

/// ln of a value with an offset below kWidthNearOne.
double logNearOne(double x, std::uint64_t offset);

// k ln(2). The high part is exact, for k below 2^11.
struct Ln2Multiple {
  double high;
  double low;
};

constexpr Ln2Multiple ln2Times(int k) { return {k * kLn2High, k * kLn2Low}; }

// The arguments in [2^-64, 2^64) take theirs from a table.
inline constexpr int kTabulatedExponents = 64;
inline constexpr auto kLn2Multiples = [] {
  std::array<Ln2Multiple, std::size_t{2} * kTabulatedExponents> table{};
  int k = -kTabulatedExponents;
  for (Ln2Multiple& multiple : table) multiple = ln2Times(k++);
  return table;
}();

// A normal number is z 2^k: z in [1, 2) and the row of its interval.
struct Mantissa {
  double z;
  const HX_NaturalLogRow& row;
};

inline Mantissa mantissaOf(std::uint64_t bits) {
  constexpr std::uint64_t kOne = std::uint64_t{1023} << 52;
  const std::uint64_t fraction = bits & ((std::uint64_t{1} << 52) - 1);
  return {std::bit_cast<double>(kOne | fraction),
          kNaturalLogRows[fraction >> 43]};
}

// ln of the positive normal number with the bits \p bits, not near 1. Its parts
// after the first sum are below 2^-9, so their errors stay below 0.01 units in
// the last place of a logarithm beyond 1/8.
inline double logFarFromOne(std::uint64_t bits, const Ln2Multiple& k) {
  // ln(x) = k ln(2) + ln(centre) + ln(1 + r), r = (z - centre) / centre, with
  // |r| <= 1.02 / 2^10; the first sum is exact.
  const auto [z, row] = mantissaOf(bits);
  const double r = (z - row.centre) * row.reciprocal;
  const double r2 = r * r;
  // r - r^2/2 + r^3/3 - ..., moved to an error below 2^-64
  const double tail = (-1.0 / 2 + r * 0x1.5555555554fe2p-2) +
                      r2 * (-0x1.0000098982d54p-2 + r * 0x1.9999b6c8a2c8dp-3);
  return (k.high + row.lnHigh) + (r + ((k.low + row.lnLow) + r2 * tail));
}

// What is near one: the intervals of the second table. Offsets, the differences
// between the bits of two doubles, pass 1 without a gap; there their unit
// doubles.
inline constexpr std::uint64_t kIntervalNearOne = std::uint64_t{1} << 44;
inline constexpr std::uint64_t kWidthNearOne =
    std::size(kNaturalLogRowsNearOne) * kIntervalNearOne;
inline constexpr auto kLowestNearOne = std::bit_cast<std::uint64_t>(1.0) -
                                       60 * kIntervalNearOne -
                                       kIntervalNearOne / 2;

}  // namespace hx_detail

/// ln(x), with an error below 0.51 units in the last place. Minus infinity for
/// both zeros, a NaN below zero and for a NaN, infinity for infinity. Leaves
/// errno alone. Needs round-to-nearest.
inline double HX_NaturalLog(double x) {
  using namespace hx_detail;
  const auto bits = std::bit_cast<std::uint64_t>(x);
  const std::uint64_t offset = bits - kLowestNearOne;
  if (offset < kWidthNearOne) return logNearOne(x, offset);
  // Sign and exponent; a set sign makes it too large.
  const auto exponent =
      static_cast<std::size_t>(bits >> 52) - (1023 - kTabulatedExponents);
  if (exponent < kLn2Multiples.size()) [[likely]] {
    return logFarFromOne(bits, kLn2Multiples[exponent]);
  }
  return logOfRareArgument(x);
}

#endif  // MATH_IMPLMATH_HX_NATURALLOG_H
