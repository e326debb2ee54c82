// Problem: sort nodes by a list of criteria, nodes equal under all criteria in
// exactly the order of HX_Quicksort(), because generated code must not change
// from release to release.
//
// Plain form: Quicksort by the first criterion, then of every group of equals
// by the second, and so on. Takes n^2 / 2 comparisons on nearly sorted input:
// 20 billion for 200000 nodes.
//
// Idea: without equals every sorting method gives the same order. So:
// 1. Input that rises throughout is done, input that falls is reversed.
// 2. Quicksort runs with a budget of 2 n log2 n comparisons; random input takes
//    1.4 n log2 n.
// 3. A part open when the budget is spent is merge sorted, which yields the
//    rank of every node; HX_RankReplay brings equals into the order of the
//    Quicksort.
//
// Example, criterion: the digit, nodes 2a 1a 2b 1b:
//   Quicksort, pivot 1b          1a 1b 2b 2a   parts 1a and 2b 2a
//   Quicksort, pivot 2a          1a 1b 2a 2b
//   the ties 1a 1b and 2a 2b go to the next criterion
//
// Invariants:
// 1. Every scan and every merge ends at the bounds of its range, whatever the
//    criterion answers; nodes move by swaps only, or as a whole permutation.
// 2. A range of m_Open lies inside one group of equals of its level - 1.
// 3. Equals exist only if compare() returned 0 for neighbours of the result,
//    and every method below compares all neighbours of its result.
//
// Tests: DependencySortingTest.IsolatedNodesSortAsInThePlainForm, and
// fuzz/HX_CheckSorter.cpp with criteria that contradict themselves.

#include "DependencySorting/implDependencySorting/HX_CriteriaSort.h"

#include <algorithm>
#include <bit>
#include <utility>

#include "DependencySorting/HxCDepSortComp.h"
#include "DependencySorting/HxCDepSortNode.h"
#include "DependencySorting/implDependencySorting/HX_RankReplay.h"
#include "implContainers/HX_MergeSort.h"
#include "implContainers/HX_Quicksort.h"

namespace {

// Comparisons per node and halving.
constexpr std::size_t kBudgetFactor = 2;

struct Entry {
  HxCDepSortNode* node;
  int place;  // before the sort
};

// RETURNS: true if some of the nodes are equal.
bool sortByRank(HxCDepSortComp& comp, HxCDepSortNode** nodes, int count) {
  HX_Vector<Entry> entries, buffer;
  entries.reserve(HX_ToSize(count));
  for (int i = 0; i < count; ++i) entries.push_back({nodes[i], i});
  HX_MergeSort(entries, buffer, [&](const Entry& a, const Entry& b) {
    return comp.compare(a.node, b.node) < 0;
  });
  HX_Vector<int> ranks(entries.size()), sorted(entries.size());
  int rank = 0;
  for (std::size_t i = 0; i < entries.size(); ++i) {
    if (i > 0 && comp.compare(entries[i - 1].node, entries[i].node) != 0)
      ++rank;
    ranks[HX_ToSize(entries[i].place)] = sorted[i] = rank;
  }
  HX_RankReplay(nodes, ranks.data(), sorted.data(), count).sort();
  return rank != count - 1;
}

// Nodes under a criterion; remembers whether the criterion met equals.
struct Sequence {
  HxCDepSortComp& comp;
  HxCDepSortNode** nodes;
  std::size_t budget;
  bool hasEquals = false;

  bool finish(const HX_Part& part) {
    const std::size_t count = HX_ToSize(part.count());
    if (budget >= count) {
      budget -= count;
      return false;
    }
    if (sortByRank(comp, nodes + part.low, part.count())) hasEquals = true;
    return true;
  }
  int compare(HxCDepSortNode* a, HxCDepSortNode* b) {
    const int order = comp.compare(a, b);
    hasEquals |= order == 0;
    return order;
  }
  int scanUp(int from, const HX_Part& part) {
    HxCDepSortNode* pivot = nodes[part.high];
    while (from < part.high && compare(nodes[from], pivot) < 0) ++from;
    return from;
  }
  int scanDown(int from, const HX_Part& part) {
    HxCDepSortNode* pivot = nodes[part.high];
    while (from >= part.low && compare(nodes[from], pivot) > 0) --from;
    return from;
  }
  void swap(int a, int b) { std::swap(nodes[a], nodes[b]); }
};

// Relations that occur between neighbours of a range.
struct Trend {
  bool rises = false;
  bool falls = false;
  bool stays = false;
};

// Stops after a rise and a fall.
Trend trendOf(HxCDepSortComp& comp, HxCDepSortNode** nodes, int count) {
  Trend trend;
  for (int i = 1; i < count; ++i) {
    const int order = comp.compare(nodes[i - 1], nodes[i]);
    (order < 0 ? trend.rises : order > 0 ? trend.falls : trend.stays) = true;
    if (trend.rises && trend.falls) break;
  }
  return trend;
}

// RETURNS: true if some of the nodes are equal.
bool sortBy(HxCDepSortComp& comp, HxCDepSortNode** nodes, int count) {
  // Nodes added in order arrive in reverse.
  const Trend trend = trendOf(comp, nodes, count);
  if (!trend.rises || !trend.falls) {
    if (trend.stays) return sortByRank(comp, nodes, count);
    if (trend.falls) std::reverse(nodes, nodes + count);
    return false;
  }
  const std::size_t size = HX_ToSize(count);
  Sequence sequence{comp, nodes, kBudgetFactor * size * std::bit_width(size)};
  HX_Quicksort(sequence, count);
  return sequence.hasEquals;
}

}  // namespace

void HX_CriteriaSort::sort(HxCDepSortNode** nodes, int count,
                           const leda::array<HxCDepSortComp*>& criteria) {
  m_Open.assign(1, {0, count, 0});
  while (!m_Open.empty()) {
    const Range range = m_Open.back();
    m_Open.pop_back();
    if (range.level == criteria.size() || range.count < 2) continue;
    HxCDepSortComp* comp = criteria[range.level];
    HxCDepSortNode::setComp(comp);
    HxCDepSortNode** const first = nodes + range.first;
    if (sortBy(*comp, first, range.count)) pushTies(*comp, first, range);
  }
}

// Leaves the groups of equals to the next criterion, the front group first.
void HX_CriteriaSort::pushTies(HxCDepSortComp& comp, HxCDepSortNode** nodes,
                               const Range& range) {
  int end = range.count;
  for (int i = range.count - 1; i >= 0; --i) {
    if (i > 0 && comp.compare(nodes[i - 1], nodes[i]) == 0) continue;
    if (end - i > 1)
      m_Open.push_back({range.first + i, end - i, range.level + 1});
    end = i;
  }
}
