#include "SourceRef/HxCBlockSrcRef.h"

#include "platform/matlab/HX_SimulinkInterface.h"
#include "platform/model/HX_Block.h"
#include "platform/model/HX_SlBlockHandlesDB.h"
#include "platform/model/HxCGlobal.h"

HxCBlockSrcRef::HxCBlockSrcRef(HX_Block* block) : m_pBlock(block) {}

// Not the base's copy: each block reference has a number of its own.
HxCBlockSrcRef::HxCBlockSrcRef(const HxCBlockSrcRef& other)
    : HxCSrcRef(), m_pBlock(other.m_pBlock) {}

HxCBlockSrcRef::~HxCBlockSrcRef() = default;

const HxCBlockSrcRef* HxCBlockSrcRef::isBlock() const { return this; }

void HxCBlockSrcRef::toString(KyCXString& text) const {
  if (m_pBlock == nullptr) {
    text = "";
    return;
  }
  m_pBlock->getFullPathName(text, false, false);
  text.replaceWhiteSpace(' ', false);
}

double HxCBlockSrcRef::getBlockHandle() const {
  if (m_pBlock == nullptr) return HX_SimulinkInterface::s_invalidHandle;
  return HxCGlobal::getSlBlockHandlesDB()->getSlBlockHandle(m_pBlock);
}

HxCSrcRef* HxCBlockSrcRef::clone() const {
  if (m_pBlock == nullptr) return new HxCSrcRef;
  return new HxCBlockSrcRef(m_pBlock);
}
