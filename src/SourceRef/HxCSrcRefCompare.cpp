#include "SourceRef/HxCSrcRefCompare.h"

#include "SourceRef/HxCDdSrcRef.h"
#include "platform/strings/KyCXString.h"

namespace {

constexpr char kUserScriptFolder[] = "CGTmpData";

bool isFromDD(const HxCSrcRef* srcRef) {
  return srcRef != nullptr && srcRef->isDd() != nullptr;
}

bool isFromUserScript(const HxCSrcRef* ddSrcRef) {
  KyCXString path;
  ddSrcRef->isDd()->getDdPath(path);
  return path.contains(kUserScriptFolder);
}

}  // namespace

bool HxCSrcRefCompare::bothFromDD(const HxCSrcRef* a,
                                  const HxCSrcRef* b) const {
  return isFromDD(a) && isFromDD(b);
}

bool HxCSrcRefCompare::bothFromDDButDifferent(const HxCSrcRef* a,
                                              const HxCSrcRef* b) const {
  return bothFromDD(a, b) &&
         a->isDd()->getDdHandle() != b->isDd()->getDdHandle();
}

bool HxCSrcRefCompare::onlyOneFromDD(const HxCSrcRef* a, const HxCSrcRef* b,
                                     int& which) const {
  if (bothFromDD(a, b)) return false;
  which = -1;
  if (isFromDD(a)) which = 0;
  if (isFromDD(b)) which = 1;
  return which >= 0;
}

bool HxCSrcRefCompare::bothFromUserScript(const HxCSrcRef* a,
                                          const HxCSrcRef* b) const {
  return bothFromDD(a, b) && isFromUserScript(a) && isFromUserScript(b);
}

bool HxCSrcRefCompare::differentDdSrcRefNotFromUserScript(
    const HxCSrcRef* a, const HxCSrcRef* b) const {
  return bothFromDDButDifferent(a, b) && !isFromUserScript(a) &&
         !isFromUserScript(b);
}
