// Keyword dictionary, validity of names, and suffixes that make them distinct.

#include <algorithm>
#include <cstdint>
#include <iterator>

#include "Control/ERR_Messages.h"
#include "Control/HX_SelfCheck.h"
#include "Naming/HxCNames.h"
#include "platform/model/HX_Options.h"
#include "platform/model/HxCGlobal.h"
#include "platform/model/HxCSymbol.h"

namespace {

constexpr char kErrorCode[] = __FILE__ "_";

// ISO/IEC 9899:1990, 6.1.1.
constexpr const char* kCKeywords[] = {
    "auto",     "break",  "case",    "char",   "const",    "continue",
    "default",  "do",     "double",  "else",   "enum",     "extern",
    "float",    "for",    "goto",    "if",     "int",      "long",
    "register", "return", "short",   "signed", "sizeof",   "static",
    "struct",   "switch", "typedef", "union",  "unsigned", "void",
    "volatile", "while"};
static_assert(sizeof kCKeywords / sizeof *kCKeywords == 32);

constexpr int kLetters = 26;

// For each first character the lengths of the dictionary's words, one bit per
// length (the last one stands for all longer words): nearly every name that is
// no word is turned away here.
std::uint64_t s_wordLengths[256];

std::uint64_t lengthBit(const KyCXString& text) {
  return std::uint64_t{1} << std::min(text.length(), 63);
}

bool mayBeWord(const KyCXString& text) {
  return (s_wordLengths[text[0] & 0xFF] & lengthBit(text)) != 0;
}

void noteWord(const KyCXString& text) {
  s_wordLengths[text[0] & 0xFF] |= lengthBit(text);
}

// The letters of a bijective base-26 numeral, least significant first.
KyCXString letterCode(int index) {
  KyCXString code;
  for (;;) {
    code += static_cast<char>('a' + index % kLetters);
    index /= kLetters;
    if (index == 0) return code;
    --index;
  }
}

}  // namespace

leda::dictionary<KyCXString, HxCNames::tagHxEDictEntryType, leda::ab_tree>*
    HxCNames::s_pKeywordDict = nullptr;

void HxCNames::boot() {
  shutdown();
  s_pKeywordDict =
      new leda::dictionary<KyCXString, tagHxEDictEntryType, leda::ab_tree>;
  for (const char* keyword : kCKeywords) {
    s_pKeywordDict->insert(keyword, eDictCKeyword);
    noteWord(keyword);
  }
}

void HxCNames::shutdown() {
  delete s_pKeywordDict;
  s_pKeywordDict = nullptr;
  std::fill(std::begin(s_wordLengths), std::end(s_wordLengths), 0);
}

void HxCNames::addToKeywordDict(const KyCXString& word,
                                tagHxEDictEntryType type) {
  if (!HX_Assert(s_pKeywordDict != nullptr, kErrorCode)) return;
  s_pKeywordDict->insert(word, type);
  noteWord(word);
}

bool HxCNames::isStringValidCVariableName(const KyCXString& name) {
  if (name.isEmpty()) return false;
  if (!HX_Assert(s_pKeywordDict != nullptr, kErrorCode))
    return name.isValidCIdentifier();
  if (!mayBeWord(name)) return name.isValidCIdentifier();
  const auto entry = s_pKeywordDict->lookup(name);
  if (!entry) return name.isValidCIdentifier();
  switch (s_pKeywordDict->inf(entry)) {
    case eDictCKeyword:
      ERR_Msg408(name.cstring());
      return false;
    case eDictBaseTypeName:
      ERR_Msg409(name.cstring());
      return false;
    case eDictUserTypeName:
      ERR_Msg410(name.cstring());
      return false;
  }
  HX_DebugCheck(false, "0");
  return false;
}

bool HxCNames::isFileNameValid(KyCXString& name) {
  for (int i = 0; i < name.length(); ++i) {
    if (name[i] != '-' && !KyCXString::isValidForCIdentifier(name[i]))
      return false;
  }
  return !name.isEmpty();
}

bool HxCNames::isFileNameValid(HxCCIdentifier& identifier) {
  KyCXString name(identifier.getCookedName(kActive));
  return isFileNameValid(name);
}

void HxCNames::appendSuffix(KyCXString& name, int index) {
  const KyCXString code = letterCode(index < 0 ? 0 : index);
  int kept = name.length();
  if (HxCGlobal::getOptions()->getLimitVariableNameLength())
    kept = std::min(kept, HxCSymbol::sm_MaxNameLength - code.length() - 1);
  name = name.head(kept);
  name += '_';
  name += code;
}
