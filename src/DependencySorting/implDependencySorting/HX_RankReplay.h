// Replays a Quicksort on ranked nodes.

#ifndef DEPENDENCYSORTING_IMPLDEPENDENCYSORTING_HX_RANKREPLAY_H
#define DEPENDENCYSORTING_IMPLDEPENDENCYSORTING_HX_RANKREPLAY_H

#include <cstddef>
#include <span>
#include <vector>

#include "DependencySorting/implDependencySorting/HX_Partition.h"
#include "DependencySorting/implDependencySorting/HX_RankTree.h"

class HxCDepSortNode;

/// Makes the swaps of HX_Partition() without walking from one to the next: two
/// trees over the ranks find the places where the scans stop.
///
/// Each swap of a partition moves one node into either part, so that all
/// partitions together make at most n log n swaps, however uneven they are. A
/// part whose ranks all differ has only one order and is put into it directly.
class HX_RankReplay {
 public:
  /// \param nodes   the nodes to sort
  /// \param ranks   their ranks, from 0 without gaps; sorted along
  /// \param sorted  the same ranks in ascending order
  HX_RankReplay(std::span<HxCDepSortNode*> nodes, std::span<int> ranks,
                std::span<const int> sorted);

  void run();

  // For HX_Partition().
  int scanUp(int from, const HX_Part& part) const;
  int scanDown(int from, const HX_Part& part) const;
  void swap(int a, int b);

 private:
  bool isDecided(const HX_Part& part) const;
  void placeByRank(const HX_Part& part);
  void swapBoth(int a, int b);
  std::size_t mirrored(int place) const {
    return m_Ranks.size() - 1 - static_cast<std::size_t>(place);
  }

  std::span<HxCDepSortNode*> m_Nodes;
  std::span<int> m_Ranks;
  std::span<const int> m_Sorted;
  HX_RankTree m_Upward;    // the ranks
  HX_RankTree m_Downward;  // the ranks negated, the last one first: the next
                           // large one is the previous small one
};

#endif  // DEPENDENCYSORTING_IMPLDEPENDENCYSORTING_HX_RANKREPLAY_H
