// Substitution of macros by values that other components know.
//
// Problem: replace a macro everywhere in a name, but not inside extended macros
// and arguments of "$E(...)", in the letter cases that the caller allows.
//
// Plain form: read the name token by token, compare the text behind each '$'
// with the macro in lower or upper case, append a value or the token.
//
// Idea: search for '$' only, copy the text between two replacements in one
// piece, and build nothing at all for a name without a replacement.
//
// Example: "a$(n)$n" with macro "n" and value "v", one letter case.
//   '$' at 1: "(" begins an extended macro, the scan goes on at 5
//   '$' at 5: "n" is the macro: append "a$(n)", append "v"   -> "a$(n)v"
//
// Invariants:
// 1. The result holds the replaced form of the source before `copied`.
// 2. Both texts exist before the identifier takes a text: missing memory
//    changes nothing.
//
// The tests in tests/plain compare with the plain form.

#include <utility>

#include "Control/HX_Memory.h"
#include "Control/HX_TextCalls.h"
#include "FLAG.h"
#include "Naming/HxCNames.h"
#include "platform/datatypes/HX_DataType.h"
#include "platform/model/HxCSymbol.h"

namespace {

using NameType = HxCCIdentifier::HxENameTypeTag;

// A file name retains every macro bit but $B, $S, $I, $M, $N and $R.
constexpr unsigned int kAllMacroBits = 0xFFFFF;
constexpr unsigned int kModelObjectMacros = HxCNames::eMacroBlockName |
                                            HxCNames::eMacroSystemNumber |
                                            HxCNames::eMacroSystemId;
constexpr unsigned int kFileNameRetained =
    kAllMacroBits &
    ~(kModelObjectMacros | HxCNames::eMacroModelName |
      HxCNames::eMacroSubsystemName | HxCNames::eMacroChangeable);
static_assert(kFileNameRetained == 0xFEFC1);

enum class Match { eNone, eValue, eUpper };

// A macro name in the letter cases that count as the macro.
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
      found.toLower();
      return found == *m_pLower ? Match::eValue : Match::eNone;
    }
    if (HX_MatchesAt(text, position, *m_pLower)) return Match::eValue;
    if (m_Kind != HxCNames::eMacroKindCaseSelectsValue) return Match::eNone;
    return HX_MatchesAt(text, position, m_Upper) ? Match::eUpper : Match::eNone;
  }

 private:
  HxCNames::tagMacroKindEnum m_Kind;
  const KyCXString* m_pLower;  // the macro as given where case matters
  KyCXString m_Lower;
  KyCXString m_Upper;  // only where upper case selects the value
};

bool isLetter(const KyCXString& macro, char upper) {
  return macro.length() == 1 && (macro[0] == upper || macro[0] == upper + 32);
}

// References and flags that a name inherits from a value.
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
  return HX_WithinMemory(false,
                         [&] { return replaceAll(id, macro, value, kind); });
}

// The formal text is made first and stored last.
bool HxCNames::replaceAll(HxCCIdentifier& id, const KyCXString& macro,
                          const HxCCIdentifier& value, tagMacroKindEnum kind) {
  constexpr auto kFormal = HxCCIdentifier::eFormalName;
  KyCXString text;
  const bool inFormal = substitutedText(id.m_Formal.cooked, macro,
                                        value.m_Formal.cooked, kind, text);
  const bool inActual = substAllDollarZByValue(id, macro, value, kind,
                                               HxCCIdentifier::eActualName);
  // The actual name, put into itself, may use more macros now.
  if (&value == &id) inherit(id, macro, value);
  if (inFormal) storeSubstituted(id, macro, std::move(text), kFormal);
  return inActual || inFormal;
}

bool HxCNames::substAllDollarZByValue(HxCCIdentifier& id,
                                      const KyCXString& macro,
                                      const HxCCIdentifier& value,
                                      tagMacroKindEnum kind, NameType type) {
  KyCXString text;
  const bool replaced = substitutedText(id.name(type).cooked, macro,
                                        value.name(type).cooked, kind, text);
  inherit(id, macro, value);
  if (replaced) storeSubstituted(id, macro, std::move(text), type);
  return replaced;
}

// Level, references and flags for \p id, with or without a replacement. The
// level goes first, because the flags of a value that is \p id hang on it.
void HxCNames::inherit(HxCCIdentifier& id, const KyCXString& macro,
                       const HxCCIdentifier& value) {
  constexpr auto kRaw = HxCCIdentifier::eCookLevelRaw;
  constexpr auto kDollarE = HxCCIdentifier::eCookLevelDollarE;
  if (isLetter(macro, 'E') ||
      (value.m_CookLevel == kDollarE && id.m_CookLevel == kRaw))
    id.setCookLevel(kDollarE);
  takeOver(id, value);
}

void HxCNames::storeSubstituted(HxCCIdentifier& id, const KyCXString& macro,
                                KyCXString&& text, NameType type) {
  noteUse(id, macro, type);
  id.name(type).cooked = std::move(text);
}

// RETURNS: whether \p source holds the macro; \p result is set only then.
bool HxCNames::substitutedText(const KyCXString& source,
                               const KyCXString& macro,
                               const KyCXString& replacement,
                               tagMacroKindEnum kind, KyCXString& result) {
  int dollar = source.find('$', 0);
  if (dollar < 0) return false;

  const MacroKey key(macro, kind);
  int copied = 0;  // end of the source text taken over
  bool replaced = false;
  for (int next = 0; dollar >= 0; dollar = source.find('$', next)) {
    const Match match = key.match(source, dollar + 1);
    if (match == Match::eNone) {
      next = endOfForeignMacro(source, dollar);
      continue;
    }
    HX_AppendSub(result, source, copied, dollar - 1);
    if (match == Match::eUpper) {
      KyCXString upper(replacement);
      upper.toUpper();
      result += upper;
    } else {
      result += replacement;
    }
    next = copied = dollar + macro.length() + 1;
    replaced = true;
  }
  if (!replaced) return false;
  HX_AppendSub(result, source, copied, source.length() - 1);
  return true;
}

// Position behind the macro at \p dollar, which stays: an extended macro ends
// at ')', $E behind the argument, any other macro behind one character.
int HxCNames::endOfForeignMacro(const KyCXString& text, int dollar) {
  const unsigned short letter = text[dollar + 1];
  if (letter == '(') {
    const int close = text.find(')', dollar);
    return close < 0 ? text.length() : close + 1;
  }
  if (letter == 'E') return dollar + 2 + findDollarELength(text, dollar + 2);
  return dollar + 2;
}

// Length of the parenthesised group at \p start, 0 without a group.
// Parentheses between single quotes do not count. An unclosed group reaches to
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

// Each text becomes the template of an identifier.
void HxCNames::handleSymbolNameMacro(HxCCIdentifier& id, HxCSymbol* symbol) {
  HX_WithinMemory([&] {
    const auto replace = [&](const char* macro, const KyCXString& text,
                             tagMacroKindEnum kind) {
      HxCCIdentifier value;
      value.setTemplate(text);
      replaceAll(id, macro, value, kind);
    };
    const bool isFunction = symbol->getKind() == HxCSymbol::eFunction;
    const HX_DataType* type = symbol->getDataType();
    HX_BaseTypeProperties* properties =
        type == nullptr ? nullptr : type->getBaseTypeProperties();
    const KyCXString cut =
        properties == nullptr ? KyCXString() : *properties->getCut();
    replace("x", symbol->getDollarX(), eMacroKindAnyCase);
    replace(isFunction ? "f" : "v", symbol->getName(),
            eMacroKindCaseSelectsValue);
    replace("t", cut, eMacroKindAnyCase);
    id.setCookLevel(HxCCIdentifier::eCookLevelSymbol);
  });
}
