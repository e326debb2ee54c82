#include "SourceRef/HxCSrcRefServer.h"

#include "SourceRef/HxCInternalSrcRef.h"

HxCSrcRefServer::~HxCSrcRefServer() {
  m_SrcRefs.forEach([](const HxCSrcRef* srcRef) { delete srcRef; });
}

HxCInternalSrcRef* HxCSrcRefServer::getSrcRef() {
  auto* srcRef = new HxCInternalSrcRef;
  // A search for what was just made would make a long run quadratic.
  if (srcRef != nullptr) m_SrcRefs.appendNew(srcRef);
  return srcRef;
}

int HxCSrcRefServer::getSpecificSrcRefFromSet(const HxCSrcRefSet* set,
                                              const HxCSrcRef** blockRef,
                                              const HxCSrcRef** ddRef,
                                              const HxCSrcRef** otherRef) {
  const HxCSrcRef* block = nullptr;
  const HxCSrcRef* dd = nullptr;
  const HxCSrcRef* other = nullptr;
  if (set != nullptr) {
    set->forEach([&](const HxCSrcRef* srcRef) {
      if (srcRef->isBlock() != nullptr || srcRef->isInputBlock() != nullptr)
        block = srcRef;
      else if (srcRef->isDd() != nullptr)
        dd = srcRef;
      else
        other = srcRef;
    });
  }
  if (blockRef != nullptr) *blockRef = block;
  if (ddRef != nullptr) *ddRef = dd;
  if (otherRef != nullptr) *otherRef = other;
  return 0;
}
