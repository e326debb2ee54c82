// Topological sort of data types or variables: every item comes after the items
// on which the item depends.
//
//   HxCDependencySorting sorting;
//   sorting.setSortingCriteriaAndInit(criteria);
//   for (HxCDepSortNode* node : all) sorting.add(node);
//   sorting.addDependency(element, structure);   // the element comes first
//   if (!sorting.sort()) return false;           // a cycle, and reported
//   for (HxCDepSortNode* node : sorting.getNodes()) emit(node);
//
// The order depends only on the calls, the names and the criteria:
//
// 1. Nodes with at least one dependency come first, in topological order
//    (Kahn 1962). Nodes set free by the same predecessor follow one after
//    another by ascending name.
// 2. Nodes without any dependency come last, ordered by the first criterion;
//    nodes equal under the first criterion by the second, and so on.
//
// Equals have a fixed order too, because generated code must not change from
// release to release: nodes set free together under the same name lie as a
// selection sort leaves them; nodes equal under all criteria lie as a Quicksort
// (Hoare 1962) with the last element as pivot leaves them, starting from the
// reverse of the order of add().
//
// COST: about n log2 n steps for any input, a stack of fixed size.

#ifndef DEPENDENCYSORTING_HXCDEPENDENCYSORTING_H
#define DEPENDENCYSORTING_HXCDEPENDENCYSORTING_H

#include <memory>
#include <utility>
#include <vector>

#include "Control/HX_Allocated.h"
#include "Control/HX_Memory.h"
#include "HX_Export.h"
#include "platform/containers/array.h"

class HxCDepSortComp;
class HxCDepSortNode;
class HxCDepSortingGraph;

/// OWNERSHIP: nodes and criteria belong to the caller and must live until the
/// last sort. One thread at a time may sort (see HxCDepSortNode::getComp()).
///
/// Without memory no operation throws. Input that add(), addDependency() or
/// setSortingCriteriaAndInit() could not store makes sort() return false until
/// the input is given anew.
class HX_UTILS_API HxCDependencySorting : public HX_Allocated {
 public:
  HxCDependencySorting();
  ~HxCDependencySorting();
  // No caller needs a copy, and a copy would share or copy a half-used graph.
  HxCDependencySorting(const HxCDependencySorting&) = delete;
  HxCDependencySorting& operator=(const HxCDependencySorting&) = delete;

  /// Stores a copy of \p criteria, the most important criterion first, none
  /// null. Forgets nodes and dependencies not sorted yet; does not replace
  /// reinit().
  void setSortingCriteriaAndInit(const leda::array<HxCDepSortComp*>& criteria);

  /// REQUIRES: \p node was not added before. A node added twice comes out
  /// twice, and dependencies concern the copy added last.
  void add(HxCDepSortNode* node);

  /// \p first goes before \p second. Both nodes must be added by the time of
  /// sort(), before or after this call.
  void addDependency(HxCDepSortNode* first, HxCDepSortNode* second);

  /// Sorts all input since the last reinit().
  ///
  /// RETURNS: false, with no valid order in the result,
  /// - after a cycle of dependencies. Message 403 (severity 2) names all nodes
  ///   with dependencies in the order of add() as "variables" if the first node
  ///   is a variable, else as "data types". A fall-through note
  ///   (HxCTraceFallThrough) follows. Fails again until reinit();
  /// - without a message if a null pointer without dependencies was added.
  ///   Fails again until reinit();
  /// - without a message if memory runs out. Input and dependencies stay for
  ///   the next sort().
  ///
  /// A dependency with a node never added raises the internal assertion
  /// (message 7) and is ignored. A null pointer with dependencies counts as a
  /// data type with an empty name.
  ///
  /// The dependencies are used up, the nodes are not: a second sort without
  /// reinit() sorts the nodes of the first sort with their dependencies and
  /// every node once more.
  bool sort();

  /// RETURNS: the result of the last sort(); empty before the first sort and
  /// without memory for the copy.
  leda::array<HxCDepSortNode*> getNodes();

  /// Forgets all nodes and dependencies, sorted or not; the criteria and the
  /// last result stay.
  void reinit();

 private:
  template <class Value>
  using Vector = std::vector<Value, HX_ControllerAllocator<Value>>;
  using Dependency = std::pair<HxCDepSortNode*, HxCDepSortNode*>;

  void forgetPending();

  leda::array<HxCDepSortNode*> m_Result;
  Vector<Dependency> m_Dependencies;  // not in the graph yet
  Vector<HxCDepSortNode*> m_Nodes;    // in the order of add()
  leda::array<HxCDepSortComp*> m_Criteria;
  std::unique_ptr<HxCDepSortingGraph> m_Graph;  // null: no memory
  bool m_LacksInput = false;                    // for want of memory
  bool m_LacksCriteria = false;                 // for want of memory
};

#endif  // DEPENDENCYSORTING_HXCDEPENDENCYSORTING_H
