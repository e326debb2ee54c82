#include "SourceRef/HxCDdSrcRef.h"

#include <utility>

#include "Strings/HX_StringParser.h"
#include "platform/datadictionary/HX_DataDictionary.h"

HxCDdSrcRef::HxCDdSrcRef(unsigned long handle) : m_Handle(handle) {}

HxCDdSrcRef::~HxCDdSrcRef() = default;

const HxCDdSrcRef* HxCDdSrcRef::isDd() const { return this; }

void HxCDdSrcRef::toString(KyCXString& text) const {
  KyCXString path;
  getDdPath(path);
  HX_StringParser().processDDPath(path, text);
}

HxCSrcRef* HxCDdSrcRef::clone() const { return new HxCDdSrcRef(*this); }

void HxCDdSrcRef::getDdPath(KyCXString& path) const {
  KyCXString found;
  if (HX_DataDictionary::getObjectFullPathName(m_Handle, found))
    path = std::move(found);
  else
    path = "Handle: " + KyCXString(m_Handle, false, true);
}
