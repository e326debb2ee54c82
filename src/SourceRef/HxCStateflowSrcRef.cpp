#include "SourceRef/HxCStateflowSrcRef.h"

#include "Control/HX_Memory.h"
#include "platform/model/SC_Model.h"

HxCStateflowSrcRef::HxCStateflowSrcRef(SC_Model* object) : m_pObject(object) {}

HxCStateflowSrcRef::~HxCStateflowSrcRef() = default;

const HxCStateflowSrcRef* HxCStateflowSrcRef::isStateflow() const {
  return this;
}

void HxCStateflowSrcRef::toString(KyCXString& text) const {
  HX_WithinMemory([&] {
    text = m_pObject != nullptr ? m_pObject->getSFName() : KyCXString();
  });
}

int HxCStateflowSrcRef::getSfObjectId() const {
  return m_pObject != nullptr ? m_pObject->getId() : -1;
}

HxCSrcRef* HxCStateflowSrcRef::clone() const {
  return new HxCStateflowSrcRef(m_pObject);
}
