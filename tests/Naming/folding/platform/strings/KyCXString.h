// String class of a host that folds letter case in its order.

#ifndef PLATFORM_STRINGS_KYCXSTRING_FOLDING_H
#define PLATFORM_STRINGS_KYCXSTRING_FOLDING_H

#define compare compareUnitByUnit
#include "../../../../../platform/strings/KyCXString.h"
#undef compare

namespace leda {

inline int compare(const KyCXString& a, const KyCXString& b) {
  KyCXString lowerA(a);
  KyCXString lowerB(b);
  return compareUnitByUnit(lowerA.toLower(), lowerB.toLower());
}

}  // namespace leda

#endif  // PLATFORM_STRINGS_KYCXSTRING_FOLDING_H
