// Orders nodes by a list of criteria.

#ifndef DEPENDENCYSORTING_IMPLDEPENDENCYSORTING_HX_CRITERIASORT_H
#define DEPENDENCYSORTING_IMPLDEPENDENCYSORTING_HX_CRITERIASORT_H

#include "implContainers/HX_Vector.h"
#include "platform/containers/array.h"

class HxCDepSortComp;
class HxCDepSortNode;

/// Gives the order of a Quicksort by the first criterion, followed by a
/// Quicksort of every group of equals by the next criterion, and so on.
class HX_CriteriaSort {
 public:
  /// Sorts [nodes, nodes + count), none null. Sets the current criterion
  /// whenever the sort goes over to another criterion. A criterion that
  /// contradicts itself gives some order of the same nodes.
  /// COST: about n log2 n comparisons per criterion, for every input.
  /// Throws std::bad_alloc; the nodes are then in some order.
  void sort(HxCDepSortNode** nodes, int count,
            const leda::array<HxCDepSortComp*>& criteria);

 private:
  struct Range {
    int first;
    int count;
    int level;  // index of the criterion to sort by
  };

  void pushTies(HxCDepSortComp& comp, HxCDepSortNode** nodes,
                const Range& range);

  HX_Vector<Range> m_Open;  // ranges still to sort, the next range at the back
};

#endif  // DEPENDENCYSORTING_IMPLDEPENDENCYSORTING_HX_CRITERIASORT_H
