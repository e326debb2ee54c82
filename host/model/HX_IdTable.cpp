#include "host/model/HX_IdTable.h"

#include <functional>

int HX_IdTable::entry(std::string_view id) {
  const auto hash =
      static_cast<std::uint32_t>(std::hash<std::string_view>()(id));
  const std::size_t mask = m_Slots.size() - 1;
  std::size_t slot = hash & mask;
  for (; m_Slots[slot] != kNone; slot = (slot + 1) & mask) {
    const int number = m_Slots[slot];
    if (m_Entries[static_cast<std::size_t>(number)].hash == hash &&
        text(number) == id)
      return number;
  }
  const int number = static_cast<int>(m_Entries.size());
  m_Entries.push_back({static_cast<std::uint32_t>(m_Text.size()),
                       static_cast<std::uint32_t>(id.size()), hash, kNone});
  m_Text += id;
  m_Slots[slot] = number;
  if (m_Entries.size() * 2 > m_Slots.size()) grow();
  return number;
}

void HX_IdTable::grow() {
  std::vector<int> slots(m_Slots.size() * 2, kNone);
  const std::size_t mask = slots.size() - 1;
  for (std::size_t number = 0; number < m_Entries.size(); ++number) {
    std::size_t slot = m_Entries[number].hash & mask;
    while (slots[slot] != kNone) slot = (slot + 1) & mask;
    slots[slot] = static_cast<int>(number);
  }
  m_Slots.swap(slots);
}
