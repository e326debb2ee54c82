// A string class from elsewhere, with the operations that the library may call
// and no others: changes return nothing, and nothing is written for speed.

#ifndef FOREIGN_TEXT_H
#define FOREIGN_TEXT_H

#include <algorithm>
#include <string>

#include "containers.h"

class KyCXString {
 public:
  enum ScEPosition { eFront, eMiddle, eBack };

  KyCXString() = default;
  KyCXString(const char* text) {
    while (text != nullptr && *text != 0)
      m_Units += static_cast<unsigned char>(*text++);
  }
  KyCXString(char character)
      : m_Units(1, static_cast<unsigned char>(character)) {}
  KyCXString(int value, bool, bool) : KyCXString(digits(value).c_str()) {}
  KyCXString(unsigned long value, bool, bool)
      : KyCXString(digits(value).c_str()) {}

  int length() const { return static_cast<int>(m_Units.size()); }
  bool isEmpty() const { return m_Units.empty(); }
  unsigned short operator[](int at) const {
    if (at < 0 || at >= length()) return 0;
    return static_cast<unsigned short>(m_Units[position(at)]);
  }
  const char* cstring() const {
    m_Narrow.clear();
    for (const char16_t unit : m_Units)
      m_Narrow += static_cast<char>(unit < 256 ? unit : '?');
    return m_Narrow.c_str();
  }

  void operator+=(const KyCXString& text) { m_Units += text.m_Units; }
  friend KyCXString operator+(KyCXString a, const KyCXString& b) {
    a += b;
    return a;
  }
  friend bool operator==(const KyCXString& a, const KyCXString& b) {
    return a.m_Units == b.m_Units;
  }
  int compareWith(const KyCXString& other) const {
    return m_Units.compare(other.m_Units);
  }

  int find(const KyCXString& text, int from) const {
    const auto at = m_Units.find(text.m_Units, position(from));
    return at == m_Units.npos ? -1 : static_cast<int>(at);
  }
  bool contains(const KyCXString& text) const { return find(text, 0) >= 0; }
  bool startsWith(const KyCXString& text) const {
    return m_Units.starts_with(text.m_Units);
  }
  KyCXString sub(int from, int to) const {
    KyCXString part;
    for (int at = std::max(from, 0); at <= std::min(to, length() - 1); ++at)
      part.m_Units += m_Units[position(at)];
    return part;
  }
  KyCXString head(int count) const { return sub(0, count - 1); }
  void split(char separator, leda::array<KyCXString>& parts) const {
    const auto mark = static_cast<unsigned char>(separator);
    const auto count = std::count(m_Units.begin(), m_Units.end(), mark);
    parts = leda::array<KyCXString>(static_cast<int>(count) + 1);
    int part = 0;
    for (const char16_t unit : m_Units)
      if (unit == mark)
        ++part;
      else
        parts[part].m_Units += unit;
  }

  void toLower() { change('A', 'Z', 'a' - 'A'); }
  void toUpper() { change('a', 'z', 'A' - 'a'); }
  void trim(bool leading, bool trailing) {
    while (trailing && isWhite(length() - 1)) m_Units.pop_back();
    while (leading && isWhite(0)) m_Units.erase(0, 1);
  }
  void filterAngleBrackets() {
    if ((*this)[0] == '<' && (*this)[length() - 1] == '>')
      *this = sub(1, length() - 2);
  }
  void replaceWhiteSpace(char by, bool) {
    for (int at = 0; at < length(); ++at)
      if (isWhite(at)) m_Units[position(at)] = static_cast<unsigned char>(by);
  }
  void replace(const KyCXString& what, const KyCXString& by) {
    for (int at = find(what, 0); at >= 0; at = find(what, at + by.length()))
      m_Units.replace(position(at), what.m_Units.size(), by.m_Units);
  }
  void makeCIdentifier(bool) {
    for (char16_t& unit : m_Units)
      if (!isValidForCIdentifier(static_cast<unsigned short>(unit))) unit = '_';
    if (isDigit((*this)[0])) m_Units.insert(0, 1, '_');
  }
  void shortenString(int limit, int marks, char fill, ScEPosition) {
    if (length() <= limit) return;
    const int tail = (limit - marks) / 2;
    const int front = limit - marks - tail;
    KyCXString result = head(front);
    for (int i = 0; i < marks; ++i) result += KyCXString(fill);
    result += sub(length() - tail, length() - 1);
    *this = result;
  }

  bool isValidCIdentifier() const {
    return !isEmpty() && !isDigit((*this)[0]) &&
           std::all_of(m_Units.begin(), m_Units.end(), [](char16_t unit) {
             return isValidForCIdentifier(static_cast<unsigned short>(unit));
           });
  }
  static bool isValidForCIdentifier(const unsigned short& unit) {
    return (unit >= 'a' && unit <= 'z') || (unit >= 'A' && unit <= 'Z') ||
           isDigit(unit) || unit == '_';
  }

 private:
  static std::size_t position(int at) { return static_cast<std::size_t>(at); }
  static bool isDigit(unsigned short unit) {
    return unit >= '0' && unit <= '9';
  }
  template <class Number>
  static std::string digits(Number value) {
    return std::to_string(value);
  }
  bool isWhite(int at) const {
    const unsigned short unit = (*this)[at];
    return unit == ' ' || (unit >= '\t' && unit <= '\r');
  }
  void change(char first, char last, int by) {
    for (char16_t& unit : m_Units)
      if (unit >= first && unit <= last)
        unit = static_cast<char16_t>(unit + by);
  }

  std::u16string m_Units;
  mutable std::string m_Narrow;
};

namespace leda {

inline int compare(const KyCXString& a, const KyCXString& b) {
  return a.compareWith(b);
}

}  // namespace leda

#endif  // FOREIGN_TEXT_H
