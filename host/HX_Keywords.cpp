#include "host/HX_Keywords.h"

#include <fstream>

HX_Keywords::HX_Keywords() {
  HxCNames::boot();  // enters the keywords of C90 on its own account
  for (const char* word :
       {"auto",     "break",  "case",    "char",   "const",    "continue",
        "default",  "do",     "double",  "else",   "enum",     "extern",
        "float",    "for",    "goto",    "if",     "int",      "long",
        "register", "return", "short",   "signed", "sizeof",   "static",
        "struct",   "switch", "typedef", "union",  "unsigned", "void",
        "volatile", "while"})
    m_Words.emplace(word, HxCNames::eDictCKeyword);
}

HX_Keywords::~HX_Keywords() { HxCNames::shutdown(); }

bool HX_Keywords::loadList(const std::string& folder, const std::string& list) {
  std::ifstream file(folder + "/" + list + ".txt");
  if (!file) return false;
  for (std::string line; std::getline(file, line);) {
    if (!line.empty() && line[0] != '#') add(line, HxCNames::eDictCKeyword);
  }
  return true;
}

void HX_Keywords::add(const std::string& word,
                      HxCNames::tagHxEDictEntryType type) {
  m_Words[word] = type;
  m_Names.addToKeywordDict(KyCXString(word.c_str()), type);
}

const char* HX_Keywords::isReserved(const std::string& name) const {
  static constexpr const char* kShown[] = {"keyword", "base type name",
                                           "type name"};
  const auto found = m_Words.find(name);
  return found == m_Words.end() ? nullptr : kShown[found->second];
}
