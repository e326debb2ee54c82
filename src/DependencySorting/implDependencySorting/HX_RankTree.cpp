#include "DependencySorting/implDependencySorting/HX_RankTree.h"

#include <algorithm>
#include <bit>
#include <limits>

HX_RankTree::HX_RankTree(int count)
    : m_Leaves(std::bit_ceil(HX_ToSize(count))),
      m_Largest(2 * m_Leaves, std::numeric_limits<int>::min()) {}

void HX_RankTree::build() {
  for (std::size_t node = m_Leaves - 1; node > 0; --node)
    m_Largest[node] = std::max(m_Largest[2 * node], m_Largest[2 * node + 1]);
}

void HX_RankTree::set(int place, int rank) {
  std::size_t node = leafOf(place);
  m_Largest[node] = rank;
  while (node > 1) {
    node /= 2;
    const int largest = std::max(m_Largest[2 * node], m_Largest[2 * node + 1]);
    if (m_Largest[node] == largest) return;
    m_Largest[node] = largest;
  }
}

int HX_RankTree::findFrom(int from, int rank) const {
  std::size_t node = leafOf(from);
  // Upward to the nearest subtree on the right with a number large enough.
  while (m_Largest[node] < rank) {
    while (node % 2 == 1) node /= 2;  // from the root, 1, to 0
    if (node == 0) return static_cast<int>(m_Leaves);
    ++node;
  }
  // Downward to its first leaf with such a number.
  while (node < m_Leaves) {
    node *= 2;
    if (m_Largest[node] < rank) ++node;
  }
  return static_cast<int>(node - m_Leaves);
}
