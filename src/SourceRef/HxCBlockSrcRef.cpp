#include "SourceRef/HxCBlockSrcRef.h"

#include <utility>

#include "Control/HX_Memory.h"
#include "platform/matlab/HX_SimulinkInterface.h"
#include "platform/model/HX_Block.h"
#include "platform/model/HX_SlBlockHandlesDB.h"
#include "platform/model/HxCGlobal.h"

HxCBlockSrcRef::HxCBlockSrcRef(HX_Block* block) : m_pBlock(block) {}

// Base by default construction, because a copy draws a new number.
HxCBlockSrcRef::HxCBlockSrcRef(const HxCBlockSrcRef& other)
    : HxCSrcRef(), m_pBlock(other.m_pBlock) {}

HxCBlockSrcRef::~HxCBlockSrcRef() = default;

const HxCBlockSrcRef* HxCBlockSrcRef::isBlock() const { return this; }

void HxCBlockSrcRef::toString(KyCXString& text) const {
  if (m_pBlock == nullptr) {
    text = "";
    return;
  }
  HX_WithinMemory([&] {
    KyCXString path;
    m_pBlock->getFullPathName(path, false, false);
    path.replaceWhiteSpace(' ', false);
    text = std::move(path);
  });
}

double HxCBlockSrcRef::getBlockHandle() const {
  if (m_pBlock == nullptr) return HX_SimulinkInterface::s_invalidHandle;
  return HxCGlobal::getSlBlockHandlesDB()->getSlBlockHandle(m_pBlock);
}

HxCSrcRef* HxCBlockSrcRef::clone() const {
  if (m_pBlock == nullptr) return new HxCSrcRef;
  return new HxCBlockSrcRef(m_pBlock);
}
