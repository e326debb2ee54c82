#include "host/base/HX_Text.h"

#include <algorithm>
#include <iterator>
#include <vector>

namespace {

bool isControl(char c) {
  return static_cast<unsigned char>(c) < ' ' || c == '\x7F';
}

// The escape of a control character, a quotation mark or a backslash.
void appendEscape(std::string& json, char c) {
  constexpr char kDigits[] = "0123456789abcdef";
  constexpr std::string_view kPlain = "\"\\\b\f\n\r\t";
  constexpr std::string_view kShort = "\"\\bfnrt";
  json += '\\';
  if (const std::size_t at = kPlain.find(c); at != kPlain.npos) {
    json += kShort[at];
    return;
  }
  const auto code = static_cast<unsigned char>(c);
  json += "u00";
  json += kDigits[code >> 4];
  json += kDigits[code & 0xF];
}

}  // namespace

char32_t HX_DecodeUtf8(std::string_view text, std::size_t& at) {
  const auto lead = static_cast<unsigned char>(text[at++]);
  if (lead < 0x80) return lead;
  const int more = lead >= 0xF0 ? 3 : lead >= 0xE0 ? 2 : 1;
  char32_t code = lead & (0x3FU >> more);
  for (int i = 0; i < more && at < text.size(); ++i)
    code = code << 6 | (static_cast<unsigned char>(text[at++]) & 0x3FU);
  return code;
}

void HX_AppendUtf8(std::string& text, char32_t code) {
  const int more = code < 0x80 ? 0 : code < 0x800 ? 1 : code < 0x10000 ? 2 : 3;
  constexpr unsigned kLeads[] = {0, 0xC0, 0xE0, 0xF0};
  text += static_cast<char>(kLeads[more] | code >> 6 * more);
  for (int i = more - 1; i >= 0; --i)
    text += static_cast<char>(0x80U | (code >> 6 * i & 0x3FU));
}

KyCXString HX_FromUtf8(std::string_view utf8) {
  // Short texts need no memory here; a byte gives one unit at most.
  unsigned short few[256];
  std::vector<unsigned short> many;
  if (utf8.size() > std::size(few)) many.resize(utf8.size());
  unsigned short* const units = many.empty() ? few : many.data();
  int count = 0;
  for (std::size_t at = 0; at < utf8.size();) {
    char32_t code = HX_DecodeUtf8(utf8, at);
    if (code > 0xFFFF) {
      code -= 0x10000;
      units[count++] = static_cast<unsigned short>(0xD800 | code >> 10);
      code = 0xDC00 | (code & 0x3FF);
    }
    units[count++] = static_cast<unsigned short>(code);
  }
  return KyCXString(units, count);
}

std::string HX_ToUtf8(const KyCXString& text) {
  std::string utf8;
  utf8.reserve(static_cast<std::size_t>(text.length()));
  for (int i = 0; i < text.length(); ++i) {
    char32_t code = text[i];
    if (code < 0x80) {
      utf8 += static_cast<char>(code);
      continue;
    }
    const bool isPair =
        (code & 0xFC00) == 0xD800 && (text[i + 1] & 0xFC00) == 0xDC00;
    if (isPair) code = 0x10000 + ((code & 0x3FF) << 10) + (text[++i] & 0x3FFU);
    HX_AppendUtf8(utf8, code);
  }
  return utf8;
}

std::string HX_Latin1ToUtf8(const std::string& latin1) {
  return HX_ToUtf8(KyCXString(latin1.c_str()));
}

std::size_t HX_WidthOf(std::string_view utf8) {
  return static_cast<std::size_t>(std::count_if(
      utf8.begin(), utf8.end(), [](char c) { return (c & '\xC0') != '\x80'; }));
}

std::string HX_Visible(std::string_view utf8) {
  if (std::none_of(utf8.begin(), utf8.end(), isControl))
    return std::string(utf8);
  std::string visible;
  for (const char c : utf8) {
    if (isControl(c))
      appendEscape(visible, c);
    else
      visible += c;
  }
  return visible;
}

std::string HX_Quoted(std::string_view utf8) {
  constexpr std::size_t kLongest = 60;
  std::size_t end = std::min(utf8.size(), kLongest);
  while (end < utf8.size() && end > 0 && (utf8[end] & '\xC0') == '\x80') --end;
  return '"' + HX_Visible(utf8.substr(0, end)) +
         (end < utf8.size() ? "...\"" : "\"");
}

void HX_AppendJson(std::string& json, std::string_view utf8) {
  json += '"';
  for (const char c : utf8) {
    if (static_cast<unsigned char>(c) < ' ' || c == '"' || c == '\\')
      appendEscape(json, c);
    else
      json += c;
  }
  json += '"';
}
