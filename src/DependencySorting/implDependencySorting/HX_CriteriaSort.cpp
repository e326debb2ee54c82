#include "DependencySorting/implDependencySorting/HX_CriteriaSort.h"

#include <algorithm>
#include <bit>
#include <utility>

#include "DependencySorting/HxCDepSortComp.h"
#include "DependencySorting/HxCDepSortNode.h"
#include "DependencySorting/implDependencySorting/HX_Partition.h"
#include "DependencySorting/implDependencySorting/HX_RankReplay.h"

namespace {

using Nodes = std::span<HxCDepSortNode*>;

// Comparisons per node and halving. Random input takes 1.4.
constexpr std::size_t kBudgetFactor = 2;

std::size_t at(int index) { return static_cast<std::size_t>(index); }

// Nodes under a criterion that remembers whether it met equals. Every sort has
// to compare the neighbours of its result, and so meets them if there are any.
struct Sequence {
  HxCDepSortComp& comp;
  Nodes nodes;
  bool hasEquals = false;

  int compare(HxCDepSortNode* a, HxCDepSortNode* b) {
    const int order = comp.compare(a, b);
    hasEquals |= order == 0;
    return order;
  }
  int scanUp(int from, const HX_Part& part) {
    HxCDepSortNode* pivot = nodes[at(part.high)];
    while (from < part.high && compare(nodes[at(from)], pivot) < 0) ++from;
    return from;
  }
  int scanDown(int from, const HX_Part& part) {
    HxCDepSortNode* pivot = nodes[at(part.high)];
    while (from >= part.low && compare(nodes[at(from)], pivot) > 0) --from;
    return from;
  }
  void swap(int a, int b) { std::swap(nodes[at(a)], nodes[at(b)]); }
};

// How the neighbours of a range stand to each other.
struct Trend {
  bool rises = false;
  bool falls = false;
  bool stays = false;
};

// Stops as soon as it has seen a rise and a fall.
Trend trendOf(HxCDepSortComp& comp, Nodes nodes) {
  Trend trend;
  for (std::size_t i = 1; i < nodes.size(); ++i) {
    const int order = comp.compare(nodes[i - 1], nodes[i]);
    (order < 0 ? trend.rises : order > 0 ? trend.falls : trend.stays) = true;
    if (trend.rises && trend.falls) break;
  }
  return trend;
}

}  // namespace

void HX_CriteriaSort::sort(Nodes nodes,
                           const leda::array<HxCDepSortComp*>& criteria) {
  m_Open.assign(1, {0, nodes.size(), 0});
  while (!m_Open.empty()) {
    const Range range = m_Open.back();
    m_Open.pop_back();
    if (range.level == criteria.size() || range.count < 2) continue;
    HxCDepSortComp* comp = criteria[range.level];
    HxCDepSortNode::setComp(comp);
    const Nodes part = nodes.subspan(range.first, range.count);
    if (sortBy(*comp, part)) pushRuns(*comp, part, range);
  }
}

// True if some of the nodes are equal.
bool HX_CriteriaSort::sortBy(HxCDepSortComp& comp, Nodes nodes) {
  // Nodes that were added in order arrive in reverse.
  const Trend trend = trendOf(comp, nodes);
  if (!trend.rises || !trend.falls) {
    if (trend.stays) return sortWithoutBudget(comp, nodes);
    if (trend.falls) std::reverse(nodes.begin(), nodes.end());
    return false;
  }

  Sequence sequence{comp, nodes};
  std::size_t budget =
      kBudgetFactor * nodes.size() * std::bit_width(nodes.size());
  // The larger part waits, so that no more than log2 n parts do.
  std::vector<HX_Part> waiting = {{0, static_cast<int>(nodes.size()) - 1}};
  while (!waiting.empty()) {
    HX_Part part = waiting.back();
    waiting.pop_back();
    while (part.count() > 1) {
      const std::size_t count = at(part.count());
      if (budget < count) {
        sequence.hasEquals |=
            sortWithoutBudget(comp, nodes.subspan(at(part.low), count));
        break;
      }
      budget -= count;
      const int pivot = HX_Partition(sequence, part);
      HX_Part smaller = {part.low, pivot - 1};
      HX_Part larger = {pivot + 1, part.high};
      if (smaller.count() > larger.count()) std::swap(smaller, larger);
      waiting.push_back(larger);
      part = smaller;
    }
  }
  return sequence.hasEquals;
}

// Gives the same order in about n log n steps; true if some of the nodes are
// equal.
bool HX_CriteriaSort::sortWithoutBudget(HxCDepSortComp& comp, Nodes nodes) {
  std::vector<Entry> entries;
  entries.reserve(nodes.size());
  for (HxCDepSortNode* node : nodes) entries.push_back({node, entries.size()});
  std::stable_sort(entries.begin(), entries.end(),
                   [&](const Entry& a, const Entry& b) {
                     return comp.compare(a.node, b.node) < 0;
                   });
  std::vector<int> ranks(nodes.size()), sorted(nodes.size());
  int rank = 0;
  for (std::size_t i = 0; i < entries.size(); ++i) {
    if (i > 0 && comp.compare(entries[i - 1].node, entries[i].node) != 0)
      ++rank;
    ranks[entries[i].position] = sorted[i] = rank;
  }
  HX_RankReplay(nodes, ranks, sorted).run();
  return sorted.back() != static_cast<int>(sorted.size()) - 1;
}

// Leaves the runs of equals to the next criterion, the front one first.
void HX_CriteriaSort::pushRuns(HxCDepSortComp& comp, Nodes nodes,
                               const Range& range) {
  std::size_t end = nodes.size();
  for (std::size_t i = nodes.size(); i-- > 0;) {
    if (i > 0 && comp.compare(nodes[i - 1], nodes[i]) == 0) continue;
    if (end - i > 1)
      m_Open.push_back({range.first + i, end - i, range.level + 1});
    end = i;
  }
}
