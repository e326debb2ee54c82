// Puts data types or variables in an order in which each comes after the items
// it depends on.
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
//    (Kahn 1962). The nodes that one predecessor sets free together follow
//    each other by ascending name.
// 2. Nodes without any dependency come last, ordered by the first criterion,
//    among those it does not tell apart by the second one, and so on.
//
// Equals have a fixed order as well, although no natural one: nodes set free
// together under the same name lie as a selection sort leaves them; nodes that
// all criteria leave together lie as a Quicksort (Hoare 1962) with the last
// element as its pivot leaves them, which starts from the reverse of the order
// of add(). Generated code must not change from release to release, so this
// order stays. A sort takes about n log n steps on any input and a stack of
// fixed size.

#ifndef DEPENDENCYSORTING_HXCDEPENDENCYSORTING_H
#define DEPENDENCYSORTING_HXCDEPENDENCYSORTING_H

#include <memory>
#include <utility>
#include <vector>

#include "Control/HX_Allocated.h"
#include "HX_Export.h"
#include "platform/containers/array.h"

class HxCDepSortComp;
class HxCDepSortNode;
class HxCDepSortingGraph;

/// Owns neither nodes nor criteria; both must live until the last sort. One
/// thread at a time may sort (see HxCDepSortNode::getComp()).
class HX_UTILS_API HxCDependencySorting : public HX_Allocated {
 public:
  HxCDependencySorting();
  ~HxCDependencySorting();
  // A copy would have to copy a half-used graph; no caller needs one.
  HxCDependencySorting(const HxCDependencySorting&) = delete;
  HxCDependencySorting& operator=(const HxCDependencySorting&) = delete;

  /// Takes a copy of \p criteria, the most important one first, none null.
  /// Forgets nodes and dependencies that were not sorted yet; does not replace
  /// reinit().
  void setSortingCriteriaAndInit(const leda::array<HxCDepSortComp*>& criteria);

  /// Each node is added once; a second time it also comes out a second time,
  /// and dependencies concern the copy added last.
  void add(HxCDepSortNode* node);

  /// \p first goes before \p second. Both must have been added by the time of
  /// sort(), before or after this call.
  void addDependency(HxCDepSortNode* first, HxCDepSortNode* second);

  /// Sorts everything since the last reinit().
  ///
  /// False if some nodes depend on themselves, directly or through others:
  /// message 403 (severity 2) then names all nodes with dependencies, in the
  /// order of add(), and calls them variables if the first one is a variable,
  /// else data types; a fall-through note (HxCTraceFallThrough) follows. False
  /// without a message if a null pointer without dependencies was added. In
  /// both cases the result is no valid order, and the sort keeps failing until
  /// reinit().
  ///
  /// A dependency with a node that was never added raises the internal
  /// assertion (message 7) and is ignored. A null pointer with dependencies is
  /// sorted as a data type with an empty name.
  ///
  /// The dependencies are used up, the nodes are not: a second sort without
  /// reinit() sorts the nodes of the first one with their dependencies and
  /// every node once more.
  bool sort();

  /// The result of the last sort(); empty before the first one.
  leda::array<HxCDepSortNode*> getNodes();

  /// Forgets all nodes and dependencies, sorted or not; the criteria and the
  /// last result stay.
  void reinit();

 private:
  using Dependency = std::pair<HxCDepSortNode*, HxCDepSortNode*>;

  void forgetPending();

  leda::array<HxCDepSortNode*> m_Result;
  std::vector<Dependency> m_Dependencies;  // not in the graph yet
  std::vector<HxCDepSortNode*> m_Nodes;    // in the order of add()
  leda::array<HxCDepSortComp*> m_Criteria;
  std::unique_ptr<HxCDepSortingGraph> m_Graph;  // null: no memory
};

#endif  // DEPENDENCYSORTING_HXCDEPENDENCYSORTING_H
