// Keyword dictionary with a string class that folds letter case.
#include <gtest/gtest.h>

#include <string>

#include "Naming/HxCNames.h"

namespace {

TEST(FoldedKeywordsTest, AllSpellingsOfAWordAnswerAlike) {
  HxCNames::boot();
  HxCNames().addToKeywordDict("Speed", HxCNames::eDictUserTypeName);
  for (int spelling = 0; spelling < 8; ++spelling) {
    std::string word = "int";
    for (int i = 0; i < 3; ++i)
      if ((spelling >> i & 1) != 0) word[i] = static_cast<char>(word[i] - 32);
    EXPECT_EQ(HxCNames::checkCVariableName(word.c_str()),
              HxCNames::eVariableNameCKeyword)
        << word;
  }
  EXPECT_EQ(HxCNames::checkCVariableName("sPEED"),
            HxCNames::eVariableNameUserType);
  EXPECT_EQ(HxCNames::checkCVariableName("inte"), HxCNames::eVariableNameValid);
  HxCNames::shutdown();
}

}  // namespace
