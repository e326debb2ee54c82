// Vector whose blocks come from the memory controller.
//
//   HX_Vector<int> ranks(count);   // throws std::bad_alloc without memory
//   ranks[HX_ToSize(vertex)] = 3;  // vertex is an int of 0 or more

#ifndef IMPLCONTAINERS_HX_VECTOR_H
#define IMPLCONTAINERS_HX_VECTOR_H

#include <cstddef>
#include <utility>
#include <vector>

#include "Control/HX_Memory.h"

/// As std::vector otherwise.
template <class Value>
using HX_Vector = std::vector<Value, HX_ControllerAllocator<Value>>;

/// The same number as std::size_t. REQUIRES: \p number >= 0.
constexpr std::size_t HX_ToSize(int number) {
  return static_cast<std::size_t>(number);
}

/// Inserts \p value in front of \p position.
template <class Value>
void HX_InsertAt(HX_Vector<Value>& values, std::size_t position, Value value) {
  values.insert(values.begin() + static_cast<std::ptrdiff_t>(position),
                std::move(value));
}

/// Removes the value at \p position.
template <class Value>
void HX_EraseAt(HX_Vector<Value>& values, std::size_t position) {
  values.erase(values.begin() + static_cast<std::ptrdiff_t>(position));
}

#endif  // IMPLCONTAINERS_HX_VECTOR_H
