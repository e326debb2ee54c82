// Replays a Quicksort on ranked nodes in n log n steps.

#ifndef DEPENDENCYSORTING_IMPLDEPENDENCYSORTING_HX_RANKREPLAY_H
#define DEPENDENCYSORTING_IMPLDEPENDENCYSORTING_HX_RANKREPLAY_H

#include "DependencySorting/implDependencySorting/HX_RankTree.h"
#include "implContainers/HX_Quicksort.h"

class HxCDepSortNode;

/// Makes the swaps of HX_Quicksort() without visiting the places between two
/// swaps.
class HX_RankReplay {
 public:
  /// \param nodes   the nodes to sort
  /// \param ranks   rank of each node, from 0 without gaps; sorted along
  /// \param sorted  the same ranks in ascending order
  /// \param count   elements of each array; the arrays outlive the object
  /// Throws std::bad_alloc.
  HX_RankReplay(HxCDepSortNode** nodes, int* ranks, const int* sorted,
                int count);

  void sort() { HX_Quicksort(*this, m_Count); }

  // For HX_Quicksort().
  bool finish(const HX_Part& part);
  int scanUp(int from, const HX_Part& part) const;
  int scanDown(int from, const HX_Part& part) const;
  void swap(int a, int b);

 private:
  void swapBoth(int a, int b);
  int mirrored(int place) const { return m_Count - 1 - place; }

  HxCDepSortNode** m_Nodes;
  int* m_Ranks;
  const int* m_Sorted;
  int m_Count;
  HX_RankTree m_Upward;    // ranks
  HX_RankTree m_Downward;  // negated ranks at mirrored places
};

#endif  // DEPENDENCYSORTING_IMPLDEPENDENCYSORTING_HX_RANKREPLAY_H
