#include "host/base/HX_Text.h"

#include <vector>

namespace {

// One code point of well-formed UTF-8; \p at moves past it.
char32_t decode(const std::string& text, std::size_t& at) {
  const auto lead = static_cast<unsigned char>(text[at++]);
  if (lead < 0x80) return lead;
  const int more = lead >= 0xF0 ? 3 : lead >= 0xE0 ? 2 : 1;
  char32_t code = lead & (0x3FU >> more);
  for (int i = 0; i < more && at < text.size(); ++i)
    code = code << 6 | (static_cast<unsigned char>(text[at++]) & 0x3FU);
  return code;
}

void encode(char32_t code, std::string& text) {
  const int more = code < 0x80 ? 0 : code < 0x800 ? 1 : code < 0x10000 ? 2 : 3;
  constexpr unsigned kLeads[] = {0, 0xC0, 0xE0, 0xF0};
  text += static_cast<char>(kLeads[more] | code >> 6 * more);
  for (int i = more - 1; i >= 0; --i)
    text += static_cast<char>(0x80U | (code >> 6 * i & 0x3FU));
}

}  // namespace

KyCXString HX_FromUtf8(const std::string& utf8) {
  std::vector<unsigned short> units;
  units.reserve(utf8.size());
  for (std::size_t at = 0; at < utf8.size();) {
    char32_t code = decode(utf8, at);
    if (code > 0xFFFF) {
      code -= 0x10000;
      units.push_back(static_cast<unsigned short>(0xD800 | code >> 10));
      code = 0xDC00 | (code & 0x3FF);
    }
    units.push_back(static_cast<unsigned short>(code));
  }
  return KyCXString(units.data(), static_cast<int>(units.size()));
}

std::string HX_ToUtf8(const KyCXString& text) {
  std::string utf8;
  for (int i = 0; i < text.length(); ++i) {
    char32_t code = text[i];
    const bool isPair =
        (code & 0xFC00) == 0xD800 && (text[i + 1] & 0xFC00) == 0xDC00;
    if (isPair) code = 0x10000 + ((code & 0x3FF) << 10) + (text[++i] & 0x3FFU);
    encode(code, utf8);
  }
  return utf8;
}

std::string HX_Utf8ToLatin1(const std::string& utf8) {
  return HX_FromUtf8(utf8).cstring();
}

std::string HX_Latin1ToUtf8(const std::string& latin1) {
  return HX_ToUtf8(KyCXString(latin1.c_str()));
}
