#include "FLAG.h"

#include "platform/messages/HX_MessageHandler.h"
#include "support/HX_TestFixture.h"

namespace {

using testing::ElementsAre;
using testing::StartsWith;

enum : unsigned int { kA = 1, kB = 2, kC = 4, kD = 8 };

// A excludes B, C and D, whose name is missing; D's bit 4 has no row.
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
  EXPECT_EQ(FLAG_GetAllFlagsFromFlagField(copy), kA | kD);
  FLAG_ClearAll(field);
  EXPECT_EQ(FLAG_CompareFlagfields(field, copy), 0);
  EXPECT_EQ(*field, 0U);
  EXPECT_EQ(m_Controller.liveBlocks(), 2);
  m_Controller.freeMemBlock(field);
  m_Controller.freeMemBlock(copy);
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
  FLAG_ClearAll(nullptr);
  FLAG_ClearFlag(nullptr, kA);
  FLAG_SetFlag(nullptr, kA);
  EXPECT_FALSE(FLAG_GetFlag(nullptr, kA));
  EXPECT_FALSE(FLAG_GetFlags(nullptr, 0));
  EXPECT_EQ(FLAG_GetAllFlagsFromFlagField(nullptr), 0U);
  EXPECT_THAT(messages(),
              testing::AllOf(testing::SizeIs(6),
                             testing::Each(StartsWith(
                                 "7/3 Internal error. Error code: FLAG.h_"))));
}

TEST_F(FLAGTest, ConflictsAreReportedAndDecideTheSetting) {
  constexpr unsigned int kNoRow = 16;  // one bit above the table
  const struct {
    const char* why;
    unsigned int held;
    unsigned int flag;
    unsigned int conflicts;  // what CheckFlag and SaveSetFlag return
    unsigned int saved;      // the field after SaveSetFlag
    unsigned int forced;     // the field after ForceSetFlag
    bool asserts;
    const char* reported;  // null for no report
  } rows[] = {
      {"no conflict", kC, kB, 0, kB | kC, kB | kC, false, nullptr},
      {"one", kA, kB, kA, kA, kA, false, "B excludes flag(s): A "},
      {"set before: force clears it", kA | kB, kB, kA, kA | kB, kA, false,
       "B excludes flag(s): A "},
      {"several, in the order of their bits", kB | kC | kD, kA, kB | kC | kD,
       kB | kC | kD, kB | kC | kD, false,
       "A excludes flag(s): B <unknown flag name> <unknown flag name> "},
      {"mask: its highest bit's row; a conflict without row", kNoRow, kB | kD,
       kNoRow, kNoRow, kNoRow, true, "<unknown flag name> excludes flag(s): "},
      {"flag 0 has row 0", kB, 0, kB, kB, kB, false, "A excludes flag(s): B "},
      {"no row", kA, kNoRow, 0, kA, kA | kNoRow, true, nullptr}};
  for (const auto& row : rows) {
    SCOPED_TRACE(row.why);
    const auto expectMessages = [&row](const std::string& suffix) {
      std::vector<testing::Matcher<std::string>> expected;
      if (row.asserts)
        expected.push_back(
            StartsWith("7/3 Internal error. Error code: FLAG.cpp_"));
      if (row.reported != nullptr)
        expected.push_back("1292/5 INTERNAL: Flag conflict found ! Flag " +
                           (row.reported + suffix));
      EXPECT_THAT(messages(), testing::ElementsAreArray(expected));
      clearMessages();
    };
    const int conflicts = static_cast<int>(row.conflicts);
    unsigned int field = row.held;
    EXPECT_EQ(FLAG_CheckFlag(&field, row.flag, 4, kRows), conflicts);
    EXPECT_EQ(field, row.held);
    expectMessages("");
    EXPECT_EQ(FLAG_SaveSetFlag(&field, row.flag, 4, kRows), conflicts);
    EXPECT_EQ(field, row.saved);
    expectMessages(". Didn't set flag.");
    field = row.held;
    unsigned int seen = row.forced;  // by who receives the report
    HX_MessageHandler::instance().setSink(
        [&](const HX_Message&) { seen = field; });
    FLAG_ForceSetFlag(&field, row.flag, 4, kRows);
    HX_MessageHandler::instance().setSink({});
    EXPECT_EQ(field, row.forced);
    EXPECT_EQ(seen, row.forced);
    expectMessages(". Clearing bad flag(s).");
  }
}

}  // namespace
