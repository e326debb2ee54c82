// Stable merge sort, bounded for every answer of the comparison.
//
// std::stable_sort reads outside its range when the comparison contradicts
// itself, and takes its buffer from the global heap. HX_MergeSort() reads and
// writes the elements only; a comparison that contradicts itself gives some
// order of the same elements.
//
//   HX_MergeSort(entries, buffer, [](const Entry& a, const Entry& b) {
//     return a.key < b.key;
//   });

#ifndef IMPLCONTAINERS_HX_MERGESORT_H
#define IMPLCONTAINERS_HX_MERGESORT_H

#include <algorithm>
#include <cstddef>
#include <type_traits>

#include "implContainers/HX_Vector.h"

/// Sorts [first, end) in place, stable, in count^2 / 4 steps on average.
template <class Value, class Less>
void HX_InsertionSort(Value* first, Value* end, Less& isLess) {
  for (Value* next = first; next < end; ++next) {
    const Value value = *next;
    Value* place = next;
    for (; place > first && isLess(value, place[-1]); --place)
      *place = place[-1];
    *place = value;
  }
}

/// Merges the sorted ranges [first, middle) and [middle, end) into \p to.
/// Elements of the first range stand before equal elements of the second.
template <class Value, class Less>
void HX_Merge(const Value* first, const Value* middle, const Value* end,
              Value* to, Less& isLess) {
  const Value* second = middle;
  if (first < middle && second < end && isLess(*second, middle[-1])) {
    while (first < middle && second < end)
      *to++ = isLess(*second, *first) ? *second++ : *first++;
  }
  std::copy(second, end, std::copy(first, middle, to));
}

/// Sorts the first \p count values; the result stands in \p buffer if
/// \p intoBuffer, else in \p values. Depth first, because a half that fits the
/// cache is then sorted within the cache.
template <class Value, class Less>
void HX_SortHalves(Value* values, Value* buffer, std::size_t count,
                   bool intoBuffer, Less& isLess) {
  constexpr std::size_t kChunk = 8;
  if (count <= kChunk) {
    HX_InsertionSort(values, values + count, isLess);
    if (intoBuffer) std::copy(values, values + count, buffer);
    return;
  }
  const std::size_t half = count / 2;
  HX_SortHalves(values, buffer, half, !intoBuffer, isLess);
  HX_SortHalves(values + half, buffer + half, count - half, !intoBuffer,
                isLess);
  const Value* const from = intoBuffer ? values : buffer;
  HX_Merge(from, from + half, from + count, intoBuffer ? buffer : values,
           isLess);
}

/// Sorts \p values.
/// \param buffer  content is lost; kept by callers who sort repeatedly
/// COST: about n log2 n comparisons, about n on sorted input. Throws
/// std::bad_alloc, with nothing changed.
template <class Value, class Less>
void HX_MergeSort(HX_Vector<Value>& values, HX_Vector<Value>& buffer,
                  Less isLess) {
  static_assert(std::is_trivially_copyable_v<Value>);
  buffer.resize(values.size());
  HX_SortHalves(values.data(), buffer.data(), values.size(), false, isLess);
}

#endif  // IMPLCONTAINERS_HX_MERGESORT_H
