// An item that can be sorted by dependencies: the base of all sortable items.
//
//   class HxCSdtNode : public HxCDepSortNode {
//    public:
//     HxCSdtNode* isSdtNode() override { return this; }
//     const KyCXString& getName() override { return m_Type.name(); }
//     ...
//   };

#ifndef DEPENDENCYSORTING_HXCDEPSORTNODE_H
#define DEPENDENCYSORTING_HXCDEPSORTNODE_H

#include "Control/HX_Allocated.h"
#include "HX_Export.h"
#include "platform/containers/compare.h"

class HxCDepSortComp;
class HxCSdtNode;
class HxCSsNode;
class KyCXString;

/// Owned by the caller, who derives a class for each kind of item.
class HX_UTILS_API HxCDepSortNode : public HX_Allocated {
 public:
  /// The ordinal number is -1.
  HxCDepSortNode() = default;
  /// Copies share the ordinal number of their source.
  HxCDepSortNode(const HxCDepSortNode&) = default;
  HxCDepSortNode& operator=(const HxCDepSortNode&) = default;
  virtual ~HxCDepSortNode();

  /// This node as a variable; null here.
  virtual HxCSsNode* isSsNode();
  /// This node as a data type; null here.
  virtual HxCSdtNode* isSdtNode();
  /// The name of the item: it orders items that become free together and
  /// stands in the report of a cycle. The text must stay valid and unchanged
  /// while a sort runs.
  virtual const KyCXString& getName() = 0;

  /// A number for the caller's own use; the sorter neither reads nor writes it.
  int getOrdNr() const { return m_OrdNr; }
  void setOrdNr(int ordNr) { m_OrdNr = ordNr; }

  /// The current criterion of leda::compare() below: null at first, after a
  /// sort by criteria the last one that had two or more nodes to sort. The
  /// runs of nodes that a criterion leaves together are sorted by the next one
  /// from the front to the back.
  static HxCDepSortComp* getComp();
  /// Not owned. One thread at a time may sort or set the criterion.
  static void setComp(HxCDepSortComp* comp);

 private:
  static HxCDepSortComp* s_pComp;

  int m_OrdNr = -1;
};

namespace leda {

/// Orders node pointers in the caller's own containers by the current
/// criterion, which must not be null. A specialisation, so that the containers
/// find it whichever header comes first.
template <>
HX_UTILS_API int compare(HxCDepSortNode* const& a, HxCDepSortNode* const& b);

}  // namespace leda

#endif  // DEPENDENCYSORTING_HXCDEPSORTNODE_H
