#include "Math/IMS_IntegerMathSupport.h"

#include <gtest/gtest.h>

#include <boost/multiprecision/cpp_int.hpp>
#include <cmath>
#include <iterator>
#include <limits>
#include <numeric>
#include <random>
#include <utility>
#include <vector>

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
  const double xs[] = {2.5,    -2.5,    std::nextafter(2.5, 0),
                       -0.4,   -0.0,    0x1.fffffffffffffp62,
                       0x1p63, -0x1p63, kInf,
                       -kInf,  kNaN};
  const long long rounded[] = {3,    -3,   2,    0,    0,   9223372036854774784,
                               kMax, kMin, kMax, kMin, kMax};
  for (std::size_t i = 0; i < std::size(xs); ++i) {
    EXPECT_EQ(IMS_RoundDouble(xs[i]), rounded[i]) << xs[i];
    EXPECT_EQ(IMS_RoundDoubleToULong(xs[i]),
              static_cast<std::uint32_t>(rounded[i]))
        << xs[i];
  }
}

// The plain form; the remainder of the big integers truncates as well.
Integer plainGcd(Integer a, Integer b) {
  while (b != 0) {
    const Integer rest = a % b;
    a = b;
    b = rest;
  }
  return a;
}

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
  while (pairs.size() < 4000) pairs.emplace_back(draw(), draw());
  for (const auto& [a, b] : pairs) {
    const long long values[] = {a, b};
    EXPECT_EQ(Integer(IMS_FindGreatestCommonDivisor(values)), plainGcd(a, b))
        << a << ", " << b;
  }
}

struct MultipleRow {
  std::vector<long long> values;
  double limit;
  long long expected;
};

const MultipleRow kMultipleRows[] = {
    {{4, 6}, 12, 12},
    {{4, 6}, std::nextafter(12, 0), 0},
    {{4, 6}, kNaN, 12},
    {{2, 3, 4}, 100, 12},
    {{2, 3, 6}, 100, 6},
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
    {{4611686018427387904, 1}, kInf, 0},
    {{1, 4611686018427387904, 3}, kInf, -4611686018427387904},  // wraps
    {{1, 4611686018427387904, 2}, kInf, 0},
};

TEST(IntegerMathSupportTest, MultiplesWithinTheirBounds) {
  for (const MultipleRow& row : kMultipleRows) {
    EXPECT_EQ(IMS_FindLeastCommonMultiple(static_cast<int>(row.values.size()),
                                          row.values.data(), row.limit),
              row.expected)
        << testing::PrintToString(row.values) << ", " << row.limit;
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

TEST(IntegerMathSupportTest, WrapsAsTheTypeDoes) {
  for (int width : {8, 16}) {
    const long long size = 1LL << width;
    for (bool isSigned : {false, true}) {
      const long long low = isSigned ? -size / 2 : 0;
      const long long high = low + size - 1;
      const HX_NumericalType type(static_cast<double>(low),
                                  static_cast<double>(high), width, isSigned);
      for (long long v = -2 * size; v <= 2 * size; ++v) {
        const long long wrapped = ((v - low) % size + size) % size + low;
        ASSERT_EQ(IMS_ShrinkValueToBaseType(v, &type), wrapped)
            << v << " to " << width << " bits, signed " << isSigned;
        for (double x :
             {static_cast<double>(v), static_cast<double>(v) + 0.5}) {
          ASSERT_EQ(IMS_ValueMatchesSignednessAndWidth(x, isSigned, width),
                    x <= static_cast<double>(high) &&
                        (!isSigned || x >= static_cast<double>(low)))
              << x << " in " << width << " bits, signed " << isSigned;
        }
      }
    }
  }
}

TEST(IntegerMathSupportTest, WrapOfUnusualTypes) {
  struct Row {
    const char* why;
    HX_NumericalType type;
    long long v, wrapped;
  };
  const HX_NumericalType int32(-2147483648.0, 2147483647, 32, true);
  const Row rows[] = {
      {"beyond 32 bits", {-10, 10, 33, true}, kMax, kMax},
      {"32 bits, signed", int32, kMin, 0},
      {"32 bits, signed", int32, 0x80000000, -2147483648LL},
      {"32 bits, unsigned", {0, 4294967295, 32, false}, -1, 4294967295},
      {"no extension below 128", {-8, 7, 4, true}, 12, 12},
      {"extension from 128 on", {-8, 7, 4, true}, 140, -4},
      {"negative values count as high", {-8, 7, 4, true}, -9, 7},
      {"no bits", {0, 0, 0, true}, 5, 0},
      {"less than no bits", {0, 0, -3, true}, 5, 0},
  };
  for (const Row& row : rows) {
    EXPECT_EQ(IMS_ShrinkValueToBaseType(row.v, &row.type), row.wrapped)
        << row.why << ": " << row.v;
  }
}

TEST(IntegerMathSupportTest, RangesOfUnusualWidths) {
  const double above64 = std::nextafter(0x1p64, kInf);
  const double below63 = std::nextafter(-0x1p63, -kInf);
  struct Row {
    bool isSigned;
    int width;
    std::vector<double> matching, others;
  };
  // No lower bound without sign; the upper one is rounded up.
  const Row rows[] = {{false, 8, {-1e300, kNaN}, {}},
                      {false, 64, {0x1p64}, {above64}},
                      {true, 64, {0x1p63, -0x1p63}, {below63}},
                      {true, 8, {kNaN}, {}},
                      {true, 2147483647, {kInf}, {}},
                      {true, 1, {0.0, -1.0}, {0.5}},
                      {true, -2147483647 - 1, {}, {0.0}}};
  for (const auto& [isSigned, width, matching, others] : rows) {
    SCOPED_TRACE(testing::Message() << isSigned << ", " << width);
    for (double x : matching)
      EXPECT_TRUE(IMS_ValueMatchesSignednessAndWidth(x, isSigned, width)) << x;
    for (double x : others)
      EXPECT_FALSE(IMS_ValueMatchesSignednessAndWidth(x, isSigned, width)) << x;
  }
}

}  // namespace
