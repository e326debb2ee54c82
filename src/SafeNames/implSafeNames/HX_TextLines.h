// Lines of a text file, whichever system wrote the file.

#ifndef SAFENAMES_IMPLSAFENAMES_HX_TEXTLINES_H
#define SAFENAMES_IMPLSAFENAMES_HX_TEXTLINES_H

#include <algorithm>
#include <cstddef>
#include <cstring>
#include <string>
#include <string_view>

namespace hx_detail {

/// Calls \p visit with each line of \p text and the number of the line, from 1.
/// A byte order mark in front and a carriage return at the end of a line are
/// left out.
template <class Visit>
void forEachLine(std::string_view text, Visit visit) {
  constexpr std::string_view kByteOrderMark = "\xEF\xBB\xBF";
  if (text.substr(0, 3) == kByteOrderMark) text.remove_prefix(3);
  for (int number = 1; !text.empty(); ++number) {
    const std::size_t end = std::min(text.find('\n'), text.size());
    std::string_view line = text.substr(0, end);
    if (!line.empty() && line.back() == '\r') line.remove_suffix(1);
    visit(line, number);
    text.remove_prefix(std::min(end + 1, text.size()));
  }
}

inline bool isDigit(char c) { return c >= '0' && c <= '9'; }
inline bool isUpper(char c) { return c >= 'A' && c <= 'Z'; }
inline bool isLower(char c) { return c >= 'a' && c <= 'z'; }

/// Whether \p text is a C identifier.
inline bool isIdentifier(std::string_view text) {
  if (text.empty() || isDigit(text.front())) return false;
  return std::all_of(text.begin(), text.end(), [](char c) {
    return isDigit(c) || isUpper(c) || isLower(c) || c == '_';
  });
}

/// \p text in quotes for a message: at most 40 bytes, control characters and
/// bytes above 126 as "\x1b".
inline std::string quoted(std::string_view text) {
  constexpr std::size_t kLongest = 40;
  constexpr char kDigits[] = "0123456789abcdef";
  std::string shown = "'";
  for (const char c : text.substr(0, kLongest)) {
    const auto byte = static_cast<unsigned char>(c);
    if (byte >= 32 && byte < 127) {
      shown += c;
      continue;
    }
    shown += "\\x";
    shown += kDigits[byte / 16];
    shown += kDigits[byte % 16];
  }
  return shown + (text.size() > kLongest ? "...'" : "'");
}

/// A key of HX_KeyTable for \p text.
inline int keyOf(std::string_view text) {
  const std::size_t hash = std::hash<std::string_view>()(text);
  return static_cast<int>(hash ^ (hash >> 16 >> 16));
}

}  // namespace hx_detail

#endif  // SAFENAMES_IMPLSAFENAMES_HX_TEXTLINES_H
