#include "SourceRef/HxCDdSrcRef.h"

#include "Control/HX_Memory.h"
#include "Strings/HX_StringParser.h"
#include "platform/datadictionary/HX_DataDictionary.h"

namespace {

KyCXString pathOf(unsigned long handle) {
  KyCXString path;
  if (HX_DataDictionary::getObjectFullPathName(handle, path)) return path;
  return "Handle: " + KyCXString(handle, false, true);
}

}  // namespace

HxCDdSrcRef::HxCDdSrcRef(unsigned long handle) : m_Handle(handle) {}

HxCDdSrcRef::~HxCDdSrcRef() = default;

const HxCDdSrcRef* HxCDdSrcRef::isDd() const { return this; }

void HxCDdSrcRef::toString(KyCXString& text) const {
  HX_WithinMemory(
      [&] { HX_StringParser().processDDPath(pathOf(m_Handle), text); });
}

HxCSrcRef* HxCDdSrcRef::clone() const { return new HxCDdSrcRef(*this); }

void HxCDdSrcRef::getDdPath(KyCXString& path) const {
  HX_WithinMemory([&] { path = pathOf(m_Handle); });
}
