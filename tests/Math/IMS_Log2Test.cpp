#include "Math/IMS_Log2.h"

#include <gtest/gtest.h>

#include <limits>

namespace {

// Both sides of every power of two that T holds.
template <class T>
void checkPowersOfTwo() {
  for (int bit = 1; bit < std::numeric_limits<T>::digits; ++bit) {
    const T power = static_cast<T>(T{1} << bit);
    EXPECT_EQ(IMS_Log2(static_cast<T>(power - 1)), bit - 1);
    EXPECT_EQ(IMS_Log2(power), bit);
    EXPECT_EQ(IMS_Log2(static_cast<T>(power + 1)), bit);
  }
  EXPECT_EQ(IMS_Log2(T{0}), 0);
  EXPECT_EQ(IMS_Log2(std::numeric_limits<T>::max()),
            std::numeric_limits<T>::digits - 1);
}

TEST(Log2Test, IsTheIndexOfTheHighestBit) {
  checkPowersOfTwo<unsigned int>();
  checkPowersOfTwo<int>();
  checkPowersOfTwo<long>();
  checkPowersOfTwo<long long>();
}

TEST(Log2Test, NegativeValuesHaveNone) {
  EXPECT_EQ(IMS_Log2(-1), -1);
  EXPECT_EQ(IMS_Log2(std::numeric_limits<long>::min()), -1);
  EXPECT_EQ(IMS_Log2(std::numeric_limits<long long>::min()), -1);
}

}  // namespace
