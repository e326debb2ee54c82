#include "host/import/HX_PartText.h"

#include <algorithm>
#include <cstdint>
#include <cstring>

namespace {

constexpr char kReplacement[] = "\xEF\xBF\xBD";

unsigned byteAt(std::string_view text, std::size_t at) {
  return static_cast<unsigned char>(text[at]);
}

// The bytes of the character at `at`, 0 for a malformed
// character.
std::size_t characterLength(std::string_view text, std::size_t at) {
  const unsigned first = byteAt(text, at);
  if (first < 0x80) return 1;
  const std::size_t length = first < 0xC2   ? 0
                             : first < 0xE0 ? 2
                             : first < 0xF0 ? 3
                             : first < 0xF5 ? 4
                                            : 0;
  if (length == 0 || text.size() - at < length) return 0;
  for (std::size_t i = 1; i < length; ++i) {
    if ((byteAt(text, at + i) & 0xC0U) != 0x80) return 0;
  }
  // The second byte decides on overlong forms, surrogates, and the last plane.
  const unsigned second = byteAt(text, at + 1);
  if (first == 0xE0 && second < 0xA0) return 0;
  if (first == 0xED && second > 0x9F) return 0;
  if (first == 0xF0 && second < 0x90) return 0;
  if (first == 0xF4 && second > 0x8F) return 0;
  return length;
}

}  // namespace

std::size_t HX_FindBadUtf8(std::string_view text) {
  std::size_t at = 0;
  while (at < text.size()) {
    std::uint64_t eight = 0;
    if (text.size() - at >= sizeof eight) {
      std::memcpy(&eight, text.data() + at, sizeof eight);
      if ((eight & 0x8080808080808080U) == 0) {
        at += sizeof eight;
        continue;
      }
    }
    const std::size_t length = characterLength(text, at);
    if (length == 0) return at;
    at += length;
  }
  return std::string_view::npos;
}

std::string HX_OneLine(std::string_view text) {
  std::string line;
  line.reserve(text.size());
  for (std::size_t at = 0; at < text.size();) {
    const std::size_t length = characterLength(text, at);
    if (length == 0)
      line += kReplacement;
    else if (byteAt(text, at) < ' ' || byteAt(text, at) == 0x7F)
      line += ' ';
    else
      line.append(text, at, length);
    at += std::max<std::size_t>(length, 1);
  }
  return line;
}

std::string HX_PlaceOf(std::string_view text, std::size_t offset) {
  const std::string_view before = text.substr(0, offset);
  const auto lines = std::count(before.begin(), before.end(), '\n');
  const std::size_t feed = before.rfind('\n');
  const std::size_t column =
      feed == std::string_view::npos ? before.size() : before.size() - feed - 1;
  return std::to_string(lines + 1) + ":" + std::to_string(column + 1);
}
