#include "FLAG.h"

#include "platform/messages/HX_MessageHandler.h"
#include "support/HX_TestFixture.h"

namespace {

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
  for (unsigned int* block : {field, copy}) m_Controller.freeMemBlock(block);
  EXPECT_EQ(m_Controller.allocated(), 2);
  m_Controller.fail();
  unsigned int word = kA;
  EXPECT_EQ(FLAG_DupFlagField(&word), nullptr);
  EXPECT_THAT(messages(), testing::ElementsAre(StartsWith("7/3 ")));
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
  for (const std::string& message : messages())
    EXPECT_THAT(message, StartsWith("7/3 Internal error. Error code: FLAG.h_"));
  EXPECT_EQ(messages().size(), 6U);
}

TEST_F(FLAGTest, ConflictsAreReportedAndDecideTheSetting) {
  constexpr unsigned int kNoRow = 16;  // one bit above the table
  const struct {
    const char* why;
    unsigned int held, flag;
    unsigned int conflicts;      // what CheckFlag and SaveSetFlag return
    unsigned int saved, forced;  // the field after SaveSetFlag, ForceSetFlag
    bool asserts;
    std::string reported;  // empty for no report
  } rows[] = {
      {"no conflict", kC, kB, 0, kB | kC, kB | kC, false, ""},
      {"one", kA, kB, kA, kA, kA, false, "B excludes flag(s): A "},
      {"set before: force clears it", kA | kB, kB, kA, kA | kB, kA, false,
       "B excludes flag(s): A "},
      {"several, in the order of their bits", kB | kC | kD, kA, kB | kC | kD,
       kB | kC | kD, kB | kC | kD, false,
       "A excludes flag(s): B <unknown flag name> <unknown flag name> "},
      {"mask: its highest bit's row; a conflict without row", kNoRow, kB | kD,
       kNoRow, kNoRow, kNoRow, true, "<unknown flag name> excludes flag(s): "},
      {"flag 0 has row 0", kB, 0, kB, kB, kB, false, "A excludes flag(s): B "},
      {"no row", kA, kNoRow, 0, kA, kA | kNoRow, true, ""}};
  for (const auto& row : rows) {
    SCOPED_TRACE(row.why);
    std::vector<testing::Matcher<std::string>> expected;
    for (const char* end :
         {"", ". Didn't set flag.", ". Clearing bad flag(s)."}) {
      if (row.asserts)
        expected.push_back(
            StartsWith("7/3 Internal error. Error code: FLAG.cpp_"));
      if (!row.reported.empty())
        expected.push_back("1292/5 INTERNAL: Flag conflict found ! Flag " +
                           row.reported + end);
    }
    unsigned int field = row.held;
    for (auto* operation : {FLAG_CheckFlag, FLAG_SaveSetFlag}) {
      EXPECT_EQ(field, row.held);
      EXPECT_EQ(operation(&field, row.flag, 4, kRows),
                static_cast<int>(row.conflicts));
    }
    EXPECT_EQ(field, row.saved);
    field = row.held;
    unsigned int seen = row.forced;  // by who receives the report
    HX_MessageHandler::instance().setSink(
        [&](const HX_Message&) { seen = field; });
    FLAG_ForceSetFlag(&field, row.flag, 4, kRows);
    HX_MessageHandler::instance().setSink({});
    EXPECT_EQ(field, row.forced);
    EXPECT_EQ(seen, row.forced);
    EXPECT_THAT(messages(), testing::ElementsAreArray(expected));
    clearMessages();
  }
}

}  // namespace
