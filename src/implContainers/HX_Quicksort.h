// Quicksort (Hoare 1962) whose pivot is the last element and whose two scans
// stop at equals, with an explicit stack.
//
// The algorithm sees places only; a Sequence gives the places a meaning. The
// order of equal elements depends on nothing but the swaps, and the swaps
// depend on nothing but the answers of the two scans: two Sequences whose scans
// answer alike end in the same order.
//
// Example, a part with the keys 3 1 4 1 2, pivot 2:
//   scanUp stops at 3, scanDown stops at the second 1; swap   1 1 4 3 2
//   scanUp stops at 4, scanDown stops at the first 1 left of 4: scans crossed
//   swap 4 and pivot                                          1 1 2 3 4
// and the parts 1 1 and 3 4 remain.

#ifndef IMPLCONTAINERS_HX_QUICKSORT_H
#define IMPLCONTAINERS_HX_QUICKSORT_H

#include <limits>
#include <utility>

/// Places of the closed range [low, high].
struct HX_Part {
  int low;
  int high;

  int count() const { return high - low + 1; }
};

/// Divides a part of at least two places.
/// RETURNS: the place of the pivot. No element to the left is larger, no
/// element to the right is smaller than the pivot.
///
/// REQUIRES of \p sequence, with the pivot at part.high:
///   scanUp(from, part)    first place in [from, part.high] not below the pivot
///   scanDown(from, part)  last place in [part.low, from] not above the pivot,
///                         part.low - 1 if there is none
///   swap(a, b)            exchanges two places
template <class Sequence>
int HX_Partition(Sequence& sequence, const HX_Part& part) {
  int i = part.low;
  int j = part.high - 1;
  while (true) {
    i = sequence.scanUp(i, part);
    j = sequence.scanDown(j, part);
    if (i >= j) break;
    sequence.swap(i++, j--);
  }
  sequence.swap(i, part.high);
  return i;
}

/// Sorts the places [0, count).
///
/// REQUIRES of \p sequence, besides HX_Partition():
///   finish(part)  true if the part needs no more work, either because the
///                 part is in order or because finish() has put it in order
/// COST: fixed stack; the larger part waits, so at most log2 count parts do.
template <class Sequence>
void HX_Quicksort(Sequence& sequence, int count) {
  HX_Part waiting[std::numeric_limits<int>::digits + 1];
  int waitingCount = 0;
  waiting[waitingCount++] = {0, count - 1};
  while (waitingCount > 0) {
    HX_Part part = waiting[--waitingCount];
    while (part.count() > 1 && !sequence.finish(part)) {
      const int pivot = HX_Partition(sequence, part);
      HX_Part smaller = {part.low, pivot - 1};
      HX_Part larger = {pivot + 1, part.high};
      if (smaller.count() > larger.count()) std::swap(smaller, larger);
      waiting[waitingCount++] = larger;
      part = smaller;
    }
  }
}

#endif  // IMPLCONTAINERS_HX_QUICKSORT_H
