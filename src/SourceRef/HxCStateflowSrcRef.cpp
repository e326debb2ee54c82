#include "SourceRef/HxCStateflowSrcRef.h"

#include "platform/model/SC_Model.h"

HxCStateflowSrcRef::HxCStateflowSrcRef(SC_Model* object) : m_pObject(object) {}

HxCStateflowSrcRef::~HxCStateflowSrcRef() = default;

const HxCStateflowSrcRef* HxCStateflowSrcRef::isStateflow() const {
  return this;
}

void HxCStateflowSrcRef::toString(KyCXString& text) const {
  text = m_pObject->getSFName();
}

int HxCStateflowSrcRef::getSfObjectId() const { return m_pObject->getId(); }

HxCSrcRef* HxCStateflowSrcRef::clone() const {
  return new HxCStateflowSrcRef(m_pObject);
}
