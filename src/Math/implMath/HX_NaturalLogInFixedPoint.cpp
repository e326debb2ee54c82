#include <array>
#include <bit>
#include <cmath>
#include <cstddef>
#include <cstdint>

#include "Math/implMath/HX_NaturalLog.h"

namespace {

// A non-negative number below 2^32 in units of 2^-256; the least significant
// word first.
using Fixed = std::array<std::uint32_t, 9>;
constexpr std::size_t kWords = 9;
constexpr std::size_t kFractionBits = 256;

constexpr Fixed kLn2 = {0x8BAAFA2B, 0x8A0D175B, 0x7298B62D,
                        0x40F34326, 0x03F2F6AF, 0xC9E3B398,
                        0xD1CF79AB, 0xB17217F7, 0};

Fixed add(const Fixed& a, const Fixed& b) {
  Fixed sum;
  std::uint64_t carry = 0;
  for (std::size_t i = 0; i < kWords; ++i) {
    carry += std::uint64_t{a[i]} + b[i];
    sum[i] = static_cast<std::uint32_t>(carry);
    carry >>= 32;
  }
  return sum;
}

// a - b; a must not be below b.
Fixed subtract(const Fixed& a, const Fixed& b) {
  Fixed difference;
  std::uint64_t borrow = 0;
  for (std::size_t i = 0; i < kWords; ++i) {
    const std::uint64_t word = std::uint64_t{a[i]} - b[i] - borrow;
    difference[i] = static_cast<std::uint32_t>(word);
    borrow = word >> 63;
  }
  return difference;
}

bool isZero(const Fixed& a) { return a == Fixed{}; }

Fixed multiply(const Fixed& a, const Fixed& b) {
  std::array<std::uint32_t, 2 * kWords> product{};
  for (std::size_t i = 0; i < kWords; ++i) {
    std::uint64_t carry = 0;
    for (std::size_t j = 0; j < kWords; ++j) {
      carry += std::uint64_t{a[i]} * b[j] + product[i + j];
      product[i + j] = static_cast<std::uint32_t>(carry);
      carry >>= 32;
    }
    product[i + kWords] = static_cast<std::uint32_t>(carry);
  }
  Fixed result;
  for (std::size_t i = 0; i < kWords; ++i) result[i] = product[i + kWords - 1];
  return result;
}

Fixed scale(const Fixed& a, std::uint32_t factor) {
  Fixed result;
  std::uint64_t carry = 0;
  for (std::size_t i = 0; i < kWords; ++i) {
    carry += std::uint64_t{a[i]} * factor;
    result[i] = static_cast<std::uint32_t>(carry);
    carry >>= 32;
  }
  return result;
}

Fixed divide(const Fixed& a, std::uint32_t divisor) {
  Fixed quotient;
  std::uint64_t rest = 0;
  for (std::size_t i = kWords; i-- > 0;) {
    rest = rest << 32 | a[i];
    quotient[i] = static_cast<std::uint32_t>(rest / divisor);
    rest %= divisor;
  }
  return quotient;
}

// numerator / denominator, below 1; the denominator is below 2^62.
Fixed fraction(std::uint64_t numerator, std::uint64_t denominator) {
  Fixed quotient{};
  for (std::size_t bit = kFractionBits; bit-- > 0;) {
    numerator *= 2;
    if (numerator < denominator) continue;
    numerator -= denominator;
    quotient[bit / 32] |= std::uint32_t{1} << (bit % 32);
  }
  return quotient;
}

// 2 atanh(s) = 2 (s + s^3/3 + s^5/5 + ...)
Fixed twiceAtanh(const Fixed& s) {
  const Fixed square = multiply(s, s);
  Fixed sum = s;
  Fixed power = multiply(s, square);
  for (std::uint32_t n = 3; !isZero(power); n += 2) {
    sum = add(sum, divide(power, n));
    power = multiply(power, square);
  }
  return add(sum, sum);
}

// The nearest double; ln of a double other than 1 never lies half way.
double toDouble(const Fixed& a) {
  std::size_t top = kWords - 1;
  while (a[top] == 0) --top;
  // The leading 96 bits hold 64 after a shift by the leading zeros.
  const std::uint64_t high = std::uint64_t{a[top]} << 32 | a[top - 1];
  const int zeros = std::countl_zero(high);
  const std::uint64_t leading =
      high << zeros | std::uint64_t{a[top - 2]} << zeros >> 32;
  const std::uint64_t rounded = (leading >> 11) + (leading >> 10 & 1);
  const int exponent = 32 * (static_cast<int>(top) - 1) - zeros + 11;
  return std::ldexp(static_cast<double>(rounded),
                    exponent - static_cast<int>(kFractionBits));
}

}  // namespace

double HX_NaturalLogInFixedPoint(double x) {
  if (x == 1.0) return 0.0;
  int k = 0;
  double z = std::frexp(x, &k);  // [0.5, 1)
  if (z < 0.70710678118654752) {
    z *= 2.0;
    --k;
  }
  // ln(z) = 2 atanh((z - 1) / (z + 1)), in units of 2^-53.
  constexpr std::uint64_t kOne = std::uint64_t{1} << 53;
  const auto units = static_cast<std::uint64_t>(std::ldexp(z, 53));
  const bool below = units < kOne;
  const Fixed lnZ =
      twiceAtanh(fraction(below ? kOne - units : units - kOne, units + kOne));
  const Fixed multiple = scale(kLn2, static_cast<std::uint32_t>(std::abs(k)));

  if (k == 0) return below ? -toDouble(lnZ) : toDouble(lnZ);
  if ((k < 0) == below) {
    const double sum = toDouble(add(multiple, lnZ));
    return below ? -sum : sum;
  }
  // |ln(z)| is less than half of ln(2): the multiple gives the sign.
  const double difference = toDouble(subtract(multiple, lnZ));
  return k < 0 ? -difference : difference;
}
