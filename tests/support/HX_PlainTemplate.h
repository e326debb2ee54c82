// The text rules of name templates in their plain form.

#ifndef SUPPORT_HX_PLAINTEMPLATE_H
#define SUPPORT_HX_PLAINTEMPLATE_H

#include <algorithm>
#include <cctype>
#include <string>
#include <vector>

/// Every text of 1 to \p length characters out of \p letters.
inline std::vector<std::string> HX_TextsUpTo(std::size_t length,
                                             const std::string& letters) {
  std::vector<std::string> texts{""};
  for (std::size_t i = 0; i < texts.size() && texts[i].size() < length; ++i)
    for (const char letter : letters) texts.push_back(texts[i] + letter);
  texts.erase(texts.begin());
  return texts;
}

/// The end of the token at \p at: a character, "$" and a character, "$(" up to
/// ")" or the end, or "$E" and the group in parentheses.
inline std::size_t HX_PlainTokenEnd(const std::string& form, std::size_t at) {
  if (form[at] != '$') return at + 1;
  const char letter = at + 1 < form.size() ? form[at + 1] : '\0';
  if (letter == '(') {
    const std::size_t close = form.find(')', at);
    return close == form.npos ? form.size() : close + 1;
  }
  std::size_t end = std::min(at + 2, form.size());
  if (letter != 'E' || end == form.size() || form[end] != '(') return end;
  int depth = 0;
  bool quoted = false;
  do {
    const char c = form[end++];
    quoted ^= c == '\'';
    if (!quoted) depth += c == '(' ? 1 : c == ')' ? -1 : 0;
  } while (depth > 0 && end < form.size());
  return end;
}

inline std::string HX_InCase(std::string text, int (*change)(int)) {
  for (char& c : text)
    if (static_cast<unsigned char>(c) < 128) c = static_cast<char>(change(c));
  return text;
}

/// The result of HxCNames::substAllDollarZByValue() for one name.
/// \param kind  HxCNames::tagMacroKindEnum
inline std::string HX_PlainSubstitution(const std::string& form,
                                        const std::string& macro,
                                        const std::string& value, int kind) {
  const std::string low = kind == 0 ? macro : HX_InCase(macro, std::tolower);
  const std::string high = kind == 0 ? macro : HX_InCase(macro, std::toupper);
  std::string result;
  for (std::size_t i = 0; i < form.size();) {
    if (form[i] == '$') {
      std::string key = form.substr(i + 1, macro.size());
      if (kind == 1) key = HX_InCase(key, std::tolower);
      if (key == low || (kind == 2 && key == high)) {
        result += key != low ? HX_InCase(value, std::toupper) : value;
        i += macro.size() + 1;
        continue;
      }
    }
    const std::size_t end = HX_PlainTokenEnd(form, i);
    result += form.substr(i, end - i);
    i = end;
  }
  return result;
}

#endif  // SUPPORT_HX_PLAINTEMPLATE_H
