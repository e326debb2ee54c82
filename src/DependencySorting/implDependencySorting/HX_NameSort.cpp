#include "DependencySorting/implDependencySorting/HX_NameSort.h"

#include <algorithm>
#include <functional>
#include <utility>

#include "DependencySorting/HxCDepSortNode.h"
#include "platform/strings/KyCXString.h"

namespace {

// Up to here the selection sort itself is the faster way.
constexpr std::size_t kSmallBatch = 8;

std::size_t at(int index) { return static_cast<std::size_t>(index); }

}  // namespace

const KyCXString& HX_NameOfNode(HxCDepSortNode* node) {
  static const KyCXString s_Empty;
  return node == nullptr ? s_Empty : node->getName();
}

void HX_NameSort::sort(std::span<int> batch) {
  if (batch.size() <= kSmallBatch) {
    selectionSort(batch);
  } else if (sortEntries(batch)) {
    replaySwaps(batch);
  } else {
    m_Batch.assign(batch.begin(), batch.end());
    for (std::size_t i = 0; i < batch.size(); ++i)
      batch[i] = m_Batch[at(m_Entries[i].position)];
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

// Sorts the entries of the batch by name, equal names by position, and tells
// whether there are equal names.
bool HX_NameSort::sortEntries(std::span<int> batch) {
  m_Entries.clear();
  for (int number : batch)
    m_Entries.push_back({&nameOf(number), static_cast<int>(m_Entries.size())});
  bool hasEqualNames = false;
  std::stable_sort(m_Entries.begin(), m_Entries.end(),
                   [&](const Entry& a, const Entry& b) {
                     const int order = a.name->compareWith(*b.name);
                     if (order == 0) hasEqualNames = true;
                     return order < 0;
                   });
  return hasEqualNames;
}

// A selection sort brings to position i the first node with the name that is
// due there, and the node that stood at i takes its place. The name due at i is
// known from the sorted entries, and i is the first position of its own name.
void HX_NameSort::replaySwaps(std::span<int> batch) {
  formGroups();
  const auto heapOf = [&](int group) {
    return std::pair(m_Positions.begin() + group,
                     m_Positions.begin() + m_HeapEnd[at(group)]);
  };
  for (std::size_t i = 0; i < batch.size(); ++i) {
    const int due = m_GroupOfEntry[i];
    const auto [first, end] = heapOf(due);
    const int smallest = *first;
    std::pop_heap(first, end, std::greater<>());
    --m_HeapEnd[at(due)];
    if (at(smallest) == i) continue;

    const auto [displacedFirst, displacedEnd] = heapOf(m_GroupAt[i]);
    std::pop_heap(displacedFirst, displacedEnd, std::greater<>());
    *(displacedEnd - 1) = smallest;
    std::push_heap(displacedFirst, displacedEnd, std::greater<>());
    std::swap(m_GroupAt[i], m_GroupAt[at(smallest)]);
    std::swap(batch[i], batch[at(smallest)]);
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
    m_GroupAt[at(entry.position)] = group;
    m_Positions[i] = entry.position;  // ascending: already a heap
    m_HeapEnd[at(group)] = static_cast<int>(i) + 1;
  }
}

const KyCXString& HX_NameSort::nameOf(int number) const {
  return HX_NameOfNode(m_Nodes[at(number)]);
}
