// Profiles of reserved words: the installed lists, reading, patterns.
#include "SafeNames/HX_ReservedNames.h"

#include <filesystem>
#include <fstream>
#include <sstream>
#include <string>
#include <vector>

#include "SafeNames/HX_ShownFaults.h"
#include "support/HX_TestFixture.h"

namespace {

using Reserved = HX_ReservedNames;

class ReservedNamesTest : public HX_TestFixture {};

std::string profileOf(const Reserved& reserved, const char* name) {
  const char* const profile = reserved.find(name, true).profile;
  return profile == nullptr ? "" : profile;
}

// The compiler's side of the proof is script/reserved_words.py.
TEST_F(ReservedNamesTest, EveryWordOfEveryInstalledListIsReserved) {
  Reserved all;
  int lists = 0;
  for (const auto& file :
       std::filesystem::directory_iterator(HX_KEYWORD_FOLDER)) {
    SCOPED_TRACE(file.path().string());
    const std::string profile = file.path().stem().string();
    Reserved one;
    HX_TextFaults faults;
    for (Reserved* reserved : {&one, &all})
      ASSERT_TRUE(reserved->readFile(profile.c_str(),
                                     file.path().string().c_str(), faults))
          << HX_ShownFaults(faults);
    std::ifstream lines(file.path());
    int words = 0;
    for (std::string line; std::getline(lines, line);) {
      if (line[0] == '#') continue;
      EXPECT_EQ(profile, profileOf(one, line.c_str()));
      EXPECT_TRUE(all.find(line.c_str(), false)) << line;
      EXPECT_FALSE(one.find((line + "x0").c_str(), true)) << line;
      ++words;
    }
    EXPECT_EQ(words, one.wordCount());
    ++lists;
  }
  EXPECT_EQ(14, lists);
  EXPECT_LT(4000, all.wordCount());
}

struct ReadCase {
  const char* why;
  std::string text;
  std::vector<std::string> words;
  std::string faults;
};

const std::string kExpected = ": expected one C identifier, found ";
const ReadCase kReadCases[] = {
    {"no line", "", {}, ""},
    {"without a last line feed", "a\nb", {"a", "b"}, ""},
    {"carriage returns", "a\r\nb\r\n", {"a", "b"}, ""},
    {"byte order mark",
     "\xEF\xBB\xBF"
     "a\n",
     {"a"},
     ""},
    {"byte order mark alone", "\xEF\xBB\xBF", {}, ""},
    {"blanks, comments, empty lines",
     "# c\n\n \t a\t \nb# c\n#\n  # c\n",
     {"a", "b"},
     ""},
    {"a word twice", "a\na\n", {"a"}, ""},
    {"two words on a line", "a\nb c\n", {}, "2" + kExpected + "'b c'"},
    {"a digit in front", "1a\n", {}, "1" + kExpected + "'1a'"},
    {"every bad line",
     "-\nok\n\x01\xFF\n",
     {},
     "1" + kExpected + "'-'; 3" + kExpected + "'\\x01\\xff'"},
    {"a zero", std::string("a\0b\n", 4), {}, "1" + kExpected + "'a\\x00b'"},
    {"a byte order mark in the middle",
     "a\n\xEF\xBB\xBF"
     "b\n",
     {},
     "2" + kExpected + "'\\xef\\xbb\\xbfb'"},
    {"a long line is cut",
     std::string(41, '-'),
     {},
     "1" + kExpected + "'" + std::string(40, '-') + "...'"},
};

TEST_F(ReservedNamesTest, ReadsAllLinesOrNone) {
  for (const ReadCase& row : kReadCases) {
    SCOPED_TRACE(row.why);
    Reserved reserved;
    HX_TextFaults faults;
    ASSERT_TRUE(reserved.readText("first", "kept", 4, faults));
    EXPECT_EQ(row.faults.empty(),
              reserved.readText("p", row.text.data(), row.text.size(), faults));
    EXPECT_EQ(row.faults, HX_ShownFaults(faults));
    ASSERT_EQ(static_cast<int>(row.words.size()) + 1, reserved.wordCount());
    EXPECT_EQ("first", profileOf(reserved, "kept"));
    for (std::size_t i = 0; i < row.words.size(); ++i) {
      EXPECT_EQ(row.words[i], reserved.word(static_cast<int>(i) + 1));
      EXPECT_STREQ("p", reserved.profileOf(static_cast<int>(i) + 1));
      EXPECT_EQ("p", profileOf(reserved, row.words[i].c_str()));
    }
  }
}

TEST_F(ReservedNamesTest, KeepsTwentyFaultsAndCountsAll) {
  Reserved reserved;
  HX_TextFaults faults;
  std::string text;
  for (int i = 0; i < 25; ++i) text += "?\n";
  EXPECT_FALSE(reserved.readText("p", text.data(), text.size(), faults));
  EXPECT_EQ(20, faults.kept());
  EXPECT_EQ(25, faults.count());
  EXPECT_EQ(20, faults[19].line);
}

TEST_F(ReservedNamesTest, RefusesWhatIsNoFile) {
  for (const char* path : {"no/such/file.txt", HX_KEYWORD_FOLDER}) {
    Reserved reserved;
    HX_TextFaults faults;
    EXPECT_FALSE(reserved.readFile("p", path, faults)) << path;
    EXPECT_EQ("0: the file cannot be read", HX_ShownFaults(faults)) << path;
  }
}

TEST_F(ReservedNamesTest, AWordKeepsItsFirstProfile) {
  Reserved reserved;
  HX_TextFaults faults;
  ASSERT_TRUE(reserved.readText("one", "a b", 1, faults));
  ASSERT_TRUE(reserved.readText("two", "a\nb", 3, faults));
  EXPECT_EQ("one", profileOf(reserved, "a"));
  EXPECT_EQ("two", profileOf(reserved, "b"));
  EXPECT_EQ("", profileOf(reserved, "A"));
  EXPECT_EQ("", profileOf(reserved, ""));
}

struct PatternCase {
  unsigned pattern;
  const char* name;
  const char* matching;  // names between blanks
  const char* others;
};

const PatternCase kPatternCases[] = {
    {Reserved::ePatternUnderscoreCapital, "underscore-capital", "_A _Zx",
     "_ _a __A A _1 a_A"},
    {Reserved::ePatternFirstUnderscores, "underscores-first", "__ __a ___",
     "_ _a a__b _a__"},
    {Reserved::ePatternUnderscores, "underscores", "__ a__b a__ ___x",
     "_ a_b_c _a_"},
    {Reserved::ePatternFileUnderscore, "underscore-file", "_ _a __ _1",
     "a a_ A_"},
    {Reserved::ePatternStr, "str", "stra strz strlen",
     "str st strA str1 str_a Stra xstra"},
    {Reserved::ePatternMem, "mem", "mema memzx", "mem memA mem_ me smema"},
    {Reserved::ePatternWcs, "wcs", "wcsa wcslen", "wcs wcsA wcs1 wc"},
    {Reserved::ePatternIs, "is", "isa isz isblank", "is isA is_a i his"},
    {Reserved::ePatternTo, "to", "toa total tolower", "to toA to_ t tA"},
    {Reserved::ePatternErrno, "E", "EA E0 E9 EZx", "E Ea E_ e0 xE0"},
    {Reserved::ePatternSignal, "SIG", "SIG SIGx SIG_ SIGINT",
     "SI Sig SIg xSIG"},
    {Reserved::ePatternLocale, "LC_", "LC_ LC_A LC_a", "LC LCA lc_a xLC_"},
    {Reserved::ePatternType, "_t", "_t a_t x__t", "t a_T a_t1 at _ta"},
};

TEST_F(ReservedNamesTest, EachPatternMatchesAlone) {
  unsigned all = 0;
  Reserved reserved;
  for (const PatternCase& row : kPatternCases) {
    SCOPED_TRACE(row.name);
    all |= row.pattern;
    EXPECT_STREQ(row.name, Reserved::patternName(row.pattern));
    EXPECT_EQ(row.pattern, Reserved::patternOf(row.name));
    reserved.setPatterns(row.pattern);
    std::istringstream matching(row.matching);
    for (std::string name; matching >> name;) {
      EXPECT_EQ(row.pattern, reserved.find(name.c_str(), true).pattern) << name;
      const bool isEverywhere = row.pattern != Reserved::ePatternFileUnderscore;
      EXPECT_EQ(isEverywhere, bool(reserved.find(name.c_str(), false))) << name;
    }
    std::istringstream others(row.others);
    for (std::string name; others >> name;)
      EXPECT_FALSE(reserved.find(name.c_str(), true)) << name;
    EXPECT_FALSE(reserved.find("", true));
  }
  EXPECT_EQ(unsigned{Reserved::ePatternAll}, all);
  EXPECT_EQ(nullptr, Reserved::patternName(0));
  EXPECT_EQ(nullptr, Reserved::patternName(3));
  EXPECT_EQ(0u, Reserved::patternOf("st"));
}

TEST_F(ReservedNamesTest, WithoutMemoryNoWordOfTheListStays) {
  HX_WithoutEachBlock("words", [] {
    Reserved reserved;
    HX_TextFaults faults;
    if (!reserved.readText("one", "a", 1, faults)) return false;
    std::string text;
    for (int i = 0; i < 40; ++i) text += "w" + std::to_string(i) + "\n";
    const bool isRead =
        reserved.readText("two", text.data(), text.size(), faults);
    EXPECT_EQ(isRead ? 41 : 1, reserved.wordCount());
    EXPECT_EQ(isRead, bool(reserved.find("w39", false)));
    EXPECT_EQ(isRead, bool(reserved.find("w0", false)));
    EXPECT_TRUE(reserved.find("a", false));
    return isRead;
  });
}

}  // namespace
