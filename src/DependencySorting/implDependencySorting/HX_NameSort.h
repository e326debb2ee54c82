// Orders nodes that become free together by name.

#ifndef DEPENDENCYSORTING_IMPLDEPENDENCYSORTING_HX_NAMESORT_H
#define DEPENDENCYSORTING_IMPLDEPENDENCYSORTING_HX_NAMESORT_H

#include <cstddef>
#include <span>
#include <vector>

class HxCDepSortNode;
class KyCXString;

/// The name of \p node; empty for null.
const KyCXString& HX_NameOfNode(HxCDepSortNode* node);

/// Gives the order of a selection sort that swaps the first of the smallest
/// names to the front, in about n log n steps. The object keeps its memory from
/// batch to batch.
class HX_NameSort {
 public:
  /// \p nodes must outlive the object; batches are numbers of its elements.
  explicit HX_NameSort(const std::vector<HxCDepSortNode*>& nodes)
      : m_Nodes(nodes) {}

  void sort(std::span<int> batch);

 private:
  struct Entry {
    const KyCXString* name;
    int position;  // in the batch
  };

  void selectionSort(std::span<int> batch) const;
  bool sortEntries(std::span<int> batch);
  void replaySwaps(std::span<int> batch);
  void formGroups();
  const KyCXString& nameOf(int number) const;

  const std::vector<HxCDepSortNode*>& m_Nodes;
  std::vector<Entry> m_Entries;  // ascending by name
  // Entries with one name form a group, known by the index of its first entry.
  std::vector<int> m_GroupOfEntry;
  std::vector<int> m_GroupAt;    // by position in the batch, moves along
  std::vector<int> m_Positions;  // per group a heap, the smallest at its front
  std::vector<int> m_HeapEnd;    // by group
  std::vector<int> m_Batch;      // copy of the batch
};

#endif  // DEPENDENCYSORTING_IMPLDEPENDENCYSORTING_HX_NAMESORT_H
