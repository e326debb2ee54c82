// Criterion for the order of items without dependencies.
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

/// Callers derive one class per criterion. OWNERSHIP: the caller.
class HX_UTILS_API HxCDepSortComp : public HX_Allocated {
 public:
  HxCDepSortComp() = default;
  HxCDepSortComp(const HxCDepSortComp&) = default;
  HxCDepSortComp& operator=(const HxCDepSortComp&) = default;
  virtual ~HxCDepSortComp();

  /// RETURNS: negative if \p a goes before \p b, 0 for equals, positive if \p a
  /// goes after \p b. The sorter never passes null.
  ///
  /// REQUIRES: a weak order. A criterion that contradicts itself, or changes
  /// its answers, gives some order of the same nodes. The number of calls is
  /// not promised.
  virtual int compare(HxCDepSortNode* a, HxCDepSortNode* b) = 0;
};

#endif  // DEPENDENCYSORTING_HXCDEPSORTCOMP_H
