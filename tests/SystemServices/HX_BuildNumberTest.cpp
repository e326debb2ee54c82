#include "SystemServices/HX_BuildNumber.h"

#include <optional>
#include <tuple>

#include "SystemServices/HX_OfficialVersion.h"
#include "platform/matlab/HX_MatlabSession.h"
#include "platform/matlab/HX_MxContent.h"
#include "support/HX_HeapCount.h"
#include "support/HX_TestFixture.h"

namespace {

using BuildNumberTest = HX_TestFixture;

// Long enough for a block of its own.
const KyCXString kLong("a text of fifty characters, more than fit in place");

bool define(HX_BuildNumber& build, int third, int counter, bool isFirstKind,
            bool isRelease, const KyCXString& date) {
  return build.definedBuildNumber(6, 0, third, counter, kLong, isFirstKind,
                                  isRelease, 9, "6.1", "2007-04", date, "9:00");
}

std::string shown(std::initializer_list<const KyCXString*> texts) {
  std::string result;
  for (const KyCXString* text : texts)
    result += std::string("|") + (text == nullptr ? "null" : text->cstring());
  return result;
}
std::string shown(const HX_BuildNumber& build) {
  return std::to_string(build.getMajorVersion()) + "," +
         std::to_string(build.getMinorVersion()) + "," +
         std::to_string(build.getMaintenanceVersion()) +
         (build.isBetaVersion() ? "beta" : "") +
         (build.isReleaseVersion() ? "release" : "") +
         shown({build.getBuildId(), build.getBrennicVersion(),
                build.getBrennicReleaseDate(), build.getLongVersionString()});
}

TEST_F(BuildNumberTest, TextsShowTheBuildKindAndTheStandardDate) {
  const std::tuple<int, int, bool, bool, std::string, std::string> rows[] = {
      {1, 5, false, false, "Mar 14 2007", "|6.0.1.B5|2007-03-14"},
      {1, -2, false, true, "Xyz 14 2007", "|6.0.1|2007-Xyz-14"},
      {2, 3, true, false, "mar  4 2007", "|6.0.2.P3|2007-mar-04"},
      {2, 3, true, true, "2007-03-14", "|6.0.2|2007-03-14"},
      {0, 5, false, false, "Mar 2007", "|6.0|Mar 2007"},
      {-1, 5, true, false, "Mar   4 2007", "|6.0|Mar   4 2007"},
      {0, 0, false, true, "", "|6.0|"},
      {1, -2, false, false, "Mar 14 2007 ", "|6.0.1.B-2|-03-02007"},
      {0, 0, false, false, " 4 2007", "|6.0|2007--4"}};
  HX_BuildNumber build;
  for (const auto& [third, counter, isFirst, isRelease, date, text] : rows) {
    EXPECT_TRUE(
        define(build, third, counter, isFirst, isRelease, date.c_str()));
    EXPECT_EQ(shown({build.getVersionString(), build.getBuildDate()}), text);
  }
  const std::string months = "JanFebMarAprMayJunJulAugSepOctNovDec";
  for (std::size_t i = 0; i < 12; ++i) {
    define(build, 0, 0, false, false,
           (months.substr(3 * i, 3) + "  1 2006").c_str());
    EXPECT_EQ(*build.getBuildDate(),
              ("2006-" + std::to_string(101 + i).substr(1) + "-01").c_str());
  }
}

TEST_F(BuildNumberTest, CopiesOutliveTheirOriginalsRedefinition) {
  HX_BuildNumber build;
  EXPECT_EQ(shown(build), "-1,-1,-1|null|null|null|null");
  define(build, 1, 5, false, true, "Mar  4 2007");
  const HX_BuildNumber copy(build);
  EXPECT_EQ(copy.getVersionString(), build.getVersionString());
  // Texts of the object itself as arguments.
  build.definedBuildNumber(3, 4, 0, 0, *build.getBuildDateTime(), false, false,
                           0, *build.getBrennicReleaseDate(),
                           *build.getBrennicVersion(), *build.getBuildTime(),
                           *build.getBuildDate());
  EXPECT_EQ(shown(build),
            "3,4,-1|Build Id 2007-03-04 9:00|2007-04|6.1|"
            "3.4\t from 9:00 2007-03-04");
  EXPECT_EQ(shown(copy), std::string("6,0,-1|Build Id ") + kLong.cstring() +
                             "|6.1|2007-04|6.0.1\t from 2007-03-04 9:00");
}

TEST_F(BuildNumberTest, TextsAreBlocksOfTheController) {
  HX_NEEDS_HEAP_OF_LIBRARY();
  HX_CountingController controller;
  {
    HX_BuildNumber build;
    define(build, 0, 0, false, false, "");
    const std::string before = shown(build);
    for (int missing = 0; missing < 8; ++missing) {
      controller.failAt(controller.allocated() + missing, false);
      EXPECT_FALSE(define(build, 1, 0, false, true, "")) << missing;
      EXPECT_EQ(shown(build), before) << missing;
    }
    EXPECT_EQ(controller.liveBlocks(), 8);
  }
  EXPECT_EQ(controller.liveBlocks(), 0);
  HX_WithoutEachHeapBlock("long texts", [] {
    HX_BuildNumber build;
    return define(build, 0, 0, false, false, kLong);
  });
}

class OfficialVersionTest : public HX_TestFixture {
 protected:
  ~OfficialVersionTest() override {
    HX_RegisterMatlabFunction("hx_config", nullptr);
    EXPECT_EQ(HX_LiveMxArrays(), 0);
  }

  // Evaluates an answer of hx_config; then with as many blocks of the heap.
  std::string evaluate(mxArray* answer, int status, int blocks = 99) {
    std::optional<HX_FailingHeap> heap;
    HX_RegisterMatlabFunction(
        "hx_config", [&](int, mxArray** output, int, mxArray** input) {
          output[0] = answer;
          heap.emplace(blocks, true);
          return mxGetScalar(input[0]) == 6.0 ? status : 1;
        });
    const bool isComplete = m_Official.evalBrennicVersionAndReleaseDate();
    const HX_OfficialVersion copy(m_Official);
    heap.reset();
    return (isComplete ? "complete" : "") +
           shown({&copy.getHXVersionString(), &copy.getHXReleaseDate()});
  }
  static mxArray* structure(const char* version, const char* date) {
    mxArray* result = mxCreateStructMatrix(1, 1, {"Version", "ReleaseDate"});
    mxSetField(result, 0, "Version", mxCreateString(version));
    if (*date != 0) mxSetField(result, 0, "ReleaseDate", mxCreateString(date));
    return result;
  }

  HX_OfficialVersion m_Official;
};

TEST_F(OfficialVersionTest, EvaluationKeepsWhatItGot) {
  HX_NEEDS_HEAP_OF_LIBRARY();
  EXPECT_FALSE(m_Official.evalBrennicVersionAndReleaseDate()) << "no function";
  EXPECT_EQ(evaluate(structure("1", "2"), 1), "||");
  EXPECT_EQ(evaluate(nullptr, 0), "||");
  EXPECT_EQ(evaluate(structure("6.1", "May"), 0), "complete|6.1|May");
  EXPECT_EQ(evaluate(nullptr, 1), "|6.1|May");
  EXPECT_EQ(evaluate(structure("6.2", ""), 0), "|6.2|- release date -");
  EXPECT_EQ(evaluate(mxCreateString("no structure"), 0),
            "|- version -|- release date -");
  EXPECT_EQ(evaluate(structure("", "Jul"), 0), "complete||Jul");
  // Evaluation and copy need two blocks each.
  const std::string text = kLong.cstring();
  for (int blocks = 0; blocks < 4; ++blocks)
    EXPECT_EQ(evaluate(structure(text.c_str(), text.c_str()), 0, blocks),
              blocks < 2 ? "||Jul" : "complete||")
        << blocks;
  EXPECT_EQ(evaluate(nullptr, 1), "|" + text + "|" + text);
}

}  // namespace
