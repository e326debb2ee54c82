#include "SourceRef/HxCSrcRef.h"

#include <cstdint>
#include <istream>
#include <ostream>

#include "platform/dump/HX_Dump.h"

int HxCSrcRef::m_sSrcRefCounter = 0;

HxCSrcRef::HxCSrcRef() : m_Id(m_sSrcRefCounter++) {}

HxCSrcRef::~HxCSrcRef() = default;

HX_Dump* HxCSrcRef::dump(HX_Dump* dumper, bool) {
  dumper->openObject(this, "HxCSrcRef");
  KyCXString text;
  toString(text);
  dumper->writeEntry("Source:", text, 0);
  dumper->closeObject(this);
  return dumper;
}

const HxCSrcRef* HxCSrcRef::isSrcRef() const { return this; }

const HxCBlockSrcRef* HxCSrcRef::isBlock() const { return nullptr; }

const HxCStateflowSrcRef* HxCSrcRef::isStateflow() const { return nullptr; }

const HxCModuleSrcRef* HxCSrcRef::isModule() const { return nullptr; }

const HxCDdSrcRef* HxCSrcRef::isDd() const { return nullptr; }

const HxCInternalSrcRef* HxCSrcRef::isInternal() const { return nullptr; }

const HxCInputBlockSrcRef* HxCSrcRef::isInputBlock() const { return nullptr; }

void HxCSrcRef::toString(KyCXString& text) const { text += "Unknown source"; }

HxCSrcRef* HxCSrcRef::clone() const { return new HxCSrcRef(*this); }

std::ostream& operator<<(std::ostream& stream, const HxCSrcRef*) {
  return stream;
}

std::istream& operator>>(std::istream& stream, const HxCSrcRef*) {
  return stream;
}

int leda::compare(const HxCSrcRef* const& a, const HxCSrcRef* const& b) {
  const auto first = reinterpret_cast<std::uintptr_t>(a);
  const auto second = reinterpret_cast<std::uintptr_t>(b);
  if (first == second) return 0;
  return first > second ? 1 : -1;
}
