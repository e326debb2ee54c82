#include "SourceRef/HxCSrcRefServer.h"

#include <memory>

#include "SourceRef/HxCInternalSrcRef.h"

HxCSrcRefServer::~HxCSrcRefServer() {
  m_SrcRefs.forEach([](const HxCSrcRef* srcRef) { delete srcRef; });
}

HxCInternalSrcRef* HxCSrcRefServer::getSrcRef() {
  std::unique_ptr<HxCInternalSrcRef> srcRef(new HxCInternalSrcRef);
  // Without a search, because a search for every reference makes a long run
  // quadratic.
  if (srcRef == nullptr || !m_SrcRefs.appendNew(srcRef.get())) return nullptr;
  return srcRef.release();
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
