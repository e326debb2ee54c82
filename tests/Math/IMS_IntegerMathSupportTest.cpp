#include "Math/IMS_IntegerMathSupport.h"

#include <gtest/gtest.h>

#include <boost/multiprecision/cpp_int.hpp>
#include <cmath>
#include <limits>
#include <numeric>
#include <random>
#include <utility>
#include <vector>

#include "Math/IMS_Log2.h"
#include "platform/datatypes/HX_NumericalType.h"

namespace {

namespace mp = boost::multiprecision;
using Integer = mp::number<mp::cpp_int_backend<>, mp::et_off>;

constexpr long long kMin = std::numeric_limits<long long>::min();
constexpr long long kMax = std::numeric_limits<long long>::max();
constexpr double kInf = std::numeric_limits<double>::infinity();
constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();

// The neighbourhood of 0 and of all powers of two, both signs.
std::vector<long long> boundaryValues() {
  std::vector<long long> values = {0, kMin, kMin + 1, kMax, kMax - 1};
  for (int bit = 0; bit < 63; ++bit) {
    for (long long offset : {-1, 0, 1}) {
      const auto value = static_cast<long long>(
          (1ULL << bit) + static_cast<unsigned long long>(offset));
      values.push_back(value);
      values.push_back(value == kMin ? kMax : -value);
    }
  }
  return values;
}

TEST(IntegerMathSupportTest, WordsAndRangesOfBoundaryValues) {
  for (long long v : boundaryValues()) {
    SCOPED_TRACE(v);
    const Integer exact(v);
    EXPECT_EQ(Integer(IMS_AbsInt64(v)), v == kMin ? Integer(kMax) : abs(exact));
    const bool fitsInt = v >= -2147483648LL && v < 2147483648LL;
    const bool fitsUInt = v >= 0 && v < 4294967296LL;
    EXPECT_EQ(IMS_FitsInt32(v), fitsInt);
    EXPECT_EQ(IMS_FitsUInt32(v), fitsUInt);
    EXPECT_EQ(IMS_Fits32Bit(v), fitsInt || fitsUInt);
    EXPECT_EQ(Integer(IMS_GetUpper32Bit(v)) * 4294967296 + IMS_GetLower32Bit(v),
              exact);
    EXPECT_TRUE(IMS_FitsUInt32(IMS_GetLower32Bit(v)));
    EXPECT_EQ(IMS_IsEven(v), exact % 2 == 0);
    const long long root = IMS_SimulinkAlikeSqrt(v);
    EXPECT_EQ(root < 0, v < 0);
    if (IMS_AbsInt64(v) < 1LL << 52) {
      const long long magnitude = IMS_AbsInt64(root);
      EXPECT_EQ(Integer(magnitude), mp::sqrt(abs(exact)));
    }
  }
}

TEST(IntegerMathSupportTest, DoublesAreRoundedHalfAwayFromZero) {
  const std::pair<double, long long> rows[] = {
      {2.5, 3},
      {-2.5, -3},
      {std::nextafter(2.5, 0), 2},
      {-0.4, 0},
      {-0.0, 0},
      {0x1.fffffffffffffp62, 9223372036854774784},
      {0x1p63, kMax},
      {-0x1p63, kMin},
      {kInf, kMax},
      {-kInf, kMin},
      {kNaN, kMax}};
  for (const auto& [x, rounded] : rows) {
    EXPECT_EQ(IMS_RoundDouble(x), rounded) << x;
    EXPECT_EQ(IMS_RoundDoubleToULong(x), static_cast<std::uint32_t>(rounded));
  }
}

// Against the plain form; the remainder of the big integers truncates as well.
TEST(IntegerMathSupportTest, DivisorsMatchThePlainRemainders) {
  const std::vector<long long> boundary = boundaryValues();
  std::mt19937_64 random(4711);
  SCOPED_TRACE("seed 4711");
  const auto draw = [&] {
    const auto v = static_cast<long long>(random()) >> random() % 64;
    const auto at = static_cast<std::size_t>(random() % boundary.size());
    return random() % 4 == 0 ? boundary[at] : v;
  };
  std::vector<std::pair<long long, long long>> pairs = {
      {kMin, -1}, {kMin, 1}, {1, kMin}, {kMin, kMin}};
  while (pairs.size() < 4000) {
    const auto common =
        static_cast<long long>(random() >> (1 + random() % 63)) | 1;
    pairs.emplace_back(draw() / common * common, draw() / common * common);
  }
  for (const auto& [first, second] : pairs) {
    const long long values[] = {first, second};
    Integer a(first), b(second);
    while (b != 0) a = std::exchange(b, a % b);
    EXPECT_EQ(Integer(IMS_FindGreatestCommonDivisor(values)), a)
        << first << ", " << second;
  }
}

TEST(IntegerMathSupportTest, MultiplesWithinTheirBounds) {
  constexpr long long kTwo62 = 4611686018427387904;
  const struct {
    std::vector<long long> values;
    double limit;
    long long expected;
  } rows[] = {{{4, 6}, 12, 12},
              {{4, 6}, std::nextafter(12, 0), 0},
              {{4, 6}, kNaN, 12},
              {{2, 3, 4}, 100, 12},
              {{2, 6, 3}, 100, 0},
              {{2, 3, 5}, 10, 0},
              {{0, 5}, 100, 0},
              {{5, 0}, 100, 0},
              {{2, 3, 0}, 100, 0},
              {{-4, 6}, 1, -12},   // the divisor is 2
              {{4, -6}, 100, 12},  // the divisor is -2
              {{-1, kMin}, kInf, 0},
              {{kMax, 1}, kInf, 0},  // 2^63 in double
              {{kMin, 1}, kInf, 0},
              {{kTwo62, 1}, kInf, 0},
              {{1, kTwo62, 3}, kInf, -kTwo62},  // wraps
              {{1, kTwo62, 2}, kInf, 0}};
  for (const auto& [values, limit, expected] : rows) {
    EXPECT_EQ(IMS_FindLeastCommonMultiple(static_cast<int>(values.size()),
                                          values.data(), limit),
              expected)
        << testing::PrintToString(values) << ", " << limit;
  }
  for (long long a = 1; a < 60; ++a) {
    for (long long b = 1; b < 60; ++b) {
      const long long values[] = {a, b};
      // The second properly divides the first.
      const bool refused = a % b == 0 && a != b;
      EXPECT_EQ(IMS_FindLeastCommonMultiple(2, values, 1e6),
                refused ? 0 : std::lcm(a, b))
          << a << ", " << b;
    }
  }
}

TEST(IntegerMathSupportTest, WrapsAndMatchesAsTheTypeDoes) {
  for (int kind = 0; kind < 4; ++kind) {
    const int width = 8 << kind / 2;
    const bool isSigned = kind % 2 != 0;
    const long long size = 1LL << width;
    const long long low = isSigned ? -size / 2 : 0, high = low + size - 1;
    const HX_NumericalType type(static_cast<double>(low),
                                static_cast<double>(high), width, isSigned);
    for (long long v = -2 * size; v <= 2 * size; ++v) {
      const long long wrapped = ((v - low) % size + size) % size + low;
      ASSERT_EQ(IMS_ShrinkValueToBaseType(v, &type), wrapped)
          << v << " to " << width << " bits, signed " << isSigned;
      for (double half : {0.0, 0.5}) {
        const double x = static_cast<double>(v) + half;
        ASSERT_EQ(IMS_ValueMatchesSignednessAndWidth(x, isSigned, width),
                  x <= static_cast<double>(high) &&
                      (!isSigned || x >= static_cast<double>(low)))
            << x << " in " << width << " bits, signed " << isSigned;
      }
    }
  }
}

TEST(IntegerMathSupportTest, WrapOfUnusualTypes) {
  const HX_NumericalType int4(-8, 7, 4, true);
  const HX_NumericalType int32(-2147483648.0, 2147483647, 32, true);
  const struct {
    const char* why;
    HX_NumericalType type;
    long long v, wrapped;
  } rows[] = {{"beyond 32 bits", {-10, 10, 33, true}, kMax, kMax},
              {"32 bits, signed", int32, kMin, 0},
              {"32 bits, signed", int32, 0x80000000, -2147483648LL},
              {"32 bits, unsigned", {0, 4294967295, 32, false}, -1, 4294967295},
              {"no extension below 128", int4, 124, 12},
              {"extension from 128 on", int4, 140, -4},
              {"negative values count as high", int4, -9, 7},
              {"no bits", {0, 0, 0, true}, 5, 0},
              {"less than no bits", {0, 0, -3, true}, 5, 0}};
  for (const auto& row : rows) {
    EXPECT_EQ(IMS_ShrinkValueToBaseType(row.v, &row.type), row.wrapped)
        << row.why << ": " << row.v;
  }
}

TEST(IntegerMathSupportTest, RangesOfUnusualWidths) {
  const struct {
    double x;
    bool isSigned;
    int width;
    bool matches;
  } rows[] = {{-1e300, false, 8, true},  // no lower bound without sign
              {kNaN, false, 8, true},
              {kNaN, true, 8, true},
              {0x1p64, false, 64, true},  // the upper one is rounded up
              {std::nextafter(0x1p64, kInf), false, 64, false},
              {0x1p63, true, 64, true},
              {-0x1p63, true, 64, true},
              {std::nextafter(-0x1p63, -kInf), true, 64, false},
              {kInf, true, 2147483647, true},
              {0.0, true, 1, true},
              {-1.0, true, 1, true},
              {0.5, true, 1, false},
              {0.0, true, -2147483647 - 1, false}};
  for (const auto& [x, isSigned, width, matches] : rows) {
    EXPECT_EQ(IMS_ValueMatchesSignednessAndWidth(x, isSigned, width), matches)
        << x << " in " << width << " bits";
  }
}

// Both sides of every power of two that the type holds.
TEST(Log2Test, IsTheIndexOfTheHighestBit) {
  const auto check = [](auto zero) {
    using T = decltype(zero);
    EXPECT_EQ(IMS_Log2(zero), 0);
    for (int bit = 1; bit < std::numeric_limits<T>::digits; ++bit) {
      const T power = T{1} << bit;
      EXPECT_EQ(IMS_Log2(power - 1), bit - 1);
      EXPECT_EQ(IMS_Log2(power), bit);
      EXPECT_EQ(IMS_Log2(power + (power - 1)), bit);
    }
    if (std::numeric_limits<T>::is_signed) {
      EXPECT_EQ(IMS_Log2(std::numeric_limits<T>::min()), -1);
      EXPECT_EQ(IMS_Log2(zero - 1), -1);
    }
  };
  check(0U);
  check(0);
  check(0L);
  check(0LL);
}

}  // namespace
