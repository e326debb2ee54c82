// The partition of a Quicksort (Hoare 1962) whose pivot is the last element and
// whose two scans stop at equals.

#ifndef DEPENDENCYSORTING_IMPLDEPENDENCYSORTING_HX_PARTITION_H
#define DEPENDENCYSORTING_IMPLDEPENDENCYSORTING_HX_PARTITION_H

/// The places from low to high, both included.
struct HX_Part {
  int low;
  int high;

  int count() const { return high - low + 1; }
};

/// Divides a part of at least two places; returns the place of the pivot, to
/// whose left no element is larger and to whose right none is smaller.
///
/// \p sequence has the three operations
///   scanUp(from, part)    the first place from \c from on, at the latest
///                         part.high, that is not smaller than part.high
///   scanDown(from, part)  the last place up to \c from, at the earliest
///                         part.low - 1, that is not larger than part.high
///   swap(a, b)            exchanges two places
/// What they do decides the cost; the swaps are always the same.
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

#endif  // DEPENDENCYSORTING_IMPLDEPENDENCYSORTING_HX_PARTITION_H
