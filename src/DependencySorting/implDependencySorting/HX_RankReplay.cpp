// Problem: bring ranked nodes into exactly the order of HX_Quicksort(), equals
// included.
//
// Plain form: HX_Quicksort() itself. The scans take n^2 / 2 steps when the
// pivots lie near the ends of the parts: 20 billion for 200000 nodes.
//
// Idea: the swaps are few, only the steps between swaps are many. Every swap
// moves a node into the smaller part, so all partitions together make at most
// n log2 n swaps. A segment tree over the ranks finds the end of a scan upward
// in log2 n steps. A second tree over the negated ranks in reverse finds the
// end of a scan downward.
//
// Example, ranks 0 1 2 3 0; | | encloses the part:
//   |0 1 2 3 0|  pivot 0: both scans stop at place 0; swap places 0 and 4
//   0|1 2 3 0|   pivot 0: scans stop at places 1 and 0; swap places 1 and 4
//   0 0|2 3 1|   all ranks differ: place nodes by rank
//   0 0 1 2 3
//
// Invariants:
// 1. Ranks left of a part <= ranks of the part <= ranks right of the part.
//    So scanDown() ends at part.low - 1 at the latest.
// 2. The ranks of places [low, high] of an open part are a permutation of
//    m_Sorted[low .. high].
// 3. The trees hold the ranks of all open parts. For a finished part they hold
//    the same ranks in another order, which is enough for invariant 1.
//
// Test: DependencySortingTest.IsolatedNodesSortAsInThePlainForm.

#include "DependencySorting/implDependencySorting/HX_RankReplay.h"

#include <utility>

HX_RankReplay::HX_RankReplay(HxCDepSortNode** nodes, int* ranks,
                             const int* sorted, int count)
    : m_Nodes(nodes),
      m_Ranks(ranks),
      m_Sorted(sorted),
      m_Count(count),
      m_Upward(count),
      m_Downward(count) {
  for (int i = 0; i < count; ++i) {
    m_Upward.put(i, ranks[i]);
    m_Downward.put(mirrored(i), -ranks[i]);
  }
  m_Upward.build();
  m_Downward.build();
}

// A part whose ranks all differ has one order only. Ranks have no gaps, so the
// ends of a part without equals are as far apart in rank as in place.
bool HX_RankReplay::finish(const HX_Part& part) {
  const int lowest = m_Sorted[part.low];
  if (m_Sorted[part.high] - lowest != part.high - part.low) return false;
  for (int i = part.low; i < part.high; ++i) {
    while (m_Ranks[i] - lowest != i - part.low)
      swapBoth(i, part.low + m_Ranks[i] - lowest);
  }
  return true;
}

int HX_RankReplay::scanUp(int from, const HX_Part& part) const {
  return m_Upward.findFrom(from, m_Ranks[part.high]);
}

int HX_RankReplay::scanDown(int from, const HX_Part& part) const {
  if (from < part.low) return from;
  const int found = m_Downward.findFrom(mirrored(from), -m_Ranks[part.high]);
  return found < m_Count ? mirrored(found) : -1;
}

void HX_RankReplay::swap(int a, int b) {
  swapBoth(a, b);
  if (m_Ranks[a] == m_Ranks[b]) return;
  for (int place : {a, b}) {
    m_Upward.set(place, m_Ranks[place]);
    m_Downward.set(mirrored(place), -m_Ranks[place]);
  }
}

void HX_RankReplay::swapBoth(int a, int b) {
  std::swap(m_Nodes[a], m_Nodes[b]);
  std::swap(m_Ranks[a], m_Ranks[b]);
}
