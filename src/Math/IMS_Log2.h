// The base-2 logarithm of an integer, rounded down.
//
//   IMS_Log2(1023u);   // 9
//   IMS_Log2(1024u);   // 10
//
// The result is the index of the highest set bit; 0 and 1 both give 0. A
// negative value has no logarithm and gives -1, the index of no bit.

#ifndef MATH_IMS_LOG2_H
#define MATH_IMS_LOG2_H

#include <bit>

#include "HX_Export.h"

/// The logarithm of \p value, rounded down: [0, 63]; 0 for 0, -1 below.
HX_UTILS_INLINE_API constexpr int IMS_Log2(unsigned int value) {
  return static_cast<int>(std::bit_width(value | 1U)) - 1;
}

/// \copydoc IMS_Log2(unsigned int)
HX_UTILS_INLINE_API constexpr int IMS_Log2(long long value) {
  if (value <= 0) [[unlikely]] {
    return value == 0 ? 0 : -1;
  }
  return static_cast<int>(
             std::bit_width(static_cast<unsigned long long>(value))) -
         1;
}

/// \copydoc IMS_Log2(unsigned int)
HX_UTILS_INLINE_API constexpr int IMS_Log2(int value) {
  return IMS_Log2(static_cast<long long>(value));
}

/// \copydoc IMS_Log2(unsigned int)
HX_UTILS_INLINE_API constexpr int IMS_Log2(long value) {
  return IMS_Log2(static_cast<long long>(value));
}

#endif  // MATH_IMS_LOG2_H
