#include "SystemServices/HX_BuildNumber.h"

#include "SystemServices/HX_OfficialVersion.h"
#include "platform/matlab/HX_MexInterface.h"
#include "support/HX_TestFixture.h"

namespace {

using BuildNumberTest = HX_TestFixture;

TEST_F(BuildNumberTest, VersionTextShowsTheBuildKindBehindAThirdNumber) {
  const struct {
    int third, counter;
    bool isFirstKind, isRelease;
    const char* version;
  } cases[] = {
      {1, 5, false, false, "6.0.1.B5"}, {1, -2, false, true, "6.0.1"},
      {2, 3, true, false, "6.0.2.P3"},  {2, 3, true, true, "6.0.2"},
      {0, 5, false, false, "6.0"},      {-1, 5, true, false, "6.0"},
      {0, 0, false, true, "6.0"},       {1, -2, false, false, "6.0.1.B-2"},
  };
  HX_BuildNumber build;
  for (const auto& c : cases) {
    SCOPED_TRACE(c.version);
    EXPECT_TRUE(build.definedBuildNumber(6, 0, c.third, c.counter, "4711",
                                         c.isFirstKind, c.isRelease, 9, "6.0",
                                         "2007-04", "Mar  4 2007", "10:23:45"));
    EXPECT_EQ(*build.getVersionString(), c.version);
    EXPECT_EQ(*build.getLongVersionString(),
              KyCXString(c.version) + "\t from 2007-03-04 10:23:45");
  }
  EXPECT_EQ(*build.getBuildId(), "Build Id 4711");
  EXPECT_EQ(*build.getBuildTime(), "10:23:45");
  EXPECT_EQ(*build.getBuildDateTime(), "2007-03-04 10:23:45");
  EXPECT_EQ(*build.getBrennicVersion(), "6.0");
  EXPECT_EQ(*build.getBrennicReleaseDate(), "2007-04");
  EXPECT_EQ(build.getMajorVersion(), 6);
  EXPECT_EQ(build.getMinorVersion(), 0);
  EXPECT_EQ(build.getMaintenanceVersion(), -1);
  EXPECT_FALSE(build.isBetaVersion() || build.isReleaseVersion());
}

TEST_F(BuildNumberTest, BuildDateTakesStandardForm) {
  const char* const cases[][2] = {
      {"Jan 31 2007", "2007-01-31"},    {"Feb  1 2008", "2008-02-01"},
      {"Mar 14 2007", "2007-03-14"},    {"Apr  9 2007", "2007-04-09"},
      {"May 31 2007", "2007-05-31"},    {"Jun 30 2007", "2007-06-30"},
      {"Jul  4 2007", "2007-07-04"},    {"Aug 10 2007", "2007-08-10"},
      {"Sep 11 2007", "2007-09-11"},    {"Oct 12 2007", "2007-10-12"},
      {"Nov 13 2007", "2007-11-13"},    {"Dec  1 2006", "2006-12-01"},
      {"Xyz 14 2007", "2007-Xyz-14"},   {"mar  4 2007", "2007-mar-04"},
      {"2007-03-14", "2007-03-14"},     {"Mar 2007", "Mar 2007"},
      {"Mar   4 2007", "Mar   4 2007"}, {"", ""},
      {"Mar 14 2007 ", "-03-02007"},    {" 4 2007", "2007--4"},
  };
  for (const auto& [date, standard] : cases) {
    HX_BuildNumber build;
    build.definedBuildNumber(1, 0, 0, 0, "", false, false, 0, "", "", date, "");
    EXPECT_EQ(*build.getBuildDate(), standard) << date;
  }
}

TEST_F(BuildNumberTest, CopiesOutliveTheirOriginalAndItsRedefinition) {
  HX_BuildNumber copy;
  EXPECT_EQ(copy.getVersionString(), nullptr);
  {
    HX_BuildNumber build;
    build.definedBuildNumber(1, 2, 0, 0, "7", false, false, 0, "p", "r", "d",
                             "t");
    copy = build;
    EXPECT_EQ(copy.getVersionString(), build.getVersionString());
    // Texts of the object itself as arguments.
    build.definedBuildNumber(3, 4, 0, 0, *build.getBuildId(), false, false, 0,
                             *build.getBrennicReleaseDate(),
                             *build.getBrennicVersion(), *build.getBuildTime(),
                             *build.getBuildDate());
    EXPECT_EQ(*build.getBrennicReleaseDate(), "p");
    EXPECT_EQ(*build.getLongVersionString(), "3.4\t from t d");
  }
  EXPECT_EQ(*copy.getLongVersionString(), "1.2\t from d t");
}

class OfficialVersionTest : public HX_TestFixture {
 protected:
  ~OfficialVersionTest() override {
    HX_RegisterMatlabFunction("hx_config", nullptr);
    EXPECT_EQ(HX_LiveMxArrays(), 0);
  }

  static mxArray* structure(const char* version, const char* date) {
    mxArray* result = mxCreateStructMatrix(1, 1, {"Version", "ReleaseDate"});
    if (version != nullptr)
      mxSetField(result, 0, "Version", mxCreateString(version));
    if (date != nullptr)
      mxSetField(result, 0, "ReleaseDate", mxCreateString(date));
    return result;
  }
};

TEST_F(OfficialVersionTest, EvaluationKeepsWhatItGot) {
  const char *const kNoVersion = "- version -", *const kNoDate =
                                                    "- release date -";
  const struct {
    const char* why;
    mxArray* answer;
    bool result;
    const char* version;
    const char* date;
    int status = 0;
  } cases[] = {
      {"failure with an answer", structure("1", "2"), false, "", "", 1},
      {"no answer", nullptr, false, "", ""},
      {"complete", structure("6.1", "May 2007"), true, "6.1", "May 2007"},
      {"failure", nullptr, false, "6.1", "May 2007", 1},
      {"no date", structure("6.2", nullptr), false, "6.2", kNoDate},
      {"no version", structure(nullptr, "Jun"), false, kNoVersion, kNoDate},
      {"not a structure", mxCreateString("x"), false, kNoVersion, kNoDate},
      {"an empty version", structure("", "Jul"), true, "", "Jul"},
  };
  HX_OfficialVersion official;
  EXPECT_FALSE(official.evalBrennicVersionAndReleaseDate()) << "no function";
  for (const auto& c : cases) {
    SCOPED_TRACE(c.why);
    HX_RegisterMatlabFunction("hx_config", [&](int outputs, mxArray** output,
                                               int inputs, mxArray** input) {
      EXPECT_EQ(outputs, 1);
      EXPECT_EQ(inputs, 1);
      EXPECT_EQ(mxGetScalar(input[0]), 6.0);
      output[0] = c.answer;
      return c.status;
    });
    EXPECT_EQ(official.evalBrennicVersionAndReleaseDate(), c.result);
    const HX_OfficialVersion copy(official);
    EXPECT_EQ(copy.getHXVersionString(), c.version);
    EXPECT_EQ(copy.getHXReleaseDate(), c.date);
  }
}

}  // namespace
