#include <cctype>

#include "Naming/HX_NamingFixture.h"

namespace {

using testing::Each;
using testing::ElementsAre;
using testing::IsEmpty;

class KeywordsTest : public HX_NamingFixture {
 protected:
  KeywordsTest() { HxCNames::boot(); }
  ~KeywordsTest() override { HxCNames::shutdown(); }

  bool isValid(const std::string& name) {
    return names.isStringValidCVariableName(name.c_str());
  }
};

TEST_F(KeywordsTest, ExactlyTheKeywordsOfC90AreReserved) {
  std::vector<std::string> expected;
  for (const auto& word :
       words("auto break case char const continue default do double else enum "
             "extern float for goto if int long register return short signed "
             "sizeof static struct switch typedef union unsigned void volatile "
             "while")) {
    EXPECT_FALSE(isValid(word)) << word;
    expected.push_back("408/2 C keyword " + word + " used as identifier.");
  }
  for (const auto& word : words("Int inline restrict _Bool INT int_ ink"))
    EXPECT_TRUE(isValid(word)) << word;
  for (const char* word : {"", "1a", "a b", "a-b", "i-t", "\xE4"})
    EXPECT_FALSE(isValid(word)) << word;
  EXPECT_EQ(messages(), expected);
}

TEST_F(KeywordsTest, TheLastEntryOfAWordCounts) {
  names.addToKeywordDict("UInt8", HxCNames::eDictBaseTypeName);
  EXPECT_FALSE(isValid("UInt8"));
  names.addToKeywordDict("UInt8", HxCNames::eDictUserTypeName);
  names.addToKeywordDict("int", HxCNames::eDictUserTypeName);
  EXPECT_FALSE(isValid("UInt8"));
  EXPECT_FALSE(isValid("int"));
  HxCNames::boot();
  EXPECT_TRUE(isValid("UInt8"));
  const std::string odd(64, 'w');  // longer than the filter counts
  names.addToKeywordDict(odd.c_str(),
                         static_cast<HxCNames::tagHxEDictEntryType>(3));
  const auto& reports = recordDebugReports();
  EXPECT_FALSE(isValid(odd));
  EXPECT_THAT(reports, ElementsAre("0"));
  EXPECT_THAT(messages(),
              ElementsAre("409/2 Base type name UInt8 used as identifier.",
                          "410/2 User data type name UInt8 used as identifier.",
                          "410/2 User data type name int used as identifier."));
}

TEST_F(KeywordsTest, WithoutADictionaryEveryUseIsAsserted) {
  HxCNames::shutdown();
  HxCNames::shutdown();
  names.addToKeywordDict("x", HxCNames::eDictCKeyword);
  EXPECT_TRUE(isValid("int"));
  EXPECT_FALSE(isValid("1"));
  EXPECT_FALSE(isValid(""));
  EXPECT_EQ(messages().size(), 3U);
  EXPECT_THAT(messages(), Each(HX_Fits(kAssertion)));
}

TEST_F(KeywordsTest, TheReasonIsToldWithoutAMessage) {
  names.addToKeywordDict("Base", HxCNames::eDictBaseTypeName);
  names.addToKeywordDict("a-b", HxCNames::eDictUserTypeName);
  names.addToKeywordDict("odd", static_cast<HxCNames::tagHxEDictEntryType>(3));
  recordDebugReports();
  const std::pair<const char*, HxCNames::HxEVariableNameTag> rows[] = {
      {"x", HxCNames::eVariableNameValid},
      {"", HxCNames::eVariableNameEmpty},
      {"int", HxCNames::eVariableNameCKeyword},
      {"Base", HxCNames::eVariableNameBaseType},
      {"a-b", HxCNames::eVariableNameUserType},
      {"odd", HxCNames::eVariableNameOtherWord},
      {"a+b", HxCNames::eVariableNameNoCIdentifier}};
  for (const auto& [text, answer] : rows)
    EXPECT_EQ(HxCNames::checkCVariableName(text), answer) << text;
  HxCNames::shutdown();
  EXPECT_EQ(HxCNames::checkCVariableName("int"), HxCNames::eVariableNameValid);
  EXPECT_THAT(recordDebugReports(), IsEmpty());
  EXPECT_THAT(messages(), IsEmpty());
}

TEST_F(KeywordsTest, FileNamesAreCheckedCharacterByCharacter) {
  for (int c = 1; c < 256; ++c) {
    const char text[] = {static_cast<char>(c), 0};
    KyCXString name(text);
    const bool valid = (c < 128 && std::isalnum(c)) || c == '_' || c == '-';
    EXPECT_EQ(names.isFileNameValid(name), valid) << c;
  }
  KyCXString empty;
  EXPECT_FALSE(names.isFileNameValid(empty));
  Id id("1abc:my.file");
  EXPECT_TRUE(names.isFileNameValid(id));
  id.activateActualName();
  EXPECT_FALSE(names.isFileNameValid(id));
}

// The next code: the first letter counts fastest.
void countUp(std::string& code) {
  for (char& letter : code) {
    if (++letter <= 'z') return;
    letter = 'a';
  }
  code += 'a';
}

TEST_F(KeywordsTest, SuffixesCountInLettersBehindWhatFits) {
  std::string code = "a";
  for (int index = -1; index < 20000; ++index) {
    const std::size_t length = static_cast<std::size_t>(index + 1) % 61;
    const bool isLimited = index % 2 == 0;
    options.setLimitVariableNameLength(isLimited);
    KyCXString name(std::string(length, 'n').c_str());
    names.appendSuffix(name, index);
    const std::size_t room = isLimited ? 30 - code.size() : length;
    ASSERT_EQ(name.cstring(),
              std::string(std::min(length, room), 'n') + "_" + code);
    if (index >= 0) countUp(code);  // a negative index counts as 0
  }
}

}  // namespace
