#include "SystemServices/HX_BuildNumber.h"

#include <utility>

#include "SystemServices/implSystemServices/HX_SharedText.h"
#include "platform/containers/array.h"

namespace {

// One row per English month abbreviation.
struct MonthRow {
  const char* name;
  const char* number;
};
constexpr MonthRow kMonths[] = {{"Jan", "01"}, {"Feb", "02"}, {"Mar", "03"},
                                {"Apr", "04"}, {"May", "05"}, {"Jun", "06"},
                                {"Jul", "07"}, {"Aug", "08"}, {"Sep", "09"},
                                {"Oct", "10"}, {"Nov", "11"}, {"Dec", "12"}};

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
  KyCXString text = HX_Decimal(majorVersion) + "." + HX_Decimal(minorVersion);
  if (thirdNumber > 0)
    text += KyCXString(".") + HX_Decimal(thirdNumber) + buildKind;
  return text;
}

KyCXString buildKindText(bool isRelease, bool isFirstKind, int buildCounter) {
  if (isRelease) return "";
  return KyCXString(isFirstKind ? ".P" : ".B") + HX_Decimal(buildCounter);
}

}  // namespace

bool HX_BuildNumber::definedBuildNumber(
    int majorVersion, int minorVersion, int thirdNumber, int buildCounter,
    const KyCXString& buildId, bool isFirstKind, bool isRelease, int /*unused*/,
    const KyCXString& productVersion, const KyCXString& productReleaseDate,
    const KyCXString& buildDate, const KyCXString& buildTime) {
  return HX_WithinMemory([&] {
    // The new texts come together in a copy: the old texts may be arguments,
    // and stay if memory runs out.
    HX_BuildNumber defined(*this);
    defined.m_MajorVersion = majorVersion;
    defined.m_MinorVersion = minorVersion;
    defined.m_pProductVersion = HX_SharedText(productVersion);
    defined.m_pProductReleaseDate = HX_SharedText(productReleaseDate);
    const KyCXString date = standardDate(buildDate);
    const KyCXString dateTime = date + " " + buildTime;
    defined.m_pBuildDate = HX_SharedText(date);
    defined.m_pBuildTime = HX_SharedText(buildTime);
    defined.m_pBuildDateTime = HX_SharedText(dateTime);
    defined.m_pBuildId = HX_SharedText(KyCXString("Build Id ") + buildId);
    const KyCXString version =
        versionText(majorVersion, minorVersion, thirdNumber,
                    buildKindText(isRelease, isFirstKind, buildCounter));
    defined.m_pVersion = HX_SharedText(version);
    defined.m_pLongVersion = HX_SharedText(version + "\t from " + dateTime);
    *this = std::move(defined);
  });
}
