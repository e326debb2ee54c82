// Finds the number of a node from its pointer.

#ifndef DEPENDENCYSORTING_IMPLDEPENDENCYSORTING_HX_NODEINDEX_H
#define DEPENDENCYSORTING_IMPLDEPENDENCYSORTING_HX_NODEINDEX_H

#include <cstddef>
#include <vector>

class HxCDepSortNode;

/// A hash table of fixed capacity with linear probing; a standard map would
/// take most of the time of a sort. It is only asked, never walked, so that
/// addresses do not reach the order of the result.
class HX_NodeIndex {
 public:
  /// Has room for \p count nodes.
  explicit HX_NodeIndex(std::size_t count);

  /// Sets the number of \p node, from 0; an earlier number is replaced. Null
  /// is a node like any other.
  void set(const HxCDepSortNode* node, int number);

  /// -1 for a node without a number.
  int find(const HxCDepSortNode* node) const {
    return m_Slots[slotOf(node)].number;
  }

 private:
  struct Slot {
    const HxCDepSortNode* node = nullptr;
    int number = -1;  // -1: the slot is free
  };

  // The slot of the node, or the free one where it belongs.
  std::size_t slotOf(const HxCDepSortNode* node) const;

  std::vector<Slot> m_Slots;  // a power of two, at most half of them taken
  unsigned m_Shift;           // leaves the upper bits that number the slots
};

#endif  // DEPENDENCYSORTING_IMPLDEPENDENCYSORTING_HX_NODEINDEX_H
