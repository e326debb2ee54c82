// Official version and release date of the product, asked from MATLAB.
//
//   HX_OfficialVersion official;
//   if (official.evalBrennicVersionAndReleaseDate())
//     use(official.getHXVersionString(), official.getHXReleaseDate());

#ifndef SYSTEMSERVICES_HX_OFFICIALVERSION_H
#define SYSTEMSERVICES_HX_OFFICIALVERSION_H

#include "Control/HX_Allocated.h"
#include "HX_Export.h"
#include "platform/strings/KyCXString.h"

/// A value type; both texts are empty until evaluated. Without memory the texts
/// of a copy are empty and an assignment changes nothing.
class HX_UTILS_API HX_OfficialVersion : public HX_Allocated {
 public:
  HX_OfficialVersion() = default;
  HX_OfficialVersion(const HX_OfficialVersion& other);
  HX_OfficialVersion& operator=(const HX_OfficialVersion& other);
  virtual ~HX_OfficialVersion();

  /// Calls the MATLAB function "hx_config" with 6 and reads the fields
  /// "Version" and "ReleaseDate" of the returned structure.
  ///
  ///     answer                version         release date         result
  ///     none, or no memory    stays           stays                false
  ///     no field "Version"    "- version -"   stays                false
  ///     no "ReleaseDate"      read            "- release date -"   false
  ///     both fields           read            read                 true
  ///
  /// A field of another type than text gives an empty text.
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
