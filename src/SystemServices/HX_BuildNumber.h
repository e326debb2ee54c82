// Numbers and texts of one build of the generator.
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

/// Copies share the texts. A text is released with the last object that holds
/// the text.
class HX_UTILS_API HX_BuildNumber : public HX_Allocated {
 public:
  /// Sets the version and the texts; replaces all texts of an earlier call.
  /// Maintenance version, beta and release flag stay. Arguments may be texts of
  /// this object.
  ///
  /// The version text is major.minor. With \p thirdNumber > 0 the text is
  /// major.minor.third and the build kind:
  ///
  ///     isRelease   isFirstKind   build kind
  ///     true        any           none
  ///     false       true          ".P" and the build counter
  ///     false       false         ".B" and the build counter
  ///
  /// \param buildDate  "Mmm dd yyyy", a blank for a leading 0 of the day;
  ///     stored as year-month-day. The text is divided at each blank:
  ///
  ///         3 parts: month, day, year        "Mar 14 2007"   2007-03-14
  ///         4 parts: month, any, day, year   "Mar  4 2007"   2007-03-04
  ///         other:   stored unchanged        "2007-03-14"    2007-03-14
  ///
  ///     An unknown month name stays.
  /// RETURNS: true; false without memory, and the object is unchanged.
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
  /// Always -1: only the version text shows the third number.
  int getMaintenanceVersion() const { return m_MaintenanceVersion; }
  /// Always false: only the version text shows the build kind.
  bool isBetaVersion() const { return m_IsBeta; }
  bool isReleaseVersion() const { return m_IsRelease; }

  // OWNERSHIP: the object owns the texts. Null until defined.

  /// "Build Id " and the id.
  KyCXString* getBuildId() const { return m_pBuildId.get(); }
  KyCXString* getBuildTime() const { return m_pBuildTime.get(); }
  /// For example "2007-03-04".
  KyCXString* getBuildDate() const { return m_pBuildDate.get(); }
  /// Date, a blank and time.
  KyCXString* getBuildDateTime() const { return m_pBuildDateTime.get(); }
  KyCXString* getVersionString() const { return m_pVersion.get(); }
  /// The version text, a tab, " from ", date and time of the build.
  KyCXString* getLongVersionString() const { return m_pLongVersion.get(); }
  /// Version and release date of the product.
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
