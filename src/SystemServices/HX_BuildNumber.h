// The numbers and texts of one build of the generator.
//
//   HX_BuildNumber build;
//   build.definedBuildNumber(2, 2, 1, 5, "4711", false, false, 0, "2.2",
//                            "2007-04-01", "Mar 14 2007", "10:23:45");
//   build.getVersionString();       // "2.2.1.B5"
//   build.getLongVersionString();   // "2.2.1.B5\t from 2007-03-14 10:23:45"

#ifndef SYSTEMSERVICES_HX_BUILDNUMBER_H
#define SYSTEMSERVICES_HX_BUILDNUMBER_H

#include <memory>

#include "Control/HX_Allocated.h"
#include "HX_Export.h"

class KyCXString;

/// A copy shares the texts with its original; the last of them that is
/// destroyed or defined anew releases them.
class HX_UTILS_API HX_BuildNumber : public HX_Allocated {
 public:
  /// Sets the version, its texts and the build's texts; replaces what an
  /// earlier call set. The maintenance version and the beta and release flags
  /// are not touched.
  ///
  /// The version text is major.minor; with a third number above 0 it is
  /// major.minor.third and the build kind: ".P" and the build counter with
  /// \p isFirstKind, otherwise ".B" and the build counter, and nothing for a
  /// release.
  /// \param buildDate  as __DATE__ gives it, "Mmm dd yyyy" with a blank for a
  ///     leading 0 of the day; stored as year-month-day. The text is divided at
  ///     each blank: of three parts, the first is the month, then come day and
  ///     year; of four the second, whatever it holds, is skipped and the day
  ///     gets a leading 0. A text of any other number of parts is stored as it
  ///     is, an unknown month name stays.
  /// \return true
  bool definedBuildNumber(int majorVersion, int minorVersion, int thirdNumber,
                          int buildCounter, const KyCXString& buildId,
                          bool isFirstKind, bool isRelease, int unused,
                          const KyCXString& productVersion,
                          const KyCXString& productReleaseDate,
                          const KyCXString& buildDate,
                          const KyCXString& buildTime);

  /// -1 until defined.
  int getMajorVersion() const { return m_MajorVersion; }
  int getMinorVersion() const { return m_MinorVersion; }
  /// Always -1: the third number only shows in the version text.
  int getMaintenanceVersion() const { return m_MaintenanceVersion; }
  /// Always false: the build kind only shows in the version text.
  bool isBetaVersion() const { return m_IsBeta; }
  bool isReleaseVersion() const { return m_IsRelease; }

  // The texts belong to the object and are null until defined.

  /// "Build Id " and the id.
  KyCXString* getBuildId() const { return m_pBuildId.get(); }
  KyCXString* getBuildTime() const { return m_pBuildTime.get(); }
  /// For example "2007-03-04".
  KyCXString* getBuildDate() const { return m_pBuildDate.get(); }
  /// Date, a blank and time.
  KyCXString* getBuildDateTime() const { return m_pBuildDateTime.get(); }
  KyCXString* getVersionString() const { return m_pVersion.get(); }
  /// The version text, a tab, " from " and the build's date and time.
  KyCXString* getLongVersionString() const { return m_pLongVersion.get(); }
  /// The product's version and release date.
  KyCXString* getBrennicVersion() const { return m_pProductVersion.get(); }
  KyCXString* getBrennicReleaseDate() const {
    return m_pProductReleaseDate.get();
  }

 private:
  using Text = std::shared_ptr<KyCXString>;

  bool m_IsBeta = false;
  bool m_IsRelease = false;
  int m_MajorVersion = -1;
  int m_MinorVersion = -1;
  int m_MaintenanceVersion = -1;
  Text m_pBuildId;
  Text m_pBuildTime;
  Text m_pBuildDate;
  Text m_pBuildDateTime;
  Text m_pProductVersion;
  Text m_pProductReleaseDate;
  Text m_pVersion;
  Text m_pLongVersion;
};

#endif  // SYSTEMSERVICES_HX_BUILDNUMBER_H
