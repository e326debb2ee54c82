#include "host/base/HX_Faults.h"

#include <algorithm>
#include <iterator>

namespace {

std::string textOf(const std::vector<HX_Diagnostic>& list) {
  std::string lines;
  for (const HX_Diagnostic& fault : list)
    lines += (lines.empty() ? "" : "\n") + HX_PlaceOf(fault) + fault.text;
  return lines;
}

}  // namespace

HX_DocumentError::HX_DocumentError(const std::vector<HX_Diagnostic>& list)
    : std::runtime_error(textOf(list)), faults(list) {}

HX_TextPlace HX_PlaceIn(std::string_view text, std::size_t place) {
  const std::string_view before = text.substr(0, place);
  std::string_view line = before.substr(before.rfind('\n') + 1);
  constexpr std::string_view kByteOrderMark = "\xEF\xBB\xBF";
  if (line.starts_with(kByteOrderMark))
    line.remove_prefix(kByteOrderMark.size());
  const auto characters = std::count_if(
      line.begin(), line.end(), [](char c) { return (c & '\xC0') != '\x80'; });
  const auto lines = std::count(before.begin(), before.end(), '\n');
  return {static_cast<int>(1 + lines), static_cast<int>(1 + characters)};
}

std::string HX_LineAndColumn(std::string_view text, std::size_t place) {
  const HX_TextPlace found = HX_PlaceIn(text, place);
  return std::to_string(found.line) + ":" + std::to_string(found.column);
}

void HX_Faults::add(std::size_t place, const std::string& found,
                    const std::string& expected, HX_MessageNumber number) {
  constexpr std::size_t kMost = 20;
  ++m_Count;
  if (m_Kept.size() == kMost) {
    if (place >= std::prev(m_Kept.end())->first) return;
    m_Kept.erase(std::prev(m_Kept.end()));
  }
  m_Kept.emplace(place, Fault{found, expected, number});
}

void HX_Faults::addRest(std::vector<HX_Diagnostic>& list) const {
  const std::size_t more = m_Count - m_Kept.size();
  if (more > 0)
    list.push_back({kHxMoreFaults, 2,
                    "... and " + std::to_string(more) + " more", "", ""});
}
