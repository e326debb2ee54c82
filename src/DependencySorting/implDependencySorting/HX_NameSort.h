// Orders nodes that become free together by name.

#ifndef DEPENDENCYSORTING_IMPLDEPENDENCYSORTING_HX_NAMESORT_H
#define DEPENDENCYSORTING_IMPLDEPENDENCYSORTING_HX_NAMESORT_H

#include <cstddef>
#include <span>

#include "implContainers/HX_Vector.h"

class HxCDepSortNode;
class KyCXString;

/// RETURNS: the name of \p node; empty for null.
const KyCXString& HX_NameOfNode(HxCDepSortNode* node);

/// Gives the order of a selection sort that swaps the first of the smallest
/// names to the front. The object keeps its memory from batch to batch.
/// COST: about n log2 n steps.
class HX_NameSort {
 public:
  /// \p nodes must outlive the object; a batch consists of indices of \p nodes.
  explicit HX_NameSort(const HX_Vector<HxCDepSortNode*>& nodes)
      : m_Nodes(nodes) {}

  /// Throws std::bad_alloc, with \p batch unchanged.
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

  const HX_Vector<HxCDepSortNode*>& m_Nodes;
  HX_Vector<Entry> m_Entries;  // ascending by name
  HX_Vector<Entry> m_Buffer;   // of the merge sort
  // Entries with equal names form a group; the index of the first entry is the
  // number of the group.
  HX_Vector<int> m_GroupOfEntry;
  HX_Vector<int> m_GroupAt;    // by position in the batch; moves along
  HX_Vector<int> m_Positions;  // a heap per group, smallest position in front
  HX_Vector<int> m_HeapEnd;    // by group
  HX_Vector<int> m_Batch;      // copy of the batch
};

#endif  // DEPENDENCYSORTING_IMPLDEPENDENCYSORTING_HX_NAMESORT_H
