#include "DependencySorting/implDependencySorting/HX_RankReplay.h"

#include <utility>

namespace {

std::size_t at(int index) { return static_cast<std::size_t>(index); }

}  // namespace

HX_RankReplay::HX_RankReplay(std::span<HxCDepSortNode*> nodes,
                             std::span<int> ranks, std::span<const int> sorted)
    : m_Nodes(nodes),
      m_Ranks(ranks),
      m_Sorted(sorted),
      m_Upward(ranks.size()),
      m_Downward(ranks.size()) {
  for (int i = 0; at(i) < ranks.size(); ++i) {
    m_Upward.put(at(i), ranks[at(i)]);
    m_Downward.put(mirrored(i), -ranks[at(i)]);
  }
  m_Upward.build();
  m_Downward.build();
}

void HX_RankReplay::run() {
  // The larger part waits, so that no more than log2 n parts do.
  std::vector<HX_Part> waiting = {{0, static_cast<int>(m_Nodes.size()) - 1}};
  while (!waiting.empty()) {
    HX_Part part = waiting.back();
    waiting.pop_back();
    while (!isDecided(part)) {
      const int pivot = HX_Partition(*this, part);
      HX_Part smaller = {part.low, pivot - 1};
      HX_Part larger = {pivot + 1, part.high};
      if (smaller.count() > larger.count()) std::swap(smaller, larger);
      waiting.push_back(larger);
      part = smaller;
    }
    placeByRank(part);
  }
}

int HX_RankReplay::scanUp(int from, const HX_Part& part) const {
  return static_cast<int>(m_Upward.findFrom(at(from), m_Ranks[at(part.high)]));
}

// No rank to the left of the part is larger than one in it, so that the search
// ends just there at the latest.
int HX_RankReplay::scanDown(int from, const HX_Part& part) const {
  if (from < part.low) return from;
  const std::size_t found =
      m_Downward.findFrom(mirrored(from), -m_Ranks[at(part.high)]);
  if (found >= m_Ranks.size()) return -1;
  return static_cast<int>(m_Ranks.size() - 1 - found);
}

void HX_RankReplay::swap(int a, int b) {
  const bool areEqual = m_Ranks[at(a)] == m_Ranks[at(b)];
  swapBoth(a, b);
  if (areEqual) return;
  for (int place : {a, b}) {
    m_Upward.set(at(place), m_Ranks[at(place)]);
    m_Downward.set(mirrored(place), -m_Ranks[at(place)]);
  }
}

// True if no two ranks of the part are equal: it holds the nodes that belong to
// its places, and ranks have no gaps.
bool HX_RankReplay::isDecided(const HX_Part& part) const {
  if (part.count() < 2) return true;
  return m_Sorted[at(part.high)] - m_Sorted[at(part.low)] ==
         part.high - part.low;
}

// Leaves the trees behind: nothing looks into this part any more, and to its
// right it only counts that no rank in it is too large.
void HX_RankReplay::placeByRank(const HX_Part& part) {
  for (int i = part.low; i < part.high; ++i) {
    const int lowest = m_Sorted[at(part.low)];
    while (m_Ranks[at(i)] - lowest != i - part.low)
      swapBoth(i, part.low + m_Ranks[at(i)] - lowest);
  }
}

void HX_RankReplay::swapBoth(int a, int b) {
  std::swap(m_Nodes[at(a)], m_Nodes[at(b)]);
  std::swap(m_Ranks[at(a)], m_Ranks[at(b)]);
}
