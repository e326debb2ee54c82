#include "Strings/HX_StringParser.h"

#include <algorithm>

#include "support/HX_TestFixture.h"

namespace {

TEST(StringParserTest, RemoveCharsTrimsTheChosenEnds) {
  const struct {
    const char *text, *chars;
    const char* trimmed[4];  // leading, trailing, both, unknown modes
  } rows[] = {{"  ab  ", " ", {"ab  ", "  ab", "ab", "  ab  "}},
              {"xxx", "x", {"", "", "", "xxx"}},
              {"", "x", {"", "", "", ""}},
              {"xyaxyx", "yx", {"axyx", "xya", "a", "xyaxyx"}},
              {"aba", "", {"aba", "aba", "aba", "aba"}}};
  for (const auto& [text, chars, trimmed] : rows)
    for (int mode : {0, 1, 2, 3, 4, -1}) {
      const auto ends = static_cast<HX_StringParser::remove_etp>(mode);
      EXPECT_EQ(HX_StringParser().removeChars(text, chars, ends),
                trimmed[mode < 0 ? 3 : std::min(mode, 3)])
          << text << " in mode " << mode;
    }
}

TEST(StringParserTest, PairsFillTheSlotsOfTheirKeys) {
  const struct {
    const char *text, *keyValueSep, *pairSep;
    const char* keys;    // divided by ','
    const char* values;  // each ended by ','; every slot held "-" before
    const char* unrecognised;
  } rows[] = {
      {"Name = F oo ; SIZE=3", "=", ";", "name,Size", "F oo,3,", ""},
      {"a=1;Bogus=2;Flag", "=", ";", "a", "1,", "flag"},
      {"flag; Bogus =2", "=", ";", "a", "-,", "bogus"},
      {"x;\t ;", "=", ";", "a", "-,", "x"},  // white space is no item
      {"x; =5", "=", ";", "a", "-,", ""},    // an empty key is
      {"a=1;a=2", "=", ";", "a", "2,", ""},
      {"a=1", "=", ";", "A,a,b", "-,1,-,", ""},  // the last of equal keys
      {"a->1 AND b->2", "->", "and", "a,b", "1,2,", ""},
      {"a=;b= ", "=", ";", "a,b", ",,", ""},
      {"a=b=\tc", "=", ";", "a", "b=\tc,", ""},
      {"a=1;b=2", "=", "", "a", "1;b=2,", ""},  // no pair separator
      {"a=1;b", "", ";", "a", "-,", "b"},       // no key separator
      {"a=b", "=", "=", "a", ",", "b"},
      {"", "=", ";", "a", "-,", ""}};
  for (const auto& row : rows) {
    leda::array<KyCXString> keys;
    KyCXString(row.keys).split(',', keys);
    leda::array<KyCXString> values(keys.size());
    for (KyCXString& value : values) value = "-";
    EXPECT_EQ(HX_StringParser().parseKeyValuePairs(row.text, row.keyValueSep,
                                                   row.pairSep, keys, values),
              row.unrecognised);
    KyCXString joined;
    for (const KyCXString& value : values) joined += value + ",";
    EXPECT_EQ(joined, row.values) << row.text;
  }
}

TEST(StringParserTest, KeywordsDivideTheText) {
  const struct {
    const char *text, *start, *stop, *embedded, *outside;
  } rows[] = {{"x[[abc]]y", "[[", "]]", "abc", "xy"},
              {"x[[abc", "[[", "]]", "abc", "x"},
              {"[[a]]B[[c]]", "[[", "]]", "ac", "B"},
              {"xBEGINaEnDy", "begin", "END", "a", "xy"},
              {"a]]b[[", "[[", "]]", "", "a]]b"},
              {"a|b|c|d", "|", "|", "bd", "ac"},
              {"a[[b", "", "]]", "", "a[[b"},
              {"a[[b]]", "[[", "", "b]]", "a"},
              {"", "[[", "]]", "", ""}};
  for (const auto& row : rows) {
    KyCXString embedded("old");
    KyCXString outside(row.text);
    HX_StringParser().divideKeywordEmbeddedString(outside, row.start, row.stop,
                                                  embedded, outside);
    EXPECT_EQ(embedded, row.embedded) << row.text;
    EXPECT_EQ(outside, row.outside) << row.text;
  }
}

TEST(StringParserTest, ScriptObjectsAreDescribed) {
  const char* const rows[][2] = {
      {"/Pool/CGTmpData/hxscript_Ctrl/3/V",
       "User script object V of block Ctrl"},
      {"CGTmpData/hxscript_Ctrl/V", "User script object V of block Ctrl"},
      {"CGTmpData/hxscript_C/3/a/b/", "User script object a/b/ of block C"},
      {"CGTmpData/hxscript_/x", "User script object x of block "},
      {"CGTmpData/hxscript_C/", "User script object  of block C"},
      {"CGTmpData/hxscript_C", "CGTmpData/hxscript_C"},
      {"cgtmpdata/hxscript_C/3/x", "cgtmpdata/hxscript_C/3/x"},
      {"", ""}};
  for (const auto& [path, description] : rows) {
    KyCXString text(path);
    HX_StringParser().processDDPath(text, text);
    EXPECT_EQ(text, description);
  }
}

}  // namespace
