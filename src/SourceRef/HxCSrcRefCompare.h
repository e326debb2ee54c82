// Relation of two source references: are both from the data dictionary, and did
// a user script make the objects?
//
//   int which = 0;
//   if (HxCSrcRefCompare().onlyOneFromDD(a, b, which)) use(which == 0 ? a : b);

#ifndef SOURCEREF_HXCSRCREFCOMPARE_H
#define SOURCEREF_HXCSRCREFCOMPARE_H

#include "Control/HX_Allocated.h"
#include "HX_Export.h"

class HxCSrcRef;

/// Class without data. Every reference may be null; null is not from the data
/// dictionary. A user script made an object if the path of the object contains
/// "CGTmpData", in this case of letters. The two questions about user scripts
/// answer false if memory runs out.
class HX_UTILS_API HxCSrcRefCompare : public HX_Allocated {
 public:
  HxCSrcRefCompare() = default;

  /// Both are from the data dictionary.
  bool bothFromDD(const HxCSrcRef* a, const HxCSrcRef* b) const;

  /// Both are from the data dictionary, from objects with different handles.
  bool bothFromDDButDifferent(const HxCSrcRef* a, const HxCSrcRef* b) const;

  /// Exactly one reference is from the data dictionary.
  /// \param[out] which  0 for \p a, 1 for \p b, -1 for neither; not written
  ///   if both are
  bool onlyOneFromDD(const HxCSrcRef* a, const HxCSrcRef* b, int& which) const;

  /// Both are from the data dictionary, from objects of user scripts.
  bool bothFromUserScript(const HxCSrcRef* a, const HxCSrcRef* b) const;

  /// bothFromDDButDifferent(), and neither object is from a user script.
  bool differentDdSrcRefNotFromUserScript(const HxCSrcRef* a,
                                          const HxCSrcRef* b) const;
};

#endif  // SOURCEREF_HXCSRCREFCOMPARE_H
