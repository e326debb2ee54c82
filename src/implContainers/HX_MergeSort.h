// Stable merge sort, bottom-up, bounded for every answer of the comparison.
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
void HX_InsertionSort(Value* first, Value* end, Less isLess) {
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
              Value* to, Less isLess) {
  const Value* second = middle;
  if (first < middle && second < end && isLess(*second, middle[-1])) {
    while (first < middle && second < end)
      *to++ = isLess(*second, *first) ? *second++ : *first++;
  }
  std::copy(second, end, std::copy(first, middle, to));
}

/// Sorts \p values.
/// \param buffer  content is lost; kept by callers who sort repeatedly
/// COST: at most n log2 n comparisons besides the first chunks of 16; n - 1 or
/// few more on sorted input. Throws std::bad_alloc, with nothing changed.
template <class Value, class Less>
void HX_MergeSort(HX_Vector<Value>& values, HX_Vector<Value>& buffer,
                  Less isLess) {
  static_assert(std::is_trivially_copyable_v<Value>);
  constexpr std::size_t kChunk = 16;
  const std::size_t count = values.size();
  if (count > kChunk) buffer.resize(count);
  Value* from = values.data();
  for (std::size_t at = 0; at < count; at += kChunk)
    HX_InsertionSort(from + at, from + std::min(at + kChunk, count), isLess);
  for (std::size_t width = kChunk; width < count; width *= 2) {
    Value* const to = buffer.data();
    for (std::size_t at = 0; at < count; at += 2 * width) {
      const std::size_t middle = std::min(at + width, count);
      const std::size_t end = std::min(middle + width, count);
      HX_Merge(from + at, from + middle, from + end, to + at, isLess);
    }
    values.swap(buffer);
    from = values.data();
  }
}

#endif  // IMPLCONTAINERS_HX_MERGESORT_H
