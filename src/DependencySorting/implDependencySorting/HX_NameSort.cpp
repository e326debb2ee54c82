// Problem: sort a batch by name, nodes with equal names in exactly the order of
// a selection sort with swaps, because generated code must not change from
// release to release.
//
// Plain form: selectionSort() below, n^2 / 2 comparisons of names, 5 billion
// for a batch of 100000.
//
// Idea: a stable merge sort tells the name due at every place. If all names
// differ, the order is found. Otherwise only the swaps are replayed: at place i
// arrives the first remaining node with the name due at i, and the node of
// place i goes where the arrived node was. One heap of positions per name finds
// the first remaining node in log n steps.
//
// Example, batch b1 a1 b2 a2, due a a b b, heaps a {1 3} and b {0 2}:
//   i = 0: due a, first at 1; swap   a1 b1 b2 a2   a {3}, b {1 2}
//   i = 1: due a, first at 3; swap   a1 a2 b2 b1   a {},  b {2 3}
//   i = 2, 3: due b, in place        a1 a2 b2 b1
//
// Invariants, before step i:
// 1. The heaps hold the positions i, i + 1, ..., each in the heap of its name.
// 2. So position i is the smallest position of its heap.
// 3. The heap of the name due at i is not empty.
//
// Test: DependencySortingTest.RandomUseSortsAsInThePlainForm.

#include "DependencySorting/implDependencySorting/HX_NameSort.h"

#include <algorithm>
#include <functional>
#include <new>
#include <utility>

#include "DependencySorting/HxCDepSortNode.h"
#include "implContainers/HX_MergeSort.h"
#include "platform/strings/KyCXString.h"

namespace {

// Largest batch for which the selection sort itself is faster.
constexpr std::size_t kSmallBatch = 8;

}  // namespace

const KyCXString& HX_NameOfNode(HxCDepSortNode* node) {
  // Never destroyed: a static object of the host may sort while the program
  // ends.
  alignas(KyCXString) static unsigned char s_Place[sizeof(KyCXString)];
  static const KyCXString* const s_Empty = new (s_Place) KyCXString;
  return node == nullptr ? *s_Empty : node->getName();
}

void HX_NameSort::sort(std::span<int> batch) {
  if (batch.size() <= kSmallBatch) {
    selectionSort(batch);
  } else if (sortEntries(batch)) {
    replaySwaps(batch);
  } else {
    m_Batch.assign(batch.begin(), batch.end());
    for (std::size_t i = 0; i < batch.size(); ++i)
      batch[i] = m_Batch[HX_ToSize(m_Entries[i].position)];
  }
}

void HX_NameSort::selectionSort(std::span<int> batch) const {
  for (std::size_t i = 0; i + 1 < batch.size(); ++i) {
    std::size_t smallest = i;
    for (std::size_t j = i + 1; j < batch.size(); ++j) {
      if (nameOf(batch[j]).compareWith(nameOf(batch[smallest])) < 0)
        smallest = j;
    }
    std::swap(batch[i], batch[smallest]);
  }
}

// Sorts the entries of the batch by name, equal names by position.
// RETURNS: true if some names are equal.
bool HX_NameSort::sortEntries(std::span<int> batch) {
  m_Entries.clear();
  for (int number : batch)
    m_Entries.push_back({&nameOf(number), static_cast<int>(m_Entries.size())});
  bool hasEqualNames = false;
  HX_MergeSort(m_Entries, m_Buffer, [&](const Entry& a, const Entry& b) {
    const int order = a.name->compareWith(*b.name);
    if (order == 0) hasEqualNames = true;
    return order < 0;
  });
  return hasEqualNames;
}

void HX_NameSort::replaySwaps(std::span<int> batch) {
  formGroups();
  const auto heapOf = [&](int group) {
    return std::pair(m_Positions.begin() + group,
                     m_Positions.begin() + m_HeapEnd[HX_ToSize(group)]);
  };
  for (std::size_t i = 0; i < batch.size(); ++i) {
    const int due = m_GroupOfEntry[i];
    const auto [first, end] = heapOf(due);
    const int smallest = *first;
    std::pop_heap(first, end, std::greater<>());
    --m_HeapEnd[HX_ToSize(due)];
    if (HX_ToSize(smallest) == i) continue;

    const auto [displacedFirst, displacedEnd] = heapOf(m_GroupAt[i]);
    std::pop_heap(displacedFirst, displacedEnd, std::greater<>());
    *(displacedEnd - 1) = smallest;
    std::push_heap(displacedFirst, displacedEnd, std::greater<>());
    std::swap(m_GroupAt[i], m_GroupAt[HX_ToSize(smallest)]);
    std::swap(batch[i], batch[HX_ToSize(smallest)]);
  }
}

void HX_NameSort::formGroups() {
  const std::size_t count = m_Entries.size();
  m_GroupOfEntry.resize(count);
  m_GroupAt.resize(count);
  m_Positions.resize(count);
  m_HeapEnd.resize(count);
  int group = 0;
  for (std::size_t i = 0; i < count; ++i) {
    const Entry& entry = m_Entries[i];
    if (i > 0 && entry.name->compareWith(*m_Entries[i - 1].name) != 0)
      group = static_cast<int>(i);
    m_GroupOfEntry[i] = group;
    m_GroupAt[HX_ToSize(entry.position)] = group;
    m_Positions[i] = entry.position;  // ascending: already a heap
    m_HeapEnd[HX_ToSize(group)] = static_cast<int>(i) + 1;
  }
}

const KyCXString& HX_NameSort::nameOf(int number) const {
  return HX_NameOfNode(m_Nodes[HX_ToSize(number)]);
}
