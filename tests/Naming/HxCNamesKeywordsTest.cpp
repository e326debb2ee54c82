#include "Naming/HX_NamingFixture.h"
#include "platform/model/HxCSymbol.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class KeywordsTest : public HX_NamingFixture {
 protected:
  KeywordsTest() { HxCNames::boot(); }
  ~KeywordsTest() override { HxCNames::shutdown(); }
};

TEST_F(KeywordsTest, ExactlyTheKeywordsOfC90AreReserved) {
  const std::string keywords =
      "auto break case char const continue default do double else enum extern "
      "float for goto if int long register return short signed sizeof static "
      "struct switch typedef union unsigned void volatile while ";
  std::size_t count = 0;
  for (std::size_t at = 0; at < keywords.size(); ++count) {
    const std::size_t end = keywords.find(' ', at);
    const std::string word = keywords.substr(at, end - at);
    EXPECT_FALSE(names.isStringValidCVariableName(word.c_str())) << word;
    EXPECT_EQ(messages().back(),
              "408/2 C keyword " + word + " used as identifier.");
    at = end + 1;
  }
  EXPECT_EQ(count, 32U);
  EXPECT_EQ(messages().size(), 32U);
  for (const char* word : {"Int", "inline", "restrict", "_Bool", "INT", "int_"})
    EXPECT_TRUE(names.isStringValidCVariableName(word)) << word;
  for (const char* word : {"", "1a", "a b", "a-b", "\xE4"})
    EXPECT_FALSE(names.isStringValidCVariableName(word)) << word;
  EXPECT_EQ(messages().size(), 32U);
}

TEST_F(KeywordsTest, TheLastEntryOfAWordCounts) {
  names.addToKeywordDict("UInt8", HxCNames::eDictBaseTypeName);
  names.isStringValidCVariableName("UInt8");
  names.addToKeywordDict("UInt8", HxCNames::eDictUserTypeName);
  names.addToKeywordDict("int", HxCNames::eDictUserTypeName);
  names.isStringValidCVariableName("UInt8");
  names.isStringValidCVariableName("int");
  EXPECT_THAT(messages(),
              ElementsAre("409/2 Base type name UInt8 used as identifier.",
                          "410/2 User data type name UInt8 used as identifier.",
                          "410/2 User data type name int used as identifier."));
  clearMessages();
  HxCNames::boot();
  EXPECT_TRUE(names.isStringValidCVariableName("UInt8"));
  names.addToKeywordDict("odd", static_cast<HxCNames::tagHxEDictEntryType>(3));
  const auto& reports = recordDebugReports();
  EXPECT_FALSE(names.isStringValidCVariableName("odd"));
  EXPECT_THAT(reports, ElementsAre("0"));
  EXPECT_THAT(messages(), IsEmpty());
}

TEST_F(KeywordsTest, WithoutADictionaryEveryUseIsAsserted) {
  HxCNames::shutdown();
  HxCNames::shutdown();
  names.addToKeywordDict("x", HxCNames::eDictCKeyword);
  EXPECT_TRUE(names.isStringValidCVariableName("int"));
  EXPECT_FALSE(names.isStringValidCVariableName("1"));
  EXPECT_EQ(messages().size(), 3U);
}

TEST_F(KeywordsTest, FileNamesAreCheckedCharacterByCharacter) {
  for (int c = 1; c < 256; ++c) {
    const char character = static_cast<char>(c);
    KyCXString name(std::string("a").append(1, character).c_str());
    const bool valid = (c >= '0' && c <= '9') || (c >= 'a' && c <= 'z') ||
                       (c >= 'A' && c <= 'Z') || c == '_' || c == '-';
    EXPECT_EQ(names.isFileNameValid(name), valid) << c;
  }
  KyCXString empty;
  EXPECT_FALSE(names.isFileNameValid(empty));
  HxCCIdentifier id("1abc:my.file");
  EXPECT_TRUE(names.isFileNameValid(id));
  id.activateActualName();
  EXPECT_FALSE(names.isFileNameValid(id));
}

TEST_F(KeywordsTest, SuffixesCountInLetters) {
  struct Row {
    int index;
    const char* code;
  };
  const Row rows[] = {{0, "a"},    {25, "z"},    {26, "aa"},      {27, "ba"},
                      {51, "za"},  {52, "ab"},   {675, "zy"},     {676, "az"},
                      {701, "zz"}, {702, "aaa"}, {18278, "aaaa"}, {-1, "a"}};
  for (const Row& row : rows) {
    KyCXString name("x");
    names.appendSuffix(name, row.index);
    EXPECT_EQ(name, KyCXString("x_") + row.code) << row.index;
  }
  std::set<std::string> codes;
  for (int index = 0; index < 20000; ++index) {
    KyCXString name;
    names.appendSuffix(name, index);
    codes.insert(name.cstring());
  }
  EXPECT_EQ(codes.size(), 20000U);
}

TEST_F(KeywordsTest, SuffixesKeepTheLimitAndStayWhole) {
  const std::string text(60, 'n');
  for (bool limited : {false, true}) {
    options.setLimitVariableNameLength(limited);
    for (int length = 0; length <= 60; ++length) {
      for (int index : {0, 26, 702}) {
        KyCXString name = KyCXString(text.c_str()).head(length);
        names.appendSuffix(name, index);
        const int code = index == 0 ? 1 : index == 26 ? 2 : 3;
        int expected = length + 1 + code;
        if (limited) expected = std::min(expected, 31);
        EXPECT_EQ(name.length(), expected);
        EXPECT_EQ(name.find('_'), expected - code - 1);
      }
    }
  }
}

}  // namespace
