// Substitution of macros by values that other components know.

#include "FLAG.h"
#include "Naming/HxCNames.h"
#include "platform/datatypes/HX_DataType.h"
#include "platform/model/HxCSymbol.h"

namespace {

using NameType = HxCCIdentifier::HxENameTypeTag;

// Macros of a file name that are expanded at once.
constexpr unsigned int kFileNameRetained = 0xFEFC1;
constexpr unsigned int kModelObjectMacros = HxCNames::eMacroBlockName |
                                            HxCNames::eMacroSystemNumber |
                                            HxCNames::eMacroSystemId;

enum class Match { eNone, eValue, eUpper };

// A macro name in the forms in which it is looked for.
class MacroKey {
 public:
  MacroKey(const KyCXString& macro, HxCNames::tagMacroKindEnum kind)
      : m_Kind(kind), m_pLower(&macro) {
    if (kind != HxCNames::eMacroKindAnyCase &&
        kind != HxCNames::eMacroKindCaseSelectsValue)
      return;
    m_Lower = macro;
    m_Lower.toLower();
    m_pLower = &m_Lower;
    if (kind == HxCNames::eMacroKindCaseSelectsValue) {
      m_Upper = macro;
      m_Upper.toUpper();
    }
  }

  MacroKey(const MacroKey&) = delete;
  MacroKey& operator=(const MacroKey&) = delete;

  Match match(const KyCXString& text, int position) const {
    if (m_Kind == HxCNames::eMacroKindAnyCase) {
      KyCXString found = text.sub(position, position + m_pLower->length() - 1);
      return found.toLower() == *m_pLower ? Match::eValue : Match::eNone;
    }
    if (text.matchesAt(position, *m_pLower)) return Match::eValue;
    if (m_Kind != HxCNames::eMacroKindCaseSelectsValue) return Match::eNone;
    return text.matchesAt(position, m_Upper) ? Match::eUpper : Match::eNone;
  }

 private:
  HxCNames::tagMacroKindEnum m_Kind;
  const KyCXString* m_pLower;  // the macro itself where case matters
  KyCXString m_Lower;
  KyCXString m_Upper;  // only where upper case selects the value
};

bool isLetter(const KyCXString& macro, char upper) {
  return macro.length() == 1 && (macro[0] == upper || macro[0] == upper + 32);
}

// References and flags that the name with the value in it inherits.
void takeOver(HxCCIdentifier& id, const HxCCIdentifier& value) {
  constexpr NameType kActive = HxCCIdentifier::eActiveName;
  if (value.getDdSourceRef() != nullptr)
    id.setDdSourceRef(value.getDdSourceRef());
  if (value.getSourceRef() != nullptr) id.setSourceRef(value.getSourceRef());
  if (value.getIdentifierChangeable(kActive))
    id.setIdentifierChangeable(true, kActive);
  if (value.getDollarLUsed(kActive)) id.setDollarLUsed(true, kActive);
  if (value.getDollarEUsed(kActive)) id.setDollarEUsed(true, kActive);
  if (value.getDollarNUsed(kActive)) id.setDollarNUsed(true, kActive);
}

void noteUse(HxCCIdentifier& id, const KyCXString& macro, NameType type) {
  if (isLetter(macro, 'E')) id.setDollarEUsed(true, type);
  if (isLetter(macro, 'L')) id.setDollarLUsed(true, type);
  if (isLetter(macro, 'N')) id.setDollarNUsed(true, type);
}

}  // namespace

bool HxCNames::substAllDollarZByValue(HxCCIdentifier& id,
                                      const KyCXString& macro,
                                      const HxCCIdentifier& value,
                                      tagMacroKindEnum kind) {
  if (isLetter(macro, 'E')) id.setCookLevel(HxCCIdentifier::eCookLevelDollarE);
  if (value.getCookLevel() == HxCCIdentifier::eCookLevelDollarE &&
      id.getCookLevel() == HxCCIdentifier::eCookLevelRaw)
    id.setCookLevel(HxCCIdentifier::eCookLevelDollarE);
  takeOver(id, value);
  const bool inActual = substAllDollarZByValue(id, macro, value, kind,
                                               HxCCIdentifier::eActualName);
  // Put into itself, the actual name may use macros now that it did not.
  if (&value == &id) takeOver(id, value);
  const bool inFormal = substAllDollarZByValue(id, macro, value, kind,
                                               HxCCIdentifier::eFormalName);
  return inActual || inFormal;
}

bool HxCNames::substAllDollarZByValue(HxCCIdentifier& id,
                                      const KyCXString& macro,
                                      const HxCCIdentifier& value,
                                      tagMacroKindEnum kind, NameType type) {
  const KyCXString& source = id.getCookedName(type);
  int dollar = source.find('$');
  if (dollar < 0) return false;

  const MacroKey key(macro, kind);
  const KyCXString& replacement = value.getCookedName(type);
  KyCXString result;
  int copied = 0;  // the source is taken over up to here
  bool replaced = false;
  for (int next = 0; dollar >= 0; dollar = source.find('$', next)) {
    const Match match = key.match(source, dollar + 1);
    if (match == Match::eNone) {
      next = endOfForeignMacro(source, dollar);
      continue;
    }
    result.appendSub(source, copied, dollar - 1);
    if (match == Match::eUpper)
      result += KyCXString(replacement).toUpper();
    else
      result += replacement;
    next = copied = dollar + macro.length() + 1;
    replaced = true;
  }
  if (!replaced) return false;
  result.appendSub(source, copied, source.length() - 1);
  noteUse(id, macro, type);
  id.setCookedName(result, type);
  return true;
}

// The position behind the macro at \p dollar that is copied unchanged: an
// extended one up to its ')', $E with its argument, or '$' and one character.
int HxCNames::endOfForeignMacro(const KyCXString& text, int dollar) {
  const unsigned short letter = text[dollar + 1];
  if (letter == '(') {
    const int close = text.find(')', dollar);
    return close < 0 ? text.length() : close + 1;
  }
  if (letter == 'E') return dollar + 2 + findDollarELength(text, dollar + 2);
  return dollar + 2;
}

// The length of the parenthesised group at \p start, 0 if there is none.
// Parentheses between single quotes do not count; an unclosed group reaches to
// the end of the text.
int HxCNames::findDollarELength(const KyCXString& text, int start) {
  if (start < 0 || start >= text.length() || text[start] != '(') return 0;
  int depth = 1;
  bool quoted = false;
  int end = start + 1;
  for (; end < text.length() && depth > 0; ++end) {
    const unsigned short unit = text[end];
    if (unit == '\'') quoted = !quoted;
    if (quoted) continue;
    if (unit == '(') ++depth;
    if (unit == ')') --depth;
  }
  return end - start;
}

bool HxCNames::handleFileNameMacro(HxCCIdentifier& id, bool useModelContext) {
  unsigned int retained = kFileNameRetained;
  if (!useModelContext && id.getSourceRef() == nullptr)
    retained |= kModelObjectMacros;
  return createNameFromForm(id, nullptr, retained, 0, false);
}

void HxCNames::handleSymbolNameMacro(HxCCIdentifier& id, HxCSymbol* symbol) {
  substAllDollarZByValue(id, "x", HxCCIdentifier(symbol->getDollarX()),
                         eMacroKindAnyCase);
  const bool isFunction = symbol->getKind() == HxCSymbol::eFunction;
  substAllDollarZByValue(id, isFunction ? "f" : "v",
                         HxCCIdentifier(symbol->getName()),
                         eMacroKindCaseSelectsValue);
  const HX_DataType* type = symbol->getDataType();
  HX_BaseTypeProperties* properties =
      type == nullptr ? nullptr : type->getBaseTypeProperties();
  const KyCXString cut =
      properties == nullptr ? KyCXString() : *properties->getCut();
  substAllDollarZByValue(id, "t", HxCCIdentifier(cut), eMacroKindAnyCase);
  id.setCookLevel(HxCCIdentifier::eCookLevelSymbol);
}
