// Orders nodes by a list of criteria.

#ifndef DEPENDENCYSORTING_IMPLDEPENDENCYSORTING_HX_CRITERIASORT_H
#define DEPENDENCYSORTING_IMPLDEPENDENCYSORTING_HX_CRITERIASORT_H

#include <cstddef>
#include <span>
#include <vector>

#include "platform/containers/array.h"

class HxCDepSortComp;
class HxCDepSortNode;

/// Gives the order of a Quicksort by each criterion in turn, applied to the
/// runs of equals that the one before left.
///
/// The Quicksort takes the last element as its pivot, which costs n^2 steps on
/// input that is nearly sorted. So it gets a budget; when that is spent, the
/// parts that are left are sorted in another way, which also ranks their nodes.
/// Only equals can tell one way from another: where there are any, the
/// Quicksort is replayed on the ranks (HX_RankReplay).
class HX_CriteriaSort {
 public:
  /// Sorts \p nodes, none null. Sets the current criterion whenever it goes
  /// over to another one.
  void sort(std::span<HxCDepSortNode*> nodes,
            const leda::array<HxCDepSortComp*>& criteria);

 private:
  using Nodes = std::span<HxCDepSortNode*>;
  struct Range {
    std::size_t first;
    std::size_t count;
    int level;  // index of the criterion to sort by
  };
  struct Entry {
    HxCDepSortNode* node;
    std::size_t position;
  };

  static bool sortBy(HxCDepSortComp& comp, Nodes nodes);
  static bool sortWithoutBudget(HxCDepSortComp& comp, Nodes nodes);
  void pushRuns(HxCDepSortComp& comp, Nodes nodes, const Range& range);

  std::vector<Range> m_Open;  // ranges still to sort, the next one at the back
};

#endif  // DEPENDENCYSORTING_IMPLDEPENDENCYSORTING_HX_CRITERIASORT_H
