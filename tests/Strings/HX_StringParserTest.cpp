#include "Strings/HX_StringParser.h"

#include <algorithm>

#include "support/HX_TestFixture.h"

namespace {

TEST(StringParserTest, RemoveCharsTrimsTheChosenEnds) {
  const char* const trimmed[] = {"ayx", "xya", "a", "xyayx", "xyayx"};
  for (int mode : {0, 1, 2, 3, -1})
    EXPECT_EQ(
        HX_StringParser().removeChars(
            "xyayx", "yx", static_cast<HX_StringParser::remove_etp>(mode)),
        trimmed[mode < 0 ? 4 : mode]);
}

TEST(StringParserTest, PairsFillTheSlotsOfTheirKeys) {
  // Text, separators of key and pair, keys, values (each ended by ',', and "-"
  // before), what is not recognised.
  const char* const rows[][6] = {
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
  for (const auto& [text, keyValueSep, pairSep, keyList, expected, unknown] :
       rows) {
    leda::array<KyCXString> keys;
    KyCXString(keyList).split(',', keys);
    leda::array<KyCXString> values(keys.size());
    for (KyCXString& value : values) value = "-";
    EXPECT_EQ(HX_StringParser().parseKeyValuePairs(text, keyValueSep, pairSep,
                                                   keys, values),
              unknown);
    KyCXString joined;
    for (const KyCXString& value : values) joined += value + ",";
    EXPECT_EQ(joined, expected) << text;
  }
}

TEST(StringParserTest, KeywordsDivideTheText) {
  // Text, start, stop -> embedded, outside.
  const char* const rows[][5] = {{"x[[abc]]y", "[[", "]]", "abc", "xy"},
                                 {"x[[abc", "[[", "]]", "abc", "x"},
                                 {"[[a]]B[[c]]", "[[", "]]", "ac", "B"},
                                 {"xBEGINaEnDy", "begin", "END", "a", "xy"},
                                 {"a]]b[[", "[[", "]]", "", "a]]b"},
                                 {"a|b|c|d", "|", "|", "bd", "ac"},
                                 {"a[[b", "", "]]", "", "a[[b"},
                                 {"a[[b]]", "[[", "", "b]]", "a"},
                                 {"", "[[", "]]", "", ""}};
  for (const auto& [text, start, stop, inside, around] : rows) {
    KyCXString embedded("old");
    KyCXString outside(text);
    HX_StringParser().divideKeywordEmbeddedString(outside, start, stop,
                                                  embedded, outside);
    EXPECT_EQ(embedded, inside) << text;
    EXPECT_EQ(outside, around) << text;
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
