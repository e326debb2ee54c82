// Questions about values that the data type server answers for everyone.

#ifndef PLATFORM_DATATYPES_HX_TYPESUPPORT_H
#define PLATFORM_DATATYPES_HX_TYPESUPPORT_H

#include <bit>

namespace HX_TypeSupport {

/// The number of the highest set bit of \p value in two's complement, the
/// lowest bit being number 1: 0 for 0, 8 for 128 to 255, 64 for every negative
/// value.
constexpr int findHighestBitSetInInt64Value(long long value) {
  return static_cast<int>(
      std::bit_width(static_cast<unsigned long long>(value)));
}

}  // namespace HX_TypeSupport

#endif  // PLATFORM_DATATYPES_HX_TYPESUPPORT_H
