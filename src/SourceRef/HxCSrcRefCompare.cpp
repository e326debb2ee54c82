#include "SourceRef/HxCSrcRefCompare.h"

#include "Control/HX_Memory.h"
#include "SourceRef/HxCDdSrcRef.h"
#include "platform/strings/KyCXString.h"

namespace {

constexpr char kUserScriptFolder[] = "CGTmpData";

bool isFromDD(const HxCSrcRef* srcRef) {
  return srcRef != nullptr && srcRef->isDd() != nullptr;
}

enum Origin { eUnknown, eUserScript, eOther };

// eUnknown: memory ran out; a path is never empty.
Origin originOf(const HxCSrcRef* ddSrcRef) {
  return HX_WithinMemory(eUnknown, [&] {
    KyCXString path;
    ddSrcRef->isDd()->getDdPath(path);
    if (path.isEmpty()) return eUnknown;
    return path.contains(kUserScriptFolder) ? eUserScript : eOther;
  });
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
  return bothFromDD(a, b) && originOf(a) == eUserScript &&
         originOf(b) == eUserScript;
}

bool HxCSrcRefCompare::differentDdSrcRefNotFromUserScript(
    const HxCSrcRef* a, const HxCSrcRef* b) const {
  return bothFromDDButDifferent(a, b) && originOf(a) == eOther &&
         originOf(b) == eOther;
}
