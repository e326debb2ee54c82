#include "Strings/HX_StringParser.h"

#include <cstdlib>
#include <string>
#include <vector>

#include "support/HX_HeapCount.h"
#include "support/HX_TestFixture.h"

namespace {

// fuzz/HX_CheckParser.cpp compares everything else with plain forms.
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

const HX_StringParser kParser;

std::vector<std::string> textsOf(const leda::array<KyCXString>& texts) {
  std::vector<std::string> result;
  for (const KyCXString& text : texts) result.push_back(text.cstring());
  return result;
}

TEST(StringParserTest, ValuesGetOneSlotPerKey) {
  const leda::array<KyCXString> keys{"a", "b"};
  for (const int before : {0, 1, 2, 5}) {
    SCOPED_TRACE(before);
    leda::array<KyCXString> values(before);
    for (KyCXString& value : values) value = "old";
    kParser.parseKeyValuePairs("b=2", "=", ";", keys, values);
    ASSERT_EQ(values.size(), 2);
    EXPECT_EQ(values[0], before == 0 ? "" : "old");
    EXPECT_EQ(values[1], "2");
  }
}

TEST(StringParserTest, ResultsMayBeArguments) {
  // A text that owns memory, so that a freed text shows under the sanitizers.
  const std::string pairs(
      "key_one = a value longer than the inline buffer ;B=1");
  const leda::array<KyCXString> keys{"KEY_ONE", "b", "c"};
  const std::string expected("a value longer than the inline buffer");
  for (const int asText : {0, 1, 2}) {
    leda::array<KyCXString> values{"x", "=", ";"};
    values[asText] = pairs.c_str();
    kParser.parseKeyValuePairs(values[asText], "=", ";", keys, values);
    EXPECT_THAT(textsOf(values),
                testing::ElementsAre(expected, "1", asText == 2 ? pairs : ";"));
  }
  leda::array<KyCXString> separators{"=", ";"};
  kParser.parseKeyValuePairs(pairs.c_str(), separators[0], separators[1], keys,
                             separators);
  EXPECT_THAT(textsOf(separators), testing::ElementsAre(expected, "1", ""));
  leda::array<KyCXString> same{"b", "key_one"};
  EXPECT_EQ(kParser.parseKeyValuePairs(pairs.c_str(), "=", ";", same, same),
            "");
  EXPECT_THAT(textsOf(same), testing::ElementsAre("1", expected));
}

bool parsesTexts() {
  // Longer than the inline buffer of a text.
  static const KyCXString s_Filler("0123456789012345678901234567890123456789");
  static const KyCXString s_Pairs = "key=" + s_Filler + ";" + s_Filler;
  static const KyCXString s_Path = "CGTmpData/hxscript_C/" + s_Filler;
  static const leda::array<KyCXString> s_Keys{"key"};
  static leda::array<KyCXString> s_Values;
  static KyCXString s_Inside, s_Outside;
  s_Values = leda::array<KyCXString>();
  s_Inside = s_Outside = KyCXString();
  const KyCXString unknown =
      kParser.parseKeyValuePairs(s_Pairs, "=", ";", s_Keys, s_Values);
  const KyCXString removed =
      kParser.removeChars(s_Filler, "9", HX_StringParser::eRemoveBoth);
  kParser.divideKeywordEmbeddedString(s_Pairs, "=", ";", s_Inside, s_Outside);
  KyCXString path;
  kParser.processDDPath(s_Path, path);
  // Each result is complete or as before.
  const bool arePairsDone = s_Values.size() == 1;
  if (!arePairsDone && !unknown.isEmpty()) std::abort();
  if (s_Inside.isEmpty() != s_Outside.isEmpty()) std::abort();
  const bool done = arePairsDone && !removed.isEmpty() && !s_Inside.isEmpty() &&
                    !path.isEmpty();
  s_Values = leda::array<KyCXString>();
  s_Inside = s_Outside = KyCXString();
  return done;
}

TEST(StringParserTest, WithoutMemoryResultsKeepTheirTexts) {
  HX_NEEDS_HEAP_OF_LIBRARY();
  ASSERT_TRUE(parsesTexts());
  HX_WithoutEachHeapBlock("parse", parsesTexts);
}

}  // namespace
