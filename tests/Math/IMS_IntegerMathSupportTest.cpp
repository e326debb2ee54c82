#include "Math/IMS_IntegerMathSupport.h"

#include <gtest/gtest.h>

#include <cmath>
#include <numeric>
#include <random>
#include <utility>

#include "Math/HX_ExactNumbers.h"
#include "Math/IMS_Log2.h"
#include "platform/datatypes/HX_NumericalType.h"

namespace {

TEST(IntegerMathSupportTest, WordsAndRangesOfBoundaryValues) {
  for (long long v : boundaryValues()) {
    SCOPED_TRACE(v);
    EXPECT_EQ(IMS_AbsInt64(v), v == kMin64 ? kMax64 : std::abs(v));
    const bool fitsInt = std::in_range<std::int32_t>(v);
    const bool fitsUInt = std::in_range<std::uint32_t>(v);
    EXPECT_EQ(IMS_FitsInt32(v), fitsInt);
    EXPECT_EQ(IMS_FitsUInt32(v), fitsUInt);
    EXPECT_EQ(IMS_Fits32Bit(v), fitsInt || fitsUInt);
    EXPECT_EQ(IMS_GetUpper32Bit(v) * 4294967296 + IMS_GetLower32Bit(v), v);
    EXPECT_TRUE(IMS_FitsUInt32(IMS_GetLower32Bit(v)));
    EXPECT_EQ(IMS_IsEven(v), v % 2 == 0);
    const Integer magnitude(IMS_AbsInt64(v));
    if (magnitude < 1LL << 52) {
      EXPECT_EQ(IMS_SimulinkAlikeSqrt(v), sqrt(magnitude) * (v < 0 ? -1 : 1));
    }
  }
}

TEST(IntegerMathSupportTest, DoublesAreRoundedHalfAwayFromZero) {
  const std::pair<double, long long> rows[] = {
      {2.5, 3},         {-2.5, -3},        {below(2.5), 2},
      {-0.4, 0},        {-0.0, 0},         {below(0x1p63), kMax64 - 1023},
      {0x1p63, kMax64}, {-0x1p63, kMin64}, {kInf, kMax64},
      {-kInf, kMin64},  {kNaN, kMax64}};
  for (const auto& [x, rounded] : rows) {
    EXPECT_EQ(IMS_RoundDouble(x), rounded) << x;
    EXPECT_EQ(IMS_RoundDoubleToULong(x), static_cast<std::uint32_t>(rounded));
  }
}

// All pairs of boundary values and of some with many divisors in common.
TEST(IntegerMathSupportTest, DivisorsMatchThePlainRemainders) {
  std::mt19937_64 random(4711);
  SCOPED_TRACE("seed 4711");
  std::vector<long long> values = boundaryValues();
  while (values.size() < 500) {
    values.push_back(static_cast<long long>(random()) >> random() % 64);
    values.back() -= values.back() % 315;
  }
  for (long long first : values) {
    for (long long second : values) {
      long long a = first, b = second;
      while (b != 0) a = std::exchange(b, b == -1 ? 0 : a % b);
      long long pair[] = {first, second};
      ASSERT_EQ(IMS_FindGreatestCommonDivisor(pair), a)
          << first << ", " << second;
    }
  }
}

TEST(IntegerMathSupportTest, MultiplesWithinTheirBounds) {
  constexpr long long kTwo62 = 4611686018427387904;
  const struct {
    std::vector<long long> values;
    double limit;
    long long expected;
  } rows[] = {{{4, 6}, kNaN, 12},
              {{-4, 6}, 1, -12},   // the divisor is 2
              {{4, -6}, 100, 12},  // the divisor is -2
              {{-1, 4}, 100, 4},   // the divisor is -1
              {{-1, kMin64}, kInf, 0},
              {{kMax64, 1}, kInf, 0},  // 2^63 in double
              {{kMin64, 1}, kInf, 0},
              {{kTwo62, 1}, kInf, 0},
              {{1, kTwo62, 3}, kInf, -kTwo62},  // wraps
              {{1, kTwo62, 2}, kInf, 0},
              {{1LL << 33, 3}, kInf, 3LL << 33}};
  for (auto [values, limit, expected] : rows) {
    EXPECT_EQ(IMS_FindLeastCommonMultiple(static_cast<int>(values.size()),
                                          values.data(), limit),
              expected)
        << testing::PrintToString(values) << ", " << limit;
  }
  constexpr long long kCount = 25;
  for (long long i = 0; i < kCount * kCount * kCount; ++i) {
    long long values[] = {i % kCount, i / kCount % kCount,
                                i / kCount / kCount};
    long long multiple = values[0];
    for (long long v : {values[1], values[2]}) {
      // 0 and a proper divisor of what came before are refused.
      const bool refused = v == 0 || (multiple % v == 0 && multiple != v);
      multiple = refused ? 0 : std::lcm(multiple, v);
      if (multiple > 60) multiple = 0;
    }
    EXPECT_EQ(IMS_FindLeastCommonMultiple(3, values, 60), multiple)
        << testing::PrintToString(values);
  }
}

TEST(IntegerMathSupportTest, WrapsAndMatchesAsTheTypeDoes) {
  for (int kind = 0; kind < 10; ++kind) {
    const int width = 1 << kind / 2;
    const bool isSigned = kind % 2 != 0;
    SCOPED_TRACE(testing::Message() << width << " bits, signed " << isSigned);
    const long long size = 1LL << width;
    const long long low = isSigned ? -size / 2 : 0, high = low + size - 1;
    HX_NumericalType type(static_cast<double>(low),
                                static_cast<double>(high), width, isSigned);
    for (long long v = -2 * size; v <= 2 * size; ++v) {
      const long long wrapped = ((v - low) % size + size) % size + low;
      if (!isSigned || width >= 8) {  // the others: below
        ASSERT_EQ(IMS_ShrinkValueToBaseType(v, &type), wrapped) << v;
      }
      for (double half : {0.0, 0.5}) {
        const double x = static_cast<double>(v) + half;
        ASSERT_EQ(IMS_ValueMatchesSignednessAndWidth(x, isSigned, width),
                  x <= static_cast<double>(high) &&
                      (!isSigned || x >= static_cast<double>(low)))
            << x;
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
  } rows[] = {{"beyond 32 bits", {-10, 10, 33, true}, kMax64, kMax64},
              {"32 bits, signed", int32, kMin64, 0},
              {"32 bits, signed", int32, 0x80000000, -2147483648LL},
              {"32 bits, unsigned", {0, 4294967295, 32, false}, -1, 4294967295},
              {"no extension below 128", int4, 124, 12},
              {"extension from 128 on", int4, 140, -4},
              {"negative values count as high", int4, -9, 7},
              {"no bits", {0, 0, 0, true}, 5, 0},
              {"less than no bits", {0, 0, -3, true}, 5, 0}};
  for (auto row : rows) {
    EXPECT_EQ(IMS_ShrinkValueToBaseType(row.v, &row.type), row.wrapped)
        << row.why << ": " << row.v;
  }
}

// There is no lower bound without sign; the upper one of 64 bits is rounded up.
TEST(IntegerMathSupportTest, RangesOfUnusualWidths) {
  constexpr int kMaxInt = std::numeric_limits<int>::max();
  const struct {
    double x;
    bool isSigned;
    int width;
    bool matches;
  } rows[] = {{-1e300, false, 8, true},
              {kNaN, false, 8, true},
              {kNaN, true, 8, true},
              {0x1p64, false, 64, true},
              {above(0x1p64), false, 64, false},
              {0x1p63, true, 64, true},
              {-0x1p63, true, 64, true},
              {below(-0x1p63), true, 64, false},
              {kInf, true, kMaxInt, true},
              {0.0, true, -kMaxInt - 1, false}};
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
