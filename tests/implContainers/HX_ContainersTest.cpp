// Private containers and helpers against plain forms.
#include <array>
#include <climits>
#include <limits>
#include <random>
#include <set>
#include <string>

#include "implContainers/HX_HashTable.h"
#include "implContainers/HX_IntervalSet.h"
#include "implContainers/HX_LetterCode.h"
#include "implContainers/HX_Number.h"
#include "support/HX_ForeignLocale.h"
#include "support/HX_TestFixture.h"

namespace {

// Counts codes up letter by letter, as an odometer.
TEST(LetterCodeTest, CodesCountUpAndReadBack) {
  std::string code = "a";
  for (int index = 0; index < 500'000; ++index) {
    ASSERT_EQ(HX_LetterCode(index).text(), code);
    const int length = static_cast<int>(code.size());
    ASSERT_EQ(HX_LetterCode::indexOf(code.c_str(), length), index);
    const bool isFirst = code.find_first_not_of('a') == code.npos;
    ASSERT_EQ(HX_LetterCode::firstOfLength(length) == index, isFirst);
    std::size_t at = 0;
    while (at < code.size() && code[at] == 'z') code[at++] = 'a';
    if (at < code.size())
      ++code[at];
    else
      code += 'a';
  }
  const std::string last = HX_LetterCode(INT_MAX - 1).text();
  EXPECT_EQ(HX_LetterCode::indexOf(last.c_str(), 7), INT_MAX - 1);
  EXPECT_EQ(HX_LetterCode::indexOf(HX_LetterCode(INT_MAX).text(), 7), -1);
  EXPECT_EQ(HX_LetterCode::indexOf("zzzzzzz", 7), -1);
  EXPECT_EQ(HX_LetterCode::firstOfLength(8), INT_MAX);
}

TEST(IntervalSetTest, AgreesWithASetOfIntegers) {
  std::mt19937 random(HX_Seed());
  HX_IntervalSet intervals;
  std::set<int> plain;
  for (int i = 0; i < 20'000; ++i) {
    const int index = static_cast<int>(random() % 60);
    if (random() % 2 == 0) {
      intervals.add(index);
      plain.insert(index);
    } else {
      intervals.remove(index);
      plain.erase(index);
    }
    int missing = static_cast<int>(random() % 60);
    const int from = missing;
    while (plain.count(missing) != 0) ++missing;
    ASSERT_EQ(intervals.firstMissing(from), missing);
    ASSERT_EQ(intervals.empty(), plain.empty());
  }
}

// Keys are places of an array, so neighbours collide and erasing moves entries.
TEST(HashTableTest, AgreesWithASetOfPointers) {
  std::mt19937 random(HX_Seed());
  std::array<char, 300> objects{};
  for (const unsigned reserved : {0U, 5U, 6U, 100U, 300U}) {
    SCOPED_TRACE(reserved);
    HX_CountingController memory;
    HX_HashTable<char*, int> table;
    std::set<char*> plain;
    ASSERT_TRUE(table.reserve(reserved));
    if (reserved == objects.size()) memory.fail();
    for (int i = 0; i < 20'000; ++i) {
      const std::size_t place = random() % objects.size();
      char* const key = &objects[place];
      auto* slot = table.find(key);
      ASSERT_EQ(slot != nullptr, plain.count(key) != 0);
      if (slot == nullptr) {
        ASSERT_NE(table.add(key, static_cast<int>(place)), nullptr);
        plain.insert(key);
      } else {
        ASSERT_EQ(slot->value, static_cast<int>(place));
        table.erase(slot);
        plain.erase(key);
      }
      ASSERT_EQ(table.size(), plain.size());
    }
    std::set<char*> walked;
    table.forEach([&](const auto& slot) { walked.insert(slot.key); });
    EXPECT_EQ(walked, plain);
  }
  HX_HashTable<int, int> tooLarge;
  EXPECT_FALSE(tooLarge.reserve(UINT_MAX));
  EXPECT_EQ(tooLarge.find(0), nullptr);
}

TEST(NumberTest, TextsFitOrAreEmpty) {
  const HX_ForeignLocale foreign;
  const struct {
    double value;
    int precision;
    std::size_t size;
    const char* text;
  } rows[] = {{2.5, 0, 9, "2"},     {2.5, 3, 6, "2.500"}, {2.5, 3, 5, ""},
              {-0.0, 1, 9, "-0.0"}, {1e20, 0, 9, ""},     {0.125, 2, 9, "0.12"},
              {1.0, 0, 1, ""}};
  for (const auto& row : rows) {
    SCOPED_TRACE(row.value);
    char text[9] = "xxxxxxxx";
    const std::string expected = row.text;
    EXPECT_EQ(HX_WriteFixed(text, row.size, row.value, row.precision),
              expected.size());
    EXPECT_EQ(text, expected);
  }
  char digits[12];
  EXPECT_EQ(HX_WriteInt(digits, sizeof digits, INT_MIN), 11U);
  EXPECT_STREQ(digits, "-2147483648");
}

}  // namespace
