#include "SystemServices/HX_BuildNumber.h"

#include "platform/containers/array.h"
#include "platform/strings/KyCXString.h"

namespace {

// One row per month name of __DATE__.
struct MonthRow {
  const char* name;
  const char* number;
};
constexpr MonthRow kMonths[] = {{"Jan", "01"}, {"Feb", "02"}, {"Mar", "03"},
                                {"Apr", "04"}, {"May", "05"}, {"Jun", "06"},
                                {"Jul", "07"}, {"Aug", "08"}, {"Sep", "09"},
                                {"Oct", "10"}, {"Nov", "11"}, {"Dec", "12"}};

KyCXString decimal(int value) { return KyCXString(value, false, true); }

KyCXString monthNumber(const KyCXString& name) {
  for (const MonthRow& row : kMonths)
    if (name == row.name) return row.number;
  return name;
}

// "Mar  4 2007" -> "2007-03-04"
KyCXString standardDate(const KyCXString& date) {
  leda::array<KyCXString> parts;
  date.split(' ', parts);
  if (parts.size() == 3)
    return parts[2] + "-" + monthNumber(parts[0]) + "-" + parts[1];
  if (parts.size() == 4)
    return parts[3] + "-" + monthNumber(parts[0]) + "-0" + parts[2];
  return date;
}

KyCXString versionText(int majorVersion, int minorVersion, int thirdNumber,
                       const KyCXString& buildKind) {
  KyCXString text = decimal(majorVersion) + "." + decimal(minorVersion);
  if (thirdNumber > 0)
    text += KyCXString(".") + decimal(thirdNumber) + buildKind;
  return text;
}

KyCXString buildKindText(bool isRelease, bool isFirstKind, int buildCounter) {
  if (isRelease) return "";
  return KyCXString(isFirstKind ? ".P" : ".B") + decimal(buildCounter);
}

}  // namespace

bool HX_BuildNumber::definedBuildNumber(
    int majorVersion, int minorVersion, int thirdNumber, int buildCounter,
    const KyCXString& buildId, bool isFirstKind, bool isRelease, int /*unused*/,
    const KyCXString& productVersion, const KyCXString& productReleaseDate,
    const KyCXString& buildDate, const KyCXString& buildTime) {
  // The arguments may be texts of this object: keep those until the end.
  const HX_BuildNumber previous(*this);
  const auto text = [](const KyCXString& value) {
    return std::make_shared<KyCXString>(value);
  };
  m_MajorVersion = majorVersion;
  m_MinorVersion = minorVersion;
  m_pProductVersion = text(productVersion);
  m_pProductReleaseDate = text(productReleaseDate);
  m_pBuildDate = text(standardDate(buildDate));
  m_pBuildTime = text(buildTime);
  m_pBuildDateTime = text(*m_pBuildDate + " " + *m_pBuildTime);
  m_pBuildId = text(KyCXString("Build Id ") + buildId);
  m_pVersion =
      text(versionText(majorVersion, minorVersion, thirdNumber,
                       buildKindText(isRelease, isFirstKind, buildCounter)));
  m_pLongVersion = text(*m_pVersion + "\t from " + *m_pBuildDateTime);
  return true;
}
