// Texts of the plain form: 16-bit units, with the few rules that names need.

#ifndef PLAIN_HX_PLAINTEXT_H
#define PLAIN_HX_PLAINTEXT_H

#include <string>
#include <vector>

namespace plain {

using Text = std::u16string;

inline Text wide(const std::string& text) {
  Text result;
  for (const char c : text) result += static_cast<unsigned char>(c);
  return result;
}

/// The 8-bit form: '?' for a unit above 255.
inline std::string narrow(const Text& text) {
  std::string result;
  for (const char16_t c : text) result += static_cast<char>(c > 255 ? '?' : c);
  return result;
}

inline Text decimal(long long value) { return wide(std::to_string(value)); }

inline bool isDigit(char16_t c) { return c >= '0' && c <= '9'; }
inline bool isLower(char16_t c) { return c >= 'a' && c <= 'z'; }
inline bool isUpper(char16_t c) { return c >= 'A' && c <= 'Z'; }
inline bool isBlank(char16_t c) { return c == ' ' || (c >= 9 && c <= 13); }
inline bool isIdentifierUnit(char16_t c) {
  return isDigit(c) || isLower(c) || isUpper(c) || c == '_';
}

inline Text lower(Text text) {
  for (char16_t& c : text)
    if (isUpper(c)) c = static_cast<char16_t>(c + 32);
  return text;
}
inline Text upper(Text text) {
  for (char16_t& c : text)
    if (isLower(c)) c = static_cast<char16_t>(c - 32);
  return text;
}

inline bool isCIdentifier(const Text& text) {
  for (const char16_t c : text)
    if (!isIdentifierUnit(c)) return false;
  return !text.empty() && !isDigit(text[0]);
}
inline Text cIdentifier(const Text& text) {
  Text result = !text.empty() && isDigit(text[0]) ? u"_" : u"";
  for (const char16_t c : text) result += isIdentifierUnit(c) ? c : u'_';
  return result;
}

inline Text trimmed(Text text) {
  while (!text.empty() && isBlank(text.front())) text.erase(0, 1);
  while (!text.empty() && isBlank(text.back())) text.pop_back();
  return text;
}
inline Text withoutAngleBrackets(const Text& text) {
  const bool hasBoth =
      text.size() >= 2 && text.front() == '<' && text.back() == '>';
  return hasBoth ? text.substr(1, text.size() - 2) : text;
}
inline Text withBlanks(Text text) {
  for (char16_t& c : text)
    if (isBlank(c)) c = ' ';
  return text;
}

/// At most \p length units: both ends with "__" in the middle.
inline Text shortened(const Text& text, std::size_t length) {
  if (text.size() <= length) return text;
  const std::size_t tail = (length - 2) / 2;
  return text.substr(0, length - 2 - tail) + u"__" +
         text.substr(text.size() - tail);
}

inline std::vector<Text> split(const Text& text, char16_t separator) {
  std::vector<Text> parts(1);
  for (const char16_t c : text)
    if (c == separator)
      parts.emplace_back();
    else
      parts.back() += c;
  return parts;
}

/// The units in the closed range [\p from, \p to], as far as inside.
inline Text sub(const Text& text, std::size_t from, std::size_t to) {
  return from >= text.size() || to + 1 <= from
             ? Text()
             : text.substr(from, to - from + 1);
}

}  // namespace plain

#endif  // PLAIN_HX_PLAINTEXT_H
