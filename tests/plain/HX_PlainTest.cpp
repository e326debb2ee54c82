// The library answers as the plain form on random cases.
#include <cstdlib>

#include "plain/HX_PlainCase.h"
#include "support/HX_TestFixture.h"

namespace {

// HX_PLAIN_CASES=300000 makes a long run.
int caseCount(int usual) {
  const char* const text = std::getenv("HX_PLAIN_CASES");
  return text != nullptr ? std::atoi(text) : usual;
}

using PlainTest = HX_TestFixture;

TEST_F(PlainTest, NamesAnswerAsThePlainForm) {
  const std::string difference = plain::smallestDifference(
      HX_Seed(), caseCount(1'500), 400, plain::differenceOfNames);
  EXPECT_TRUE(difference.empty()) << difference;
}

TEST_F(PlainTest, SourceReferencesAnswerAsThePlainForm) {
  const std::string difference = plain::smallestDifference(
      HX_Seed(), caseCount(1'500), 400, plain::differenceOfSrcRefs);
  EXPECT_TRUE(difference.empty()) << difference;
}

}  // namespace
