// Natural logarithm with the same bits on every machine.
//
// Problem: the logarithms of C run-times differ in the last bit, also between
// two processors with one run-time. One model would give two results.
//
// Plain form: a logarithm of 50 digits, rounded to a double. Correct, but every
// call computes with numbers of many words.
//
// Idea (P. T. P. Tang, "Table-driven implementation of the logarithm function
// in IEEE floating-point arithmetic", ACM TOMS 16, 1990): a fixed sequence of
// additions and multiplications of doubles, because IEEE 754 rounds both in one
// way only. For x = z 2^k with z in [1, 2), a table gives a centre c near z:
//   ln(x) = k ln(2) + ln(c) + ln(1 + r),   r = (z - c) / c
// ln(c) comes from the table in two parts, high and low; ln(1 + r) is a short
// polynomial, because |r| is below 2^-9.
//
// Example, x = 10: k = 3, z = 1.25, row 128 with c = 1.2510690287110569
//   k ln(2)     2.0794415416798
//   ln(c)       0.2239984087883
//   r          -0.0008544921875
//   ln(1 + r)  -0.0008548574741   = r - r^2/2 + r^3/3 - ...
//   sum         2.3025850929940   = ln(10)
//
// Invariants:
//   1. kLn2High and all lnHigh are multiples of 2^-42: k.high + lnHigh is
//   exact.
//   2. All parts after this first sum are below 2^-9: their rounding errors
//   stay
//      below 0.01 units in the last place of a logarithm beyond 1/8.
//   3. Near x = 1 the logarithm itself is small and invariant 2 says nothing.
//      Arguments in the second table take logNearOne(), where q is exact and
//      the error of the sum is carried along.
//   4. No operation depends on the locale, on errno or on fused multiplication.
//
// COST: operations that wait for the argument limit the speed, not the number
// of operations; hence the table of k ln(2) for the frequent k.
//
// Tests: LogarithmIsAlmostAlwaysCorrectlyRounded compares with 50 digits;
// script/make_log_table.py writes the tables.

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

// k ln(2). The high part is exact for k below 2^11.
struct Ln2Multiple {
  double high;
  double low;
};

constexpr Ln2Multiple ln2Times(int k) { return {k * kLn2High, k * kLn2Low}; }

// Table of k ln(2) for the arguments in [2^-64, 2^64).
inline constexpr int kTabulatedExponents = 64;
inline constexpr auto kLn2Multiples = [] {
  std::array<Ln2Multiple, std::size_t{2} * kTabulatedExponents> table{};
  int k = -kTabulatedExponents;
  for (Ln2Multiple& multiple : table) multiple = ln2Times(k++);
  return table;
}();

// z of a normal number z 2^k, in [1, 2), and the row of the table for z.
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

// ln of the positive normal number with the bits \p bits, not near 1
// (invariants 1 and 2).
inline double logFarFromOne(std::uint64_t bits, const Ln2Multiple& k) {
  // |r| <= 1.02 / 2^10
  const auto [z, row] = mantissaOf(bits);
  const double r = (z - row.centre) * row.reciprocal;
  const double r2 = r * r;
  // r - r^2/2 + r^3/3 - ..., coefficients moved to an error below 2^-64
  const double tail = (-1.0 / 2 + r * 0x1.5555555554fe2p-2) +
                      r2 * (-0x1.0000098982d54p-2 + r * 0x1.9999b6c8a2c8dp-3);
  return (k.high + row.lnHigh) + (r + ((k.low + row.lnLow) + r2 * tail));
}

// Near one: the intervals of the second table, in offsets. An offset is the
// difference between the bits of two doubles. Offsets pass 1 without a gap,
// where the distance of neighbouring doubles doubles.
inline constexpr std::uint64_t kIntervalNearOne = std::uint64_t{1} << 44;
inline constexpr std::uint64_t kWidthNearOne =
    std::size(kNaturalLogRowsNearOne) * kIntervalNearOne;
inline constexpr auto kLowestNearOne = std::bit_cast<std::uint64_t>(1.0) -
                                       60 * kIntervalNearOne -
                                       kIntervalNearOne / 2;

}  // namespace hx_detail

/// ln(x), with an error below 0.51 units in the last place. -Inf for both
/// zeros, NaN below zero and for NaN, +Inf for +Inf. Never touches errno.
/// REQUIRES: round-to-nearest.
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
