// Set of integers, stored as disjoint half-open intervals.
//
//   HX_IntervalSet taken;
//   taken.add(0); taken.add(1); taken.add(5);   // [0, 2) and [5, 6)
//   taken.firstMissing(0);                      // 2
//
// Invariants: 1. intervals ascend; 2. between two intervals at least one
// integer is missing; 3. no interval is empty.

#ifndef IMPLCONTAINERS_HX_INTERVALSET_H
#define IMPLCONTAINERS_HX_INTERVALSET_H

#include <cstddef>

#include "implContainers/HX_Vector.h"

/// COST: a lookup takes log2 n steps for n intervals, a change up to n moves.
class HX_IntervalSet {
 public:
  /// True if the set has no element.
  bool empty() const { return m_Intervals.empty(); }
  /// \p index must be below INT_MAX. Throws std::bad_alloc, with nothing
  /// changed, without memory.
  void add(int index);
  /// Throws std::bad_alloc, with nothing changed, without memory.
  void remove(int index);
  /// Removes all elements; needs no memory.
  void clear() { m_Intervals.clear(); }
  /// RETURNS: the smallest integer of at least \p from outside the set.
  int firstMissing(int from) const;

 private:
  struct Interval {
    int first;
    int end;  // one behind the last element
  };

  std::size_t intervalAfter(int index) const;

  HX_Vector<Interval> m_Intervals;
};

#endif  // IMPLCONTAINERS_HX_INTERVALSET_H
