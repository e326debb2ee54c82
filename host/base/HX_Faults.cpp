#include "host/base/HX_Faults.h"

#include <algorithm>
#include <iterator>

std::string HX_LineAndColumn(std::string_view text, std::size_t place) {
  const std::string_view before = text.substr(0, place);
  std::string_view line = before.substr(before.rfind('\n') + 1);
  constexpr std::string_view kByteOrderMark = "\xEF\xBB\xBF";
  if (line.starts_with(kByteOrderMark))
    line.remove_prefix(kByteOrderMark.size());
  const auto characters = std::count_if(
      line.begin(), line.end(), [](char c) { return (c & '\xC0') != '\x80'; });
  return std::to_string(1 + std::count(before.begin(), before.end(), '\n')) +
         ":" + std::to_string(1 + characters);
}

void HX_Faults::add(std::size_t place, const std::string& found,
                    const std::string& expected) {
  constexpr std::size_t kMost = 20;
  ++m_Count;
  if (m_Kept.size() == kMost) {
    if (place >= std::prev(m_Kept.end())->first) return;
    m_Kept.erase(std::prev(m_Kept.end()));
  }
  m_Kept.emplace(place, Fault{found, expected});
}

std::string HX_Faults::rest() const {
  const std::size_t more = m_Count - m_Kept.size();
  return more == 0 ? std::string()
                   : "... and " + std::to_string(more) + " more";
}
