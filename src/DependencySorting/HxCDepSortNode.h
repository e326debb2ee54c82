// Base class of items sorted by dependencies.
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

/// Callers derive a class per kind of item. OWNERSHIP: the caller.
class HX_UTILS_API HxCDepSortNode : public HX_Allocated {
 public:
  /// The ordinal number is -1.
  HxCDepSortNode() = default;
  /// A copy has the ordinal number of the original.
  HxCDepSortNode(const HxCDepSortNode&) = default;
  HxCDepSortNode& operator=(const HxCDepSortNode&) = default;
  virtual ~HxCDepSortNode();

  /// This node as a variable; null in the base class.
  virtual HxCSsNode* isSsNode();
  /// This node as a data type; null in the base class.
  virtual HxCSdtNode* isSdtNode();
  /// Name of the item, for the order of items that become free together and
  /// for the report of a cycle. The text must stay valid and unchanged during a
  /// sort.
  virtual const KyCXString& getName() = 0;

  /// Number for the use of the caller alone.
  int getOrdNr() const { return m_OrdNr; }
  void setOrdNr(int ordNr) { m_OrdNr = ordNr; }

  /// Current criterion of leda::compare() below: null at first, after a sort
  /// the last criterion that had two or more nodes to sort. Groups of equals
  /// are sorted by the next criterion from the front to the back.
  static HxCDepSortComp* getComp();
  /// Not owned. One thread at a time may sort or set the criterion.
  static void setComp(HxCDepSortComp* comp);

 private:
  static HxCDepSortComp* s_pComp;

  int m_OrdNr = -1;
};

namespace leda {

/// Orders node pointers in containers of the caller by the current criterion.
/// REQUIRES: the current criterion is not null. A specialisation, because then
/// the order of includes does not matter.
template <>
HX_UTILS_API int compare(HxCDepSortNode* const& a, HxCDepSortNode* const& b);

}  // namespace leda

#endif  // DEPENDENCYSORTING_HXCDEPSORTNODE_H
