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
  const bool inActual = substAllDollarZByValue(id, macro, value, kind,
                                               HxCCIdentifier::eActualName);
  const bool inFormal = substAllDollarZByValue(id, macro, value, kind,
                                               HxCCIdentifier::eFormalName);
  return inActual || inFormal;
}

bool HxCNames::substAllDollarZByValue(HxCCIdentifier& id,
                                      const KyCXString& macro,
                                      const HxCCIdentifier& value,
                                      tagMacroKindEnum kind, NameType type) {
  takeOver(id, value);
  const KyCXString& source = id.getCookedName(type);
  int dollar = source.find('$');
  if (dollar < 0) return false;

  KyCXString lowerKey(macro);
  KyCXString upperKey(macro);
  if (kind != eMacroKindExact) {
    lowerKey.toLower();
    upperKey.toUpper();
  }
  KyCXString result;
  int copied = 0;  // the source is taken over up to here
  bool replaced = false;
  while (dollar >= 0) {
    KyCXString key = source.sub(dollar + 1, dollar + macro.length());
    if (kind == eMacroKindAnyCase) key.toLower();
    const bool isLower = key == lowerKey;
    int next = 0;
    if (isLower || key == upperKey) {
      result.appendSub(source, copied, dollar - 1);
      if (!isLower && kind == eMacroKindCaseSelectsValue) {
        KyCXString upper(value.getCookedName(type));
        result += upper.toUpper();
      } else {
        result += value.getCookedName(type);
      }
      next = copied = dollar + macro.length() + 1;
      replaced = true;
    } else {
      next = endOfForeignMacro(source, dollar);
    }
    dollar = source.find('$', next);
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
