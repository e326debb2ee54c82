#include "Math/IMS_IntegerMathSupport.h"

#include <gtest/gtest.h>

#include <cmath>
#include <numeric>
#include <random>
#include <utility>

#include "Math/HX_ExactNumbers.h"
#include "Math/IMS_Log2.h"
#include "platform/datatypes/HX_NumericalType.h"
#include "support/HX_RecordedResults.h"

namespace {

long long multiple(const HX_Arguments& row) {
  std::vector<long long> values;
  for (std::size_t i = 1; i < row.size(); ++i) values.push_back(row.integer(i));
  return IMS_FindLeastCommonMultiple(static_cast<int>(values.size()),
                                     values.data(), row.real(0));
}
// v, minimum, maximum, width and whether the type is signed.
long long wrapped(const HX_Arguments& row) {
  HX_NumericalType type(row.real(1), row.real(2),
                        static_cast<int>(row.integer(3)), row.integer(4) != 0);
  return IMS_ShrinkValueToBaseType(row.integer(0), &type);
}
bool matches(const HX_Arguments& row) {
  return IMS_ValueMatchesSignednessAndWidth(row.real(0), row.integer(1) != 0,
                                            static_cast<int>(row.integer(2)));
}

const HX_Operations kOperations = {HX_OF(IMS_AbsInt64(v)),
                                   HX_OF(IMS_FitsInt32(v)),
                                   HX_OF(IMS_FitsUInt32(v)),
                                   HX_OF(IMS_Fits32Bit(v)),
                                   HX_OF(IMS_GetLower32Bit(v)),
                                   HX_OF(IMS_GetUpper32Bit(v)),
                                   HX_OF(IMS_IsEven(v)),
                                   HX_OF(IMS_SimulinkAlikeSqrt(v)),
                                   HX_OF(IMS_Log2(v)),
                                   HX_OF(IMS_Log2(static_cast<int>(v))),
                                   HX_OF(IMS_Log2(static_cast<unsigned>(v))),
                                   HX_OF(IMS_Log2(static_cast<long>(v))),
                                   HX_OF(IMS_RoundDouble(x)),
                                   HX_OF(IMS_RoundDoubleToULong(x)),
                                   HX_OF(multiple(row)),
                                   HX_OF(wrapped(row)),
                                   HX_OF(matches(row))};

TEST(IntegerMathSupportTest, OperationsGiveTheRecordedResults) {
  HX_ExpectRecorded("IMS_results.txt", kOperations);
}

// All pairs of boundary values and of values with many common divisors.
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
  constexpr long long kCount = 25;
  for (long long i = 0; i < kCount * kCount * kCount; ++i) {
    long long values[] = {i % kCount, i / kCount % kCount, i / kCount / kCount};
    long long multiple = values[0];
    for (long long v : {values[1], values[2]}) {
      // 0 and a proper divisor of the multiple so far are refused.
      const bool refused = v == 0 || (multiple % v == 0 && multiple != v);
      multiple = refused ? 0 : std::lcm(multiple, v);
      if (multiple > 60) multiple = 0;
    }
    EXPECT_EQ(IMS_FindLeastCommonMultiple(3, values, 60), multiple)
        << testing::PrintToString(values);
  }
}

}  // namespace
