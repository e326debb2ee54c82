// Maximum segment tree: finds the next large number in a sequence whose numbers
// change.
//
//   place   0  1  2  3         HX_RankTree tree(4);
//   number  5  1  7  2         tree.findFrom(1, 6);   // 2
//
//          7                   node n covers the places of nodes 2n and 2n + 1;
//      5       7               node 1 is the root, the leaves are the last
//    5   1   7   2             nodes

#ifndef DEPENDENCYSORTING_IMPLDEPENDENCYSORTING_HX_RANKTREE_H
#define DEPENDENCYSORTING_IMPLDEPENDENCYSORTING_HX_RANKTREE_H

#include <cstddef>

#include "implContainers/HX_Vector.h"

/// Places count from 0. Every node of the tree holds the maximum of its leaves.
class HX_RankTree {
 public:
  /// A sequence of \p count numbers, all INT_MIN. Throws std::bad_alloc.
  explicit HX_RankTree(int count);

  /// Fills a place without updating the tree; build() follows the last put().
  void put(int place, int rank) { m_Largest[leafOf(place)] = rank; }
  void build();

  /// Changes one number in log n steps.
  void set(int place, int rank);

  /// RETURNS: the first place in [from, count) whose number is at least
  /// \p rank; a number of at least count if there is none.
  /// COST: log n steps, few steps if the place is near.
  int findFrom(int from, int rank) const;

 private:
  std::size_t leafOf(int place) const { return m_Leaves + HX_ToSize(place); }

  std::size_t m_Leaves;  // a power of two
  HX_Vector<int> m_Largest;
};

#endif  // DEPENDENCYSORTING_IMPLDEPENDENCYSORTING_HX_RANKTREE_H
