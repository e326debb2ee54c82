#include "DependencySorting/implDependencySorting/HX_RankTree.h"

#include <algorithm>
#include <bit>
#include <limits>

HX_RankTree::HX_RankTree(std::size_t count)
    : m_Leaves(std::bit_ceil(count)),
      m_Largest(2 * m_Leaves, std::numeric_limits<int>::min()) {}

void HX_RankTree::build() {
  for (std::size_t node = m_Leaves - 1; node > 0; --node)
    m_Largest[node] = std::max(m_Largest[2 * node], m_Largest[2 * node + 1]);
}

void HX_RankTree::set(std::size_t place, int rank) {
  std::size_t node = m_Leaves + place;
  m_Largest[node] = rank;
  while (node > 1) {
    node /= 2;
    const int largest = std::max(m_Largest[2 * node], m_Largest[2 * node + 1]);
    if (m_Largest[node] == largest) return;
    m_Largest[node] = largest;
  }
}

std::size_t HX_RankTree::findFrom(std::size_t from, int rank) const {
  std::size_t node = m_Leaves + from;
  while (m_Largest[node] < rank) {
    while (node % 2 == 1) node /= 2;  // the root, 1, leads to 0
    if (node == 0) return m_Leaves;
    ++node;
  }
  while (node < m_Leaves) {
    node *= 2;
    if (m_Largest[node] < rank) ++node;
  }
  return node - m_Leaves;
}
