#include "FLAG.h"

#include <set>

#include "platform/messages/HX_MessageHandler.h"
#include "support/HX_TestFixture.h"

namespace {

using testing::AllOf;
using testing::Each;
using testing::ElementsAre;
using testing::ElementsAreArray;
using testing::SizeIs;
using testing::StartsWith;

enum : unsigned int { kA = 1, kB = 2, kC = 4, kD = 8 };

// A excludes B, C and D. C and D have no name. D excludes bit 4, without a row.
const FLAG_flag_info kRows[] = {
    {kB | kC | kD, "A"}, {kA, "B"}, {kA, ""}, {kA | 16, nullptr}};

class FLAGTest : public HX_TestFixture {
 protected:
  HX_CountingController m_Controller;
};

TEST_F(FLAGTest, FieldsAreWordsOfTheController) {
  unsigned int* field = FLAG_NewField();
  EXPECT_EQ(*field, 0U);
  FLAG_SetFlag(field, kA | kC | kD);
  FLAG_ClearFlag(field, kC | kB);
  unsigned int* copy = FLAG_DupFlagField(field);
  EXPECT_EQ(FLAG_CompareFlagfields(field, copy), 1);
  FLAG_ClearAll(field);
  EXPECT_EQ(FLAG_CompareFlagfields(field, copy), 0);
  EXPECT_EQ(FLAG_GetAllFlagsFromFlagField(copy), kA | kD);
  for (unsigned int* block : {field, copy}) m_Controller.freeMemBlock(block);
  EXPECT_EQ(m_Controller.allocated(), 2);
  m_Controller.fail();
  unsigned int word = kA;
  EXPECT_EQ(FLAG_DupFlagField(&word), nullptr);
  EXPECT_THAT(messages(), ElementsAre(StartsWith("7/3 ")));
}

// Against the plain walk over the 32 masks.
TEST_F(FLAGTest, FlagsAreCountedFromTheLowestBitAndAskedForByAnyOrAll) {
  const unsigned int words[] = {0,  kA,          kB,          kA | kB,
                                kC, 0x80000001U, 0xFFFFFFFFU, 0xA5u << 13};
  for (unsigned int word : words) {
    int count = 0;
    for (unsigned int mask = 1; mask != 0; mask <<= 1)
      if ((word & mask) != 0) {
        EXPECT_EQ(FLAG_GetIthFlagInField(&word, ++count), mask);
      }
    EXPECT_EQ(FLAG_GetNumberOfFlagsInField(&word), count);
    for (int none : {-1, 0, count + 1, 1 << 30})
      EXPECT_EQ(FLAG_GetIthFlag(word, none), 0U) << none;
    for (unsigned int asked : words) {
      EXPECT_EQ(FLAG_GetFlag(&word, asked), (word & asked) != 0);
      EXPECT_EQ(FLAG_GetFlags(&word, asked), (word & asked) == asked);
    }
  }
}

TEST_F(FLAGTest, NullFieldsAreReportedAndLeftAlone) {
  for (auto* operation : {FLAG_SetFlag, FLAG_ClearFlag}) operation(nullptr, kA);
  FLAG_ClearAll(nullptr);
  EXPECT_FALSE(FLAG_GetFlag(nullptr, kA) || FLAG_GetFlags(nullptr, 0));
  EXPECT_EQ(FLAG_GetAllFlagsFromFlagField(nullptr), 0U);
  const auto internal = StartsWith("7/3 Internal error. Error code: FLAG.cpp_");
  EXPECT_THAT(messages(), AllOf(SizeIs(6), Each(internal)));
  const std::vector<std::string> all = messages();
  EXPECT_EQ(std::set<std::string>(all.begin(), all.end()).size(), 6U)
      << "each operation fails on a line of its own";
}

TEST_F(FLAGTest, ConflictsAreReportedAndDecideTheSetting) {
  constexpr unsigned int kNoRow = 16;  // one bit above the table
  constexpr unsigned int kBCD = kB | kC | kD;
  const struct {
    const char* why;
    unsigned int held, flag;
    int conflicts;               // results of CheckFlag and SaveSetFlag
    unsigned int saved, forced;  // the field after SaveSetFlag, ForceSetFlag
    bool asserts;
    std::string reported;  // empty for no report
  } rows[] = {
      {"no conflict", kC, kB, 0, kB | kC, kB | kC, false, ""},
      {"nor in the first row", 0, kA, 0, kA, kA, false, ""},
      {"one", kA, kB, kA, kA, kA, false, "B excludes flag(s): A "},
      {"set before: force clears it", kA | kB, kB, kA, kA | kB, kA, false,
       "B excludes flag(s): A "},
      {"several, in the order of their bits", kBCD, kA, kBCD, kBCD, kBCD, false,
       "A excludes flag(s): B <unknown flag name> <unknown flag name> "},
      {"mask: its highest bit's row; a conflict without row", kNoRow, kB | kD,
       kNoRow, kNoRow, kNoRow, true, "<unknown flag name> excludes flag(s): "},
      {"flag 0 has row 0", kB, 0, kB, kB, kB, false, "A excludes flag(s): B "},
      {"no row", kA, kNoRow, 0, kA, kA | kNoRow, true, ""}};
  unsigned int field,
      seen;  // seen: as the receiver of the message finds the field
  HX_MessageHandler::instance().setSink(
      [&](const HX_Message&) { seen = field; });
  const auto assertion =
      StartsWith("7/3 Internal error. Error code: FLAG.cpp_");
  for (const auto& row : rows) {
    SCOPED_TRACE(row.why);
    std::vector<testing::Matcher<std::string>> expected;
    for (const char* end :
         {"", ". Didn't set flag.", ". Clearing bad flag(s)."}) {
      if (row.asserts) expected.push_back(assertion);
      if (!row.reported.empty())
        expected.push_back("1292/5 INTERNAL: Flag conflict found ! Flag " +
                           row.reported + end);
    }
    clearMessages();
    field = row.held;
    EXPECT_EQ(FLAG_CheckFlag(&field, row.flag, 4, kRows), row.conflicts);
    EXPECT_EQ(field, row.held);
    EXPECT_EQ(FLAG_SaveSetFlag(&field, row.flag, 4, kRows), row.conflicts);
    EXPECT_EQ(field, row.saved);
    field = row.held;
    seen = row.forced;
    FLAG_ForceSetFlag(&field, row.flag, 4, kRows);
    EXPECT_EQ(field, row.forced);
    EXPECT_EQ(seen, row.forced);
    EXPECT_THAT(messages(), ElementsAreArray(expected));
  }
}

TEST_F(FLAGTest, AConflictIsReportedWithoutMemoryAndByTheController) {
  unsigned int field = kA;
  EXPECT_EQ(FLAG_CheckFlag(&field, kB, 4, kRows), static_cast<int>(kA));
  EXPECT_GT(m_Controller.allocated(), 0);
  m_Controller.fail();
  clearMessages();
  EXPECT_EQ(FLAG_SaveSetFlag(&field, kB, 4, kRows), static_cast<int>(kA));
  FLAG_ForceSetFlag(&field, kB, 4, kRows);
  EXPECT_EQ(field, kA);
  EXPECT_THAT(
      messages(),
      AllOf(SizeIs(2), Each("1292/5 INTERNAL: Flag conflict found ! Flag ")));
  EXPECT_EQ(m_Controller.liveBlocks(), 0);
}

}  // namespace
