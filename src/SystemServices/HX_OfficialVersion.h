// The product's official version and release date, as MATLAB knows them.
//
//   HX_OfficialVersion official;
//   if (official.evalBrennicVersionAndReleaseDate())
//     use(official.getHXVersionString(), official.getHXReleaseDate());

#ifndef SYSTEMSERVICES_HX_OFFICIALVERSION_H
#define SYSTEMSERVICES_HX_OFFICIALVERSION_H

#include "Control/HX_Allocated.h"
#include "HX_Export.h"
#include "platform/strings/KyCXString.h"

/// A value type; both texts are empty until evaluated.
class HX_UTILS_API HX_OfficialVersion : public HX_Allocated {
 public:
  HX_OfficialVersion() = default;
  HX_OfficialVersion(const HX_OfficialVersion&) = default;
  HX_OfficialVersion& operator=(const HX_OfficialVersion&) = default;
  virtual ~HX_OfficialVersion();

  /// Calls the MATLAB function "hx_config" with 6 and reads the fields
  /// "Version" and "ReleaseDate" of the structure it returns.
  ///
  /// A failed call leaves both texts. A missing field makes its text
  /// "- version -" or "- release date -", and nothing further is read; a field
  /// that is no text gives an empty text.
  /// \return true if both fields were there
  bool evalBrennicVersionAndReleaseDate();

  /// Valid until the next evaluation or assignment.
  const KyCXString& getHXVersionString() const { return m_Version; }
  const KyCXString& getHXReleaseDate() const { return m_ReleaseDate; }

 private:
  bool m_IsValid = true;  // the result of the last evaluation
  KyCXString m_Version;
  KyCXString m_ReleaseDate;
};

#endif  // SYSTEMSERVICES_HX_OFFICIALVERSION_H
