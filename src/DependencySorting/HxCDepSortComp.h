// A criterion by which items without dependencies are put in order.
//
//   class BySize : public HxCDepSortComp {
//     int compare(HxCDepSortNode* a, HxCDepSortNode* b) override {
//       return sizeOf(b) - sizeOf(a);  // the largest first
//     }
//   };

#ifndef DEPENDENCYSORTING_HXCDEPSORTCOMP_H
#define DEPENDENCYSORTING_HXCDEPSORTCOMP_H

#include "Control/HX_Allocated.h"
#include "HX_Export.h"

class HxCDepSortNode;

/// Callers derive one class per criterion and own the objects.
class HX_UTILS_API HxCDepSortComp : public HX_Allocated {
 public:
  HxCDepSortComp() = default;
  HxCDepSortComp(const HxCDepSortComp&) = default;
  HxCDepSortComp& operator=(const HxCDepSortComp&) = default;
  virtual ~HxCDepSortComp();

  /// Negative if \p a goes before \p b, 0 if the criterion does not tell them
  /// apart, positive if \p a goes after \p b. The sorter never passes null.
  ///
  /// Must be a weak order: one that contradicts itself gives some order of the
  /// same nodes. How often it is called is not promised.
  virtual int compare(HxCDepSortNode* a, HxCDepSortNode* b) = 0;
};

#endif  // DEPENDENCYSORTING_HXCDEPSORTCOMP_H
