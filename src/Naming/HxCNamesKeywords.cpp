// Keyword dictionary, validity of names, and suffixes of distinct names.

#include <algorithm>
#include <cstdint>
#include <iterator>
#include <memory>
#include <utility>

#include "Control/ERR_Messages.h"
#include "Control/HX_Memory.h"
#include "Control/HX_SelfCheck.h"
#include "Naming/HxCNamesScan.h"
#include "implContainers/HX_LetterCode.h"
#include "platform/model/HX_Options.h"
#include "platform/model/HxCGlobal.h"
#include "platform/model/HxCSymbol.h"

namespace {

// ISO/IEC 9899:1990, 6.1.1.
constexpr const char* kCKeywords[] = {
    "auto",     "break",  "case",    "char",   "const",    "continue",
    "default",  "do",     "double",  "else",   "enum",     "extern",
    "float",    "for",    "goto",    "if",     "int",      "long",
    "register", "return", "short",   "signed", "sizeof",   "static",
    "struct",   "switch", "typedef", "union",  "unsigned", "void",
    "volatile", "while"};
static_assert(sizeof kCKeywords / sizeof *kCKeywords == 32);

using Dictionary =
    leda::dictionary<KyCXString, HxCNames::tagHxEDictEntryType, leda::ab_tree>;

// Bloom filter in front of the dictionary: lengths of the words by first
// character, one bit per length (the last bit for all longer words). Answers
// most lookups of names without touching the dictionary.
std::uint64_t s_wordLengths[256];
// The filter needs texts that are equal only unit by unit.
bool s_filterIsSound = false;

std::uint64_t lengthBit(const KyCXString& text) {
  return std::uint64_t{1} << std::min(text.length(), 63);
}

bool mayBeWord(const KyCXString& text) {
  return !s_filterIsSound ||
         (s_wordLengths[text[0] & 0xFF] & lengthBit(text)) != 0;
}

void noteWord(const KyCXString& text) {
  s_wordLengths[text[0] & 0xFF] |= lengthBit(text);
}

// The string class of a host may fold letter case or skip characters in
// leda::compare. Then two of these 257 texts are equal.
bool comparesUnitByUnit() {
  leda::dictionary<KyCXString, bool, leda::ab_tree> different;
  different.insert(KyCXString(), true);
  for (int unit = 0; unit < 256; ++unit)
    different.insert(KyCXString(static_cast<char>(unit)), true);
  return different.size() == 257;
}

}  // namespace

leda::dictionary<KyCXString, HxCNames::tagHxEDictEntryType, leda::ab_tree>*
    HxCNames::s_pKeywordDict = nullptr;

void HxCNames::boot() {
  HX_WithinMemory([] {
    std::unique_ptr<Dictionary> words(new Dictionary);
    for (const char* keyword : kCKeywords)
      words->insert(keyword, eDictCKeyword);
    const bool isSound = comparesUnitByUnit();
    shutdown();
    s_pKeywordDict = words.release();
    for (const char* keyword : kCKeywords) noteWord(keyword);
    s_filterIsSound = isSound;
  });
}

void HxCNames::shutdown() {
  delete s_pKeywordDict;
  s_pKeywordDict = nullptr;
  s_filterIsSound = false;
  std::fill(std::begin(s_wordLengths), std::end(s_wordLengths), 0);
}

void HxCNames::addToKeywordDict(const KyCXString& word,
                                tagHxEDictEntryType type) {
  HX_WithinMemory([&] {
    if (!HX_Assert(s_pKeywordDict != nullptr, kNamesErrorCode)) return;
    s_pKeywordDict->insert(word, type);
    noteWord(word);
  });
}

HxCNames::HxEVariableNameTag HxCNames::checkCVariableName(
    const KyCXString& name) {
  if (name.isEmpty()) return eVariableNameEmpty;
  if (s_pKeywordDict != nullptr && mayBeWord(name)) {
    if (const auto entry = s_pKeywordDict->lookup(name)) {
      switch (s_pKeywordDict->inf(entry)) {
        case eDictCKeyword:
          return eVariableNameCKeyword;
        case eDictBaseTypeName:
          return eVariableNameBaseType;
        case eDictUserTypeName:
          return eVariableNameUserType;
      }
      return eVariableNameOtherWord;
    }
  }
  return name.isValidCIdentifier() ? eVariableNameValid
                                   : eVariableNameNoCIdentifier;
}

bool HxCNames::isStringValidCVariableName(const KyCXString& name) {
  const HxEVariableNameTag answer = checkCVariableName(name);
  // A message may take memory.
  HX_WithinMemory([&] {
    if (answer != eVariableNameEmpty)
      HX_Assert(s_pKeywordDict != nullptr, kNamesErrorCode);
    if (answer == eVariableNameCKeyword) ERR_Msg408(name.cstring());
    if (answer == eVariableNameBaseType) ERR_Msg409(name.cstring());
    if (answer == eVariableNameUserType) ERR_Msg410(name.cstring());
    HX_DebugCheck(answer != eVariableNameOtherWord, "0");
  });
  return answer == eVariableNameValid;
}

bool HxCNames::isFileNameValid(KyCXString& name) {
  for (int i = 0; i < name.length(); ++i) {
    if (name[i] != '-' && !KyCXString::isValidForCIdentifier(name[i]))
      return false;
  }
  return !name.isEmpty();
}

bool HxCNames::isFileNameValid(HxCCIdentifier& identifier) {
  return isFileNameValid(identifier.name(kActive).cooked);
}

void HxCNames::appendSuffix(KyCXString& name, int index) {
  HX_WithinMemory([&] {
    const HX_LetterCode code(index < 0 ? 0 : index);
    int kept = name.length();
    if (HxCGlobal::getOptions()->getLimitVariableNameLength())
      kept = std::min(kept, HxCSymbol::sm_MaxNameLength - code.length() - 1);
    KyCXString result = name.head(kept);
    result += '_';
    result += code.text();
    name = std::move(result);
  });
}
