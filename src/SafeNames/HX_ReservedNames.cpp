#include "SafeNames/HX_ReservedNames.h"

#include <cstdio>
#include <cstring>
#include <string>
#include <string_view>

#include "Control/HX_Memory.h"
#include "SafeNames/implSafeNames/HX_TextLines.h"
#include "implContainers/HX_HashTable.h"
#include "implContainers/HX_PlainArray.h"
#include "implContainers/HX_TextArena.h"

namespace {

using hx_detail::isDigit;
using hx_detail::isLower;
using hx_detail::isUpper;

using Name = std::string_view;

bool startsWith(Name name, Name head) {
  return name.substr(0, head.size()) == head;
}

// Head and a lower case letter.
template <int length>
bool isHeadAndLower(Name name, const char (&head)[length]) {
  return name.size() >= length && startsWith(name, head) &&
         isLower(name[length - 1]);
}

struct PatternRow {
  unsigned int bit;
  const char* name;
  bool (*matches)(Name name);  // of a name that is not empty
};

// In the order of the test.
constexpr PatternRow kPatterns[] = {
    {HX_ReservedNames::ePatternUnderscoreCapital, "underscore-capital",
     [](Name n) { return n.size() > 1 && n[0] == '_' && isUpper(n[1]); }},
    {HX_ReservedNames::ePatternFirstUnderscores, "underscores-first",
     [](Name n) { return startsWith(n, "__"); }},
    {HX_ReservedNames::ePatternUnderscores, "underscores",
     [](Name n) { return n.find("__") != Name::npos; }},
    {HX_ReservedNames::ePatternFileUnderscore, "underscore-file",
     [](Name n) { return n[0] == '_'; }},
    {HX_ReservedNames::ePatternStr, "str",
     [](Name n) { return isHeadAndLower(n, "str"); }},
    {HX_ReservedNames::ePatternMem, "mem",
     [](Name n) { return isHeadAndLower(n, "mem"); }},
    {HX_ReservedNames::ePatternWcs, "wcs",
     [](Name n) { return isHeadAndLower(n, "wcs"); }},
    {HX_ReservedNames::ePatternIs, "is",
     [](Name n) { return isHeadAndLower(n, "is"); }},
    {HX_ReservedNames::ePatternTo, "to",
     [](Name n) { return isHeadAndLower(n, "to"); }},
    {HX_ReservedNames::ePatternErrno, "E",
     [](Name n) {
       return n.size() > 1 && n[0] == 'E' && (isUpper(n[1]) || isDigit(n[1]));
     }},
    {HX_ReservedNames::ePatternSignal, "SIG",
     [](Name n) { return startsWith(n, "SIG"); }},
    {HX_ReservedNames::ePatternLocale, "LC_",
     [](Name n) { return startsWith(n, "LC_"); }},
    {HX_ReservedNames::ePatternType, "_t",
     [](Name n) { return n.size() > 1 && n.substr(n.size() - 2) == "_t"; }},
};

// Word of a line, without comment and surrounding blanks.
Name wordOf(Name line) {
  line = line.substr(0, line.find('#'));
  const std::size_t from = line.find_first_not_of(" \t");
  if (from == Name::npos) return {};
  return line.substr(from, line.find_last_not_of(" \t") - from + 1);
}

// False if the file cannot be opened or read to its end.
bool readWhole(const char* path, std::string& content) {
  std::FILE* const file = std::fopen(path, "rb");
  if (file == nullptr) return false;
  char block[4096];
  bool isRead = true;
  // Missing memory must not leave the file open.
  const bool isKept = HX_WithinMemory([&] {
    std::size_t count = 0;
    while ((count = std::fread(block, 1, sizeof block, file)) != 0)
      content.append(block, count);
    isRead = std::ferror(file) == 0;
  });
  std::fclose(file);
  return isRead && isKept;
}

}  // namespace

struct HX_ReservedNames::Words : HX_Allocated {
  struct Word {
    const char* text;
    const char* profile;
  };

  // Null for any other text.
  const Word* find(Name wanted) const {
    const auto* const slot =
        index.find(hx_detail::keyOf(wanted),
                   [&](unsigned int at) { return wanted == words[at].text; });
    return slot == nullptr ? nullptr : &words[slot->value];
  }

  // False, with nothing changed, without memory.
  bool add(Name text, const char* profile) {
    if (find(text) != nullptr) return true;
    const char* const kept = texts.add(text.data(), text.size());
    if (kept == nullptr || !words.append(Word{kept, profile})) return false;
    if (index.add(hx_detail::keyOf(text), words.size() - 1)) return true;
    words.dropLast();
    return false;
  }

  void dropLast() {
    const unsigned int last = words.size() - 1;
    index.erase(index.find(hx_detail::keyOf(words[last].text),
                           [last](unsigned int at) { return at == last; }));
    words.dropLast();
  }

  HX_PlainArray<Word> words;              // in the order of their addition
  HX_HashTable<int, unsigned int> index;  // positions, by the hash of the text
  HX_TextArena texts;
};

HX_ReservedNames::HX_ReservedNames() : m_pWords(new Words) {}

HX_ReservedNames::~HX_ReservedNames() { delete m_pWords; }

bool HX_ReservedNames::readText(const char* profile, const char* text,
                                std::size_t length, HX_TextFaults& faults) {
  if (m_pWords == nullptr) return false;
  return HX_WithinMemory(false, [&] {
    bool isGood = true;
    const Name whole(text, length);
    hx_detail::forEachLine(whole, [&](Name line, int number) {
      const Name word = wordOf(line);
      if (word.empty() || hx_detail::isIdentifier(word)) return;
      isGood = false;
      faults.add(number,
                 ("expected one C identifier, found " + hx_detail::quoted(word))
                     .c_str());
    });
    if (!isGood) return false;

    const unsigned int before = m_pWords->words.size();
    const char* const kept = m_pWords->texts.add(profile, std::strlen(profile));
    bool hasMemory = kept != nullptr;
    hx_detail::forEachLine(whole, [&](Name line, int) {
      const Name word = wordOf(line);
      if (hasMemory && !word.empty()) hasMemory = m_pWords->add(word, kept);
    });
    if (hasMemory) return true;
    while (m_pWords->words.size() > before) m_pWords->dropLast();
    faults.add(0, "no memory for the words");
    return false;
  });
}

bool HX_ReservedNames::readFile(const char* profile, const char* path,
                                HX_TextFaults& faults) {
  return HX_WithinMemory(false, [&] {
    std::string content;
    if (readWhole(path, content))
      return readText(profile, content.data(), content.size(), faults);
    faults.add(0, "the file cannot be read");
    return false;
  });
}

int HX_ReservedNames::wordCount() const {
  return m_pWords == nullptr ? 0 : static_cast<int>(m_pWords->words.size());
}

const char* HX_ReservedNames::word(int index) const {
  return m_pWords->words[static_cast<unsigned int>(index)].text;
}

const char* HX_ReservedNames::profileOf(int index) const {
  return m_pWords->words[static_cast<unsigned int>(index)].profile;
}

HX_ReservedNames::Reservation HX_ReservedNames::find(const KyCXString& name,
                                                     bool isAtFileScope) const {
  Reservation found;
  const char* const text = name.cstring();
  const Words::Word* const word =
      m_pWords == nullptr ? nullptr : m_pWords->find(text);
  if (word != nullptr)
    found.profile = word->profile;
  else
    found.pattern = matching(name, m_Patterns, isAtFileScope);
  return found;
}

unsigned int HX_ReservedNames::matching(const KyCXString& name,
                                        unsigned int patterns,
                                        bool isAtFileScope) {
  if (!isAtFileScope)
    patterns &= ~static_cast<unsigned int>(ePatternFileUnderscore);
  if (patterns == 0 || name.isEmpty()) return 0;
  for (const PatternRow& row : kPatterns)
    if ((patterns & row.bit) != 0 && row.matches(name.cstring()))
      return row.bit;
  return 0;
}

const char* HX_ReservedNames::patternName(unsigned int pattern) {
  for (const PatternRow& row : kPatterns)
    if (row.bit == pattern) return row.name;
  return nullptr;
}

unsigned int HX_ReservedNames::patternOf(const char* name) {
  for (const PatternRow& row : kPatterns)
    if (std::strcmp(row.name, name) == 0) return row.bit;
  return 0;
}
