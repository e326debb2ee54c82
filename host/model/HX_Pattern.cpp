// Matches a text against a sequence of items without backtracking.
//
// Plain form: try every number of repetitions for every item; exponential in
// the number of items. Idea: read the text once and keep the set of items that
// the next byte may belong to, one bit per item. Bit n means that all items
// fit.
//
// "a+b" on "aab": {a} -a-> {a, b} -a-> {a, b} -b-> {end}: the pattern fits.
#include "host/model/HX_Pattern.h"

#include <cstdint>

namespace {

using Set = std::uint64_t;

constexpr std::string_view kSpecial = "\\^$()|{}?";

// The class that begins behind '['; \p at moves behind ']', or to 0 if the
// class is open.
std::bitset<256> readClass(std::string_view pattern, std::size_t& at) {
  std::bitset<256> bytes;
  const std::size_t close = pattern.find(']', at);
  if (close == pattern.npos) {
    at = 0;
    return bytes;
  }
  for (; at < close; ++at) {
    const auto first = static_cast<unsigned char>(pattern[at]);
    const bool isRange = at + 2 < close && pattern[at + 1] == '-';
    if (isRange) at += 2;
    const auto last = static_cast<unsigned char>(pattern[at]);
    for (unsigned byte = first; byte <= last; ++byte) bytes.set(byte);
  }
  ++at;
  return bytes;
}

}  // namespace

HX_Pattern::HX_Pattern(std::string_view pattern) {
  for (std::size_t at = 0; at < pattern.size() && m_IsValid;) {
    Item item;
    const char c = pattern[at++];
    if (c == '[')
      item.bytes = readClass(pattern, at);
    else if (c == '.')
      item.bytes.set();
    else
      item.bytes.set(static_cast<unsigned char>(c));
    m_IsValid = at != 0 && kSpecial.find(c) == kSpecial.npos &&
                m_Items.size() < kMostItems;
    if (at < pattern.size() && (pattern[at] == '*' || pattern[at] == '+')) {
      item.isRepeated = true;
      item.isOptional = pattern[at++] == '*';
    }
    m_Items.push_back(item);
  }
}

bool HX_Pattern::fits(std::string_view text) const {
  // Adds the items behind an optional item.
  const auto withOptional = [this](Set set) {
    for (std::size_t i = 0; i < m_Items.size(); ++i) {
      if (m_Items[i].isOptional && (set >> i & 1) != 0) set |= Set{2} << i;
    }
    return set;
  };
  Set set = withOptional(1);
  for (const char c : text) {
    Set next = 0;
    for (std::size_t i = 0; i < m_Items.size(); ++i) {
      if ((set >> i & 1) == 0 ||
          !m_Items[i].bytes[static_cast<unsigned char>(c)])
        continue;
      next |= Set{2} << i;
      if (m_Items[i].isRepeated) next |= Set{1} << i;
    }
    set = withOptional(next);
  }
  return m_IsValid && (set >> m_Items.size() & 1) != 0;
}
