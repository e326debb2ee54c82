#include <set>
#include <utility>

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
  for (const auto& word :
       words("auto break case char const continue default do double else enum "
             "extern "
             "float for goto if int long register return short signed sizeof "
             "static "
             "struct switch typedef union unsigned void volatile while")) {
    clearMessages();
    EXPECT_FALSE(names.isStringValidCVariableName(word.c_str())) << word;
    EXPECT_THAT(messages(), ElementsAre("408/2 C keyword " + word +
                                        " used as identifier."));
  }
  clearMessages();
  for (const auto& word : words("Int inline restrict _Bool INT int_"))
    EXPECT_TRUE(names.isStringValidCVariableName(word.c_str())) << word;
  for (const char* word : {"", "1a", "a b", "a-b", "\xE4"})
    EXPECT_FALSE(names.isStringValidCVariableName(word)) << word;
  EXPECT_THAT(messages(), IsEmpty());
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
  const KyCXString odd(std::string(64, 'w').c_str());  // longer than noted
  names.addToKeywordDict(odd, static_cast<HxCNames::tagHxEDictEntryType>(3));
  const auto& reports = recordDebugReports();
  EXPECT_FALSE(names.isStringValidCVariableName(odd));
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
  Id id("1abc:my.file");
  EXPECT_TRUE(names.isFileNameValid(id));
  id.activateActualName();
  EXPECT_FALSE(names.isFileNameValid(id));
}

TEST_F(KeywordsTest, SuffixesCountInLetters) {
  const std::pair<int, const char*> rows[] = {
      {0, "a"},    {25, "z"},    {26, "aa"},      {27, "ba"},
      {51, "za"},  {52, "ab"},   {675, "zy"},     {676, "az"},
      {701, "zz"}, {702, "aaa"}, {18278, "aaaa"}, {-1, "a"}};
  const std::string text(60, 'n');
  for (const auto& [index, code] : rows) {
    for (int length = 0; length <= 120; ++length) {
      const bool isLimited = length > 60;
      options.setLimitVariableNameLength(isLimited);
      const KyCXString given = KyCXString(text.c_str()).head(length % 61);
      KyCXString name = given;
      names.appendSuffix(name, index);
      const KyCXString suffix = KyCXString("_") + code;
      const int room = isLimited ? 31 - suffix.length() : 60;
      EXPECT_EQ(name, given.head(std::min(given.length(), room)) + suffix);
    }
  }
  std::set<std::string> codes;
  for (int index = 0; index < 20000; ++index) {
    KyCXString name;
    names.appendSuffix(name, index);
    codes.insert(name.cstring());
  }
  EXPECT_EQ(codes.size(), 20000U);
}

}  // namespace
