// Finds the next large number in a sequence whose numbers change.

#ifndef DEPENDENCYSORTING_IMPLDEPENDENCYSORTING_HX_RANKTREE_H
#define DEPENDENCYSORTING_IMPLDEPENDENCYSORTING_HX_RANKTREE_H

#include <cstddef>
#include <vector>

/// A binary tree in which each node holds the maximum of its two children.
class HX_RankTree {
 public:
  /// A sequence of \p count numbers, all of them smaller than any other.
  explicit HX_RankTree(std::size_t count);

  /// Fills a place without bringing the tree up to date; build() does.
  void put(std::size_t place, int rank) { m_Largest[m_Leaves + place] = rank; }
  void build();

  /// Changes one number: log n steps.
  void set(std::size_t place, int rank);

  /// The first place at or after \p from whose number is at least \p rank, the
  /// length of the sequence or more if there is none: log n steps, few if the
  /// place is near.
  std::size_t findFrom(std::size_t from, int rank) const;

 private:
  std::size_t m_Leaves;  // a power of two; the children of n are 2n and 2n + 1
  std::vector<int> m_Largest;
};

#endif  // DEPENDENCYSORTING_IMPLDEPENDENCYSORTING_HX_RANKTREE_H
