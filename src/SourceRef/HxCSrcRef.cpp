#include "SourceRef/HxCSrcRef.h"

#include <cstdint>
#include <istream>
#include <ostream>

#include "Control/HX_Memory.h"
#include "platform/dump/HX_Dump.h"

int HxCSrcRef::m_sSrcRefCounter = 0;

HxCSrcRef::HxCSrcRef() : m_Id(m_sSrcRefCounter++) {}

HxCSrcRef::~HxCSrcRef() = default;

HX_Dump* HxCSrcRef::dump(HX_Dump* dumper, bool) {
  // All texts before the section, because an open section has to be closed.
  KyCXString className;
  KyCXString label;
  KyCXString text;
  const bool hasTexts = HX_WithinMemory([&] {
    className = "HxCSrcRef";
    label = "Source:";
    toString(text);
  });
  if (!hasTexts) return dumper;
  dumper->openObject(this, className);
  dumper->writeEntry(label, text, 0);
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

void HxCSrcRef::toString(KyCXString& text) const {
  HX_WithinMemory([&] { text += "Unknown source"; });
}

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
