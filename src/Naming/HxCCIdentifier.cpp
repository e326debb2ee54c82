// Fields of an identifier. An operation on several texts makes all new texts
// first and moves the new texts in last: missing memory leaves no half-set
// name.

#include "Naming/HxCCIdentifier.h"

#include <utility>

#include "Control/HX_Memory.h"
#include "platform/model/HX_Options.h"
#include "platform/model/HxCGlobal.h"
#include "platform/model/HxCSymbol.h"

namespace {

void shorten(KyCXString& name) {
  name.shortenString(HxCSymbol::sm_MaxNameLength, 2, '_',
                     static_cast<KyCXString::ScEPosition>(1));
}

bool containsMacro(const KyCXString& text, char letter) {
  for (int at = text.find('$', 0); at >= 0; at = text.find('$', at + 1))
    if (text[at + 1] == letter) return true;
  return false;
}

// The string class keeps a text whose assignment runs out of memory.
void assign(KyCXString& target, const KyCXString& text) {
  HX_WithinMemory([&] { target = text; });
}

}  // namespace

HxCCIdentifier::HxCCIdentifier() = default;

HxCCIdentifier::HxCCIdentifier(const KyCXString& name) { setName(name); }

HxCCIdentifier::HxCCIdentifier(const char* name) { *this = name; }

HxCCIdentifier::HxCCIdentifier(const HxCCIdentifier& other) : HX_Allocated() {
  *this = other;
}

HxCCIdentifier::~HxCCIdentifier() = default;

void HxCCIdentifier::operator=(const HxCCIdentifier& other) {
  if (this != &other) HX_WithinMemory([&] { copy(other); });
}

void HxCCIdentifier::operator=(const KyCXString& name) { setName(name); }

void HxCCIdentifier::operator=(const char* name) {
  HX_WithinMemory([&] { setTemplate(name); });
}

void HxCCIdentifier::init() {
  m_Actual = Name();
  m_Formal = Name();
  m_FormalNameActive = true;
  m_CookLevel = eCookLevelRaw;
  m_SignalLabel = KyCXString();
  m_pSourceRef = nullptr;
  m_pDdSourceRef = nullptr;
  m_pSourceIVBlock = nullptr;
  m_DollarXValue = KyCXString();
}

void HxCCIdentifier::copy(const HxCCIdentifier& other) {
  Name actual(other.m_Actual);
  Name formal(other.m_Formal);
  KyCXString label(other.m_SignalLabel);
  KyCXString x(other.m_DollarXValue);
  m_Actual = std::move(actual);
  m_Formal = std::move(formal);
  m_CookLevel = other.m_CookLevel;
  m_SignalLabel = std::move(label);
  m_pSourceRef = other.m_pSourceRef;
  m_pDdSourceRef = other.m_pDdSourceRef;
  m_pSourceIVBlock = other.m_pSourceIVBlock;
  m_DollarXValue = std::move(x);
  m_FormalNameActive = other.m_FormalNameActive;
}

bool HxCCIdentifier::setName(const KyCXString& name) {
  return HX_WithinMemory(false, [&] { return setTemplate(name); });
}

bool HxCCIdentifier::setTemplate(const KyCXString& text) {
  Name actual;
  Name formal;
  const int colon = text.find(':', 0);
  const int second = colon < 0 ? -1 : text.find(':', colon + 1);
  if (colon < 0) {
    formal.raw = text;
    actual.raw = text;
    actual.raw += "$R";
  } else {
    formal.raw = text.head(colon);
    actual.raw = text.sub(colon + 1, (second < 0 ? text.length() : second) - 1);
  }
  formal.cooked = formal.raw;
  actual.cooked = actual.raw;
  init();  // text may be one of the names: not read any more
  m_Actual = std::move(actual);
  m_Formal = std::move(formal);
  return second < 0;
}

const KyCXString& HxCCIdentifier::getRawName(HxENameTypeTag type) const {
  return name(type).raw;
}

const KyCXString& HxCCIdentifier::getCookedName(HxENameTypeTag type) const {
  return name(type).cooked;
}

void HxCCIdentifier::setCookedName(const KyCXString& text,
                                   HxENameTypeTag type) {
  assign(name(type).cooked, text);
}

template <class Change>
void HxCCIdentifier::changeTexts(Change change) {
  HX_WithinMemory([&] {
    KyCXString rawActual = change(m_Actual.raw);
    KyCXString rawFormal = change(m_Formal.raw);
    KyCXString cookedActual = change(m_Actual.cooked);
    KyCXString cookedFormal = change(m_Formal.cooked);
    m_Actual.raw = std::move(rawActual);
    m_Formal.raw = std::move(rawFormal);
    m_Actual.cooked = std::move(cookedActual);
    m_Formal.cooked = std::move(cookedFormal);
  });
}

void HxCCIdentifier::addPrefix(const KyCXString& prefix) {
  changeTexts([&](const KyCXString& text) { return prefix + text; });
}

void HxCCIdentifier::addPostfix(const KyCXString& postfix) { *this += postfix; }

void HxCCIdentifier::makeCIdentifier() {
  HX_WithinMemory([&] { makeCNames(); });
}

void HxCCIdentifier::makeCNames() {
  KyCXString actual(m_Actual.cooked);
  KyCXString formal(m_Formal.cooked);
  actual.makeCIdentifier(false);
  formal.makeCIdentifier(false);
  m_Actual.cooked = std::move(actual);
  m_Formal.cooked = std::move(formal);
}

void HxCCIdentifier::adaptSize() {
  if (!getIdentifierChangeable(eActiveName)) return;
  if (!HxCGlobal::getOptions()->getLimitVariableNameLength()) return;
  HX_WithinMemory([&] {
    KyCXString actual(m_Actual.cooked);
    KyCXString formal(m_Formal.cooked);
    shorten(actual);
    shorten(formal);
    m_Actual.cooked = std::move(actual);
    m_Formal.cooked = std::move(formal);
  });
}

bool HxCCIdentifier::isFormalNameActive() const { return m_FormalNameActive; }

void HxCCIdentifier::activateFormalName() { m_FormalNameActive = true; }

void HxCCIdentifier::activateActualName() { m_FormalNameActive = false; }

HxCCIdentifier::HxECookLevelTag HxCCIdentifier::getCookLevel() {
  return m_CookLevel;
}

void HxCCIdentifier::setCookLevel(HxECookLevelTag level) {
  m_CookLevel = level;
}

void HxCCIdentifier::setIdentifierChangeable(bool value, HxENameTypeTag type) {
  name(type).flags.changeable = value;
}

bool HxCCIdentifier::getIdentifierChangeable(HxENameTypeTag type) const {
  return name(type).flags.changeable;
}

void HxCCIdentifier::setDollarLUsed(bool value, HxENameTypeTag type) {
  name(type).flags.dollarLUsed = value;
}

bool HxCCIdentifier::getDollarLUsed(HxENameTypeTag type) const {
  const Name& found = name(type);
  return m_CookLevel >= eCookLevelFull ? found.flags.dollarLUsed
                                       : containsMacro(found.cooked, 'L');
}

void HxCCIdentifier::setDollarEUsed(bool value, HxENameTypeTag type) {
  name(type).flags.dollarEUsed = value;
}

bool HxCCIdentifier::getDollarEUsed(HxENameTypeTag type) const {
  const Name& found = name(type);
  return m_CookLevel >= eCookLevelDollarE ? found.flags.dollarEUsed
                                          : containsMacro(found.cooked, 'E');
}

void HxCCIdentifier::setDollarNUsed(bool value, HxENameTypeTag type) {
  name(type).flags.dollarNUsed = value;
}

bool HxCCIdentifier::getDollarNUsed(HxENameTypeTag type) const {
  const Name& found = name(type);
  return m_CookLevel >= eCookLevelFull ? found.flags.dollarNUsed
                                       : containsMacro(found.cooked, 'N');
}

const KyCXString& HxCCIdentifier::getSignalLabel() const {
  return m_SignalLabel;
}

void HxCCIdentifier::setSignalLabel(const KyCXString& label) {
  assign(m_SignalLabel, label);
}

const HxCSrcRef* HxCCIdentifier::getSourceRef() const { return m_pSourceRef; }

void HxCCIdentifier::setSourceRef(const HxCSrcRef* srcRef) {
  m_pSourceRef = srcRef;
}

const HxCSrcRef* HxCCIdentifier::getDdSourceRef() const {
  return m_pDdSourceRef;
}

void HxCCIdentifier::setDdSourceRef(const HxCSrcRef* srcRef) {
  m_pDdSourceRef = srcRef;
}

HX_BdBlock* HxCCIdentifier::getSourceIVBlock() { return m_pSourceIVBlock; }

void HxCCIdentifier::setSourceIVBlock(HX_BdBlock* block) {
  m_pSourceIVBlock = block;
}

void HxCCIdentifier::getDollarXValue(KyCXString& value) const {
  assign(value, m_DollarXValue);
}

void HxCCIdentifier::setDollarXValue(const KyCXString& value) {
  assign(m_DollarXValue, value);
}

bool operator==(const HxCCIdentifier& a, const HxCCIdentifier& b) {
  return a.getRawName(HxCCIdentifier::eActiveName) ==
         b.getRawName(HxCCIdentifier::eActiveName);
}

HxCCIdentifier& operator+=(HxCCIdentifier& id, const KyCXString& text) {
  id.changeTexts([&](const KyCXString& before) { return before + text; });
  return id;
}

HxCCIdentifier& operator+=(HxCCIdentifier& id, const char* text) {
  HX_WithinMemory([&] { id += KyCXString(text); });
  return id;
}
