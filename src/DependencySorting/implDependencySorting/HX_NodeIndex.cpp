#include "DependencySorting/implDependencySorting/HX_NodeIndex.h"

#include <bit>
#include <cstdint>

namespace {

// 2^64 / golden ratio: multiplying by it spreads neighbouring addresses
// (Knuth, The Art of Computer Programming 3, 6.4).
constexpr std::uint64_t kSpread = 0x9E3779B97F4A7C15U;

}  // namespace

HX_NodeIndex::HX_NodeIndex(std::size_t count)
    : m_Slots(std::bit_ceil(2 * count + 2)),
      m_Shift(64U - static_cast<unsigned>(std::bit_width(m_Slots.size() - 1))) {
}

void HX_NodeIndex::set(const HxCDepSortNode* node, int number) {
  m_Slots[slotOf(node)] = {node, number};
}

std::size_t HX_NodeIndex::slotOf(const HxCDepSortNode* node) const {
  const std::size_t last = m_Slots.size() - 1;
  const std::uint64_t address = reinterpret_cast<std::uintptr_t>(node);
  auto slot = static_cast<std::size_t>((address * kSpread) >> m_Shift);
  while (m_Slots[slot].number >= 0 && m_Slots[slot].node != node)
    slot = (slot + 1) & last;
  return slot;
}
