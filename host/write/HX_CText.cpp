#include "host/write/HX_CText.h"

#include <algorithm>
#include <charconv>
#include <ostream>
#include <string_view>

namespace {

constexpr std::size_t kLineLength = 120;  // a word may be longer
constexpr std::size_t kWordLength = 300;

// Characters in UTF-8 that turn the direction of text: an editor would show
// code other than the compiler reads.
constexpr struct {
  std::string_view utf8;
  const char* shown;
} kTurning[] = {
    {"\xD8\x9C", "<U+061C>"},     {"\xE2\x80\x8E", "<U+200E>"},
    {"\xE2\x80\x8F", "<U+200F>"}, {"\xE2\x80\xAA", "<U+202A>"},
    {"\xE2\x80\xAB", "<U+202B>"}, {"\xE2\x80\xAC", "<U+202C>"},
    {"\xE2\x80\xAD", "<U+202D>"}, {"\xE2\x80\xAE", "<U+202E>"},
    {"\xE2\x81\xA6", "<U+2066>"}, {"\xE2\x81\xA7", "<U+2067>"},
    {"\xE2\x81\xA8", "<U+2068>"}, {"\xE2\x81\xA9", "<U+2069>"},
};

void showTurning(std::string& text) {
  for (const auto& [utf8, shown] : kTurning) {
    for (auto at = text.find(utf8); at != text.npos; at = text.find(utf8, at))
      text.replace(at, utf8.size(), shown);
  }
}

template <class Float>
std::string decimal(Float value, const char* suffix) {
  char text[64];
  const auto end = std::to_chars(text, text + sizeof text, value).ptr;
  std::string number(text, end);
  if (number.find_first_of(".e") == std::string::npos) number += ".0";
  return number + suffix;
}

}  // namespace

std::string HX_CommentText(const std::string& text) {
  std::string safe;
  std::size_t wordLength = 0;
  for (const char c : text) {
    const char last = safe.empty() ? ' ' : safe.back();
    const bool isPair = (last == '*' && c == '/') ||
                        (last == '/' && c == '*') || (last == '?' && c == '?');
    const bool isInsideCharacter =
        (static_cast<unsigned char>(c) & 0xC0) == 0x80;
    if (isPair || (wordLength >= kWordLength && !isInsideCharacter))
      safe += ' ';
    safe += static_cast<unsigned char>(c) < ' ' || c == '\x7F' ? ' ' : c;
    wordLength =
        safe.back() == ' ' || safe.size() < 2 || safe[safe.size() - 2] == ' '
            ? 0
            : wordLength + 1;
  }
  showTurning(safe);
  return safe;
}

std::string HX_Comment(const std::string& text) {
  return "/* " + HX_CommentText(text) + " */\n";
}

std::string HX_Wrapped(const std::string& text, const std::string& indent) {
  std::string lines;
  std::size_t begin = 0;
  while (true) {
    const std::size_t room =
        lines.empty() ? kLineLength
                      : kLineLength - std::min(indent.size(), kLineLength / 2);
    std::size_t end = std::min(text.find('\n', begin), text.size());
    if (end - begin <= room) return lines + text.substr(begin);
    std::size_t blank = text.rfind(' ', begin + room);
    if (blank == text.npos || blank <= begin) blank = text.find(' ', begin + 1);
    if (blank == text.npos || blank >= end) return lines + text.substr(begin);
    lines += text.substr(begin, blank - begin) + "\n" + indent;
    begin = blank + 1;
  }
}

std::string HX_FloatText(float value) { return decimal(value, "F"); }

std::string HX_DoubleText(double value) { return decimal(value, ""); }

std::string HX_SignedText(std::int64_t value) {
  if (value == INT32_MIN) return "(-2147483647 - 1)";
  return std::to_string(value);
}

std::string HX_WordsText(std::uint64_t bits, bool isSigned) {
  const std::string low = std::to_string(bits & 0xFFFFFFFFU) + "U";
  const auto high = static_cast<std::uint32_t>(bits >> 32);
  return "{" + low + ", " +
         (isSigned ? HX_SignedText(static_cast<std::int32_t>(high))
                   : std::to_string(high) + "U") +
         "}";
}

HX_CFile& HX_CFile::operator<<(const std::string& text) {
  m_Out << text;
  m_Line += static_cast<int>(std::count(text.begin(), text.end(), '\n'));
  return *this;
}
