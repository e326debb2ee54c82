#include "implContainers/HX_BloomFilter.h"

#include <gtest/gtest.h>

#include <random>
#include <unordered_set>

namespace {

TEST(BloomFilterTest, PassesEveryKeyOfTheTableAndFewOthers) {
  HX_HashTable<int, int> table;
  HX_BloomFilter filter;
  std::unordered_set<int> keys;
  std::mt19937 random(1);
  const auto draw = [&] { return static_cast<int>(random()); };
  while (keys.size() < 9000) {
    const int key = draw();
    if (!keys.insert(key).second) continue;
    table.add(key, 0);
    filter.noteAdded(key, table);
    if (keys.size() % 1000 != 0) continue;
    for (int held : keys) ASSERT_TRUE(filter.mayHold(held));
    if (keys.size() == 1000) continue;  // no bits yet
    int passed = 0;
    constexpr int kTries = 16000;
    for (int i = 0; i < kTries; ++i) passed += filter.mayHold(draw()) ? 1 : 0;
    // One in 16 and five standard deviations, besides the keys themselves.
    EXPECT_LT(passed, kTries / 16 + 150) << keys.size();
    EXPECT_GT(passed, kTries / 64) << "more bits than needed";
  }
}

}  // namespace
