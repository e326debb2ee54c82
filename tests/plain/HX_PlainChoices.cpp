#include "plain/HX_PlainChoices.h"

#include <cstdio>

namespace plain {

Text Choices::text(const char* what, int most,
                   std::initializer_list<const char16_t*> pieces) {
  Text result;
  const int count = byte() % (most + 1);
  for (int i = 0; i < count; ++i)
    result += *(pieces.begin() + byte() % static_cast<int>(pieces.size()));
  if (what != nullptr && !result.empty())
    tell(std::string(" ") + what + "=" + shown(result));
  return result;
}

Text Choices::anyText() {
  Text result;
  for (int count = byte() % 24; count > 0; --count) {
    const int unit = byte();
    if (unit != 0)
      result += static_cast<char16_t>(unit | (unit < 0xF8 ? 0 : 0xFF00));
  }
  return result;
}

std::string shown(const Text& text) {
  std::string result = "\"";
  for (const char16_t c : text) {
    char unit[8];
    std::snprintf(unit, sizeof unit, c < 32 || c > 126 ? "\\u%04X" : "%c",
                  static_cast<unsigned>(c));
    result += unit;
  }
  return result + "\"";
}

namespace {

// Removes ranges, then lowers bytes, while the difference remains.
std::string smallest(std::string bytes, const Check& check) {
  int budget = 20'000;
  const auto differs = [&](const std::string& candidate) {
    return budget-- > 0 && !check(candidate, nullptr).empty();
  };
  for (std::string before; before != bytes && budget > 0;) {
    before = bytes;
    for (std::size_t size = bytes.size(); size > 0; size /= 2)
      for (std::size_t at = 0; at < bytes.size();) {
        std::string candidate = bytes;
        candidate.erase(at, size);
        if (differs(candidate))
          bytes = candidate;
        else
          at += size;
      }
    for (std::size_t at = 0; at < bytes.size(); ++at) {
      const auto byte = static_cast<unsigned char>(bytes[at]);
      for (const int lower : {0, byte / 2, byte - 1}) {
        std::string candidate = bytes;
        candidate[at] = static_cast<char>(lower);
        if (lower < 0 || lower >= byte || !differs(candidate)) continue;
        bytes = candidate;
        break;
      }
    }
  }
  return bytes;
}

}  // namespace

std::string smallestDifference(unsigned seed, int count, std::size_t length,
                               const Check& check) {
  std::mt19937 random(seed);
  for (int i = 0; i < count; ++i) {
    std::string bytes(length / 2 + random() % length, '\0');
    for (char& byte : bytes) byte = static_cast<char>(random() >> 24);
    if (check(bytes, nullptr).empty()) continue;
    const std::string found = smallest(bytes, check);
    std::string log;
    const std::string difference = check(found, &log);
    return "seed " + std::to_string(seed) + ", case " + std::to_string(i) +
           ":\n" + log + "\n" + difference;
  }
  return "";
}

}  // namespace plain
