#include "Naming/HxCCIdentifier.h"

#include <utility>

#include "platform/model/HX_Options.h"
#include "platform/model/HxCGlobal.h"
#include "platform/model/HxCSymbol.h"

namespace {

void shorten(KyCXString& name) {
  name.shortenString(HxCSymbol::sm_MaxNameLength, 2, '_',
                     KyCXString::ePositionMiddle);
}

bool containsMacro(const KyCXString& text, char letter) {
  for (int at = text.find('$'); at >= 0; at = text.find('$', at + 1))
    if (text[at + 1] == letter) return true;
  return false;
}

}  // namespace

HxCCIdentifier::HxCCIdentifier(const KyCXString& name) { setName(name); }

HxCCIdentifier::HxCCIdentifier(const char* name) { setName(name); }

HxCCIdentifier::~HxCCIdentifier() = default;

HxCCIdentifier& HxCCIdentifier::operator=(const KyCXString& name) {
  setName(name);
  return *this;
}

HxCCIdentifier& HxCCIdentifier::operator=(const char* name) {
  setName(name);
  return *this;
}

bool HxCCIdentifier::setName(const KyCXString& name) {
  const KyCXString text(name);  // may be one of the names reset here
  *this = HxCCIdentifier();
  const int colon = text.find(':');
  const int second = colon < 0 ? -1 : text.find(':', colon + 1);
  if (colon < 0) {
    m_Formal.raw = text;
    m_Actual.raw = text;
    m_Actual.raw += "$R";
  } else {
    m_Formal.raw = text.head(colon);
    m_Actual.raw =
        text.sub(colon + 1, (second < 0 ? text.length() : second) - 1);
  }
  m_Formal.cooked = m_Formal.raw;
  m_Actual.cooked = m_Actual.raw;
  return second < 0;
}

void HxCCIdentifier::setCookedName(const KyCXString& name,
                                   HxENameTypeTag type) {
  this->name(type).cooked = name;
}

void HxCCIdentifier::setCookedName(KyCXString&& name, HxENameTypeTag type) {
  this->name(type).cooked = std::move(name);
}

void HxCCIdentifier::addPrefix(const KyCXString& prefix) {
  const KyCXString text(prefix);  // may be one of the names changed here
  for (Name* name : {&m_Actual, &m_Formal}) {
    name->raw = text + name->raw;
    name->cooked = text + name->cooked;
  }
}

void HxCCIdentifier::addPostfix(const KyCXString& postfix) { *this += postfix; }

void HxCCIdentifier::makeCIdentifier() {
  m_Actual.cooked.makeCIdentifier(false);
  m_Formal.cooked.makeCIdentifier(false);
}

void HxCCIdentifier::adaptSize() {
  if (!getIdentifierChangeable(eActiveName)) return;
  if (!HxCGlobal::getOptions()->getLimitVariableNameLength()) return;
  shorten(m_Actual.cooked);
  shorten(m_Formal.cooked);
}

bool HxCCIdentifier::getDollarLUsed(HxENameTypeTag type) const {
  const Name& found = name(type);
  return m_CookLevel >= eCookLevelFull ? found.dollarLUsed
                                       : containsMacro(found.cooked, 'L');
}

bool HxCCIdentifier::getDollarEUsed(HxENameTypeTag type) const {
  const Name& found = name(type);
  return m_CookLevel >= eCookLevelDollarE ? found.dollarEUsed
                                          : containsMacro(found.cooked, 'E');
}

bool HxCCIdentifier::getDollarNUsed(HxENameTypeTag type) const {
  const Name& found = name(type);
  return m_CookLevel >= eCookLevelFull ? found.dollarNUsed
                                       : containsMacro(found.cooked, 'N');
}

bool operator==(const HxCCIdentifier& a, const HxCCIdentifier& b) {
  return a.getRawName(HxCCIdentifier::eActiveName) ==
         b.getRawName(HxCCIdentifier::eActiveName);
}

HxCCIdentifier& operator+=(HxCCIdentifier& id, const KyCXString& text) {
  const KyCXString tail(text);  // may be one of the names changed here
  id.m_Actual.raw += tail;
  id.m_Formal.raw += tail;
  id.m_Actual.cooked += tail;
  id.m_Formal.cooked += tail;
  return id;
}

HxCCIdentifier& operator+=(HxCCIdentifier& id, const char* text) {
  return id += KyCXString(text);
}
