#include "SystemServices/HX_BuildNumber.h"

#include <tuple>

#include "SystemServices/HX_OfficialVersion.h"
#include "platform/matlab/HX_MatlabSession.h"
#include "platform/matlab/HX_MxContent.h"
#include "support/HX_TestFixture.h"

namespace {

class BuildNumberTest : public HX_TestFixture {
 protected:
  void define(int third, int counter, bool isFirstKind, bool isRelease,
              const char* date) {
    EXPECT_TRUE(m_Build.definedBuildNumber(6, 0, third, counter, "4711",
                                           isFirstKind, isRelease, 9, "6.1",
                                           "2007-04", date, "10:23:45"));
  }

  HX_BuildNumber m_Build;
};

TEST_F(BuildNumberTest, VersionTextShowsTheBuildKindBehindAThirdNumber) {
  const std::tuple<int, int, bool, bool, const char*> cases[] = {
      {1, 5, false, false, "6.0.1.B5"}, {1, -2, false, true, "6.0.1"},
      {2, 3, true, false, "6.0.2.P3"},  {2, 3, true, true, "6.0.2"},
      {0, 5, false, false, "6.0"},      {-1, 5, true, false, "6.0"},
      {0, 0, false, true, "6.0"},       {1, -2, false, false, "6.0.1.B-2"},
  };
  for (const auto& [third, counter, isFirstKind, isRelease, text] : cases) {
    define(third, counter, isFirstKind, isRelease, "");
    EXPECT_EQ(*m_Build.getVersionString(), text);
  }
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
    define(0, 0, false, false, date);
    EXPECT_EQ(*m_Build.getBuildDate(), standard) << date;
  }
}

TEST_F(BuildNumberTest, CopiesOutliveTheirOriginalsRedefinition) {
  EXPECT_EQ(m_Build.getVersionString(), nullptr);
  define(1, 5, false, false, "Mar  4 2007");
  const HX_BuildNumber copy(m_Build);
  EXPECT_EQ(copy.getVersionString(), m_Build.getVersionString());
  // Texts of the object itself as arguments.
  m_Build.definedBuildNumber(3, 4, 0, 0, *m_Build.getBuildId(), false, false, 0,
                             *m_Build.getBrennicReleaseDate(),
                             *m_Build.getBrennicVersion(),
                             *m_Build.getBuildTime(), *m_Build.getBuildDate());
  EXPECT_EQ(*m_Build.getBrennicVersion(), "2007-04");
  EXPECT_EQ(*m_Build.getBrennicReleaseDate(), "6.1");
  EXPECT_EQ(*m_Build.getLongVersionString(), "3.4\t from 10:23:45 2007-03-04");

  EXPECT_EQ(*copy.getBuildId(), "Build Id 4711");
  EXPECT_EQ(*copy.getLongVersionString(),
            "6.0.1.B5\t from 2007-03-04 10:23:45");
  EXPECT_EQ(copy.getMajorVersion(), 6);
  EXPECT_EQ(copy.getMinorVersion(), 0);
  EXPECT_EQ(copy.getMaintenanceVersion(), -1);
  EXPECT_FALSE(copy.isBetaVersion() || copy.isReleaseVersion());
}

class OfficialVersionTest : public HX_TestFixture {
 protected:
  ~OfficialVersionTest() override {
    HX_RegisterMatlabFunction("hx_config", nullptr);
    EXPECT_EQ(HX_LiveMxArrays(), 0);
  }

  static mxArray* structure(const char* version, const char* date) {
    mxArray* result = mxCreateStructMatrix(1, 1, {"Version", "ReleaseDate"});
    mxSetField(result, 0, "Version", mxCreateString(version));
    if (date != nullptr)
      mxSetField(result, 0, "ReleaseDate", mxCreateString(date));
    return result;
  }
};

TEST_F(OfficialVersionTest, EvaluationKeepsWhatItGot) {
  const struct {
    const char* why;
    mxArray* answer;
    bool isComplete;
    const char* shown;
    int status = 0;
  } cases[] = {
      {"failure with an answer", structure("1", "2"), false, "|", 1},
      {"no answer", nullptr, false, "|"},
      {"complete", structure("6.1", "May 2007"), true, "6.1|May 2007"},
      {"failure", nullptr, false, "6.1|May 2007", 1},
      {"no date", structure("6.2", nullptr), false, "6.2|- release date -"},
      {"no version in what is no structure", mxCreateString("x"), false,
       "- version -|- release date -"},
      {"an empty version", structure("", "Jul"), true, "|Jul"},
  };
  HX_OfficialVersion official;
  EXPECT_FALSE(official.evalBrennicVersionAndReleaseDate()) << "no function";
  for (const auto& c : cases) {
    SCOPED_TRACE(c.why);
    HX_RegisterMatlabFunction("hx_config", [&](int outputs, mxArray** output,
                                               int inputs, mxArray** input) {
      EXPECT_TRUE(outputs == 1 && inputs == 1);
      EXPECT_EQ(mxGetScalar(input[0]), 6.0);
      output[0] = c.answer;
      return c.status;
    });
    EXPECT_EQ(official.evalBrennicVersionAndReleaseDate(), c.isComplete);
    const HX_OfficialVersion copy(official);
    EXPECT_EQ(copy.getHXVersionString() + "|" + copy.getHXReleaseDate(),
              c.shown);
  }
}

}  // namespace
