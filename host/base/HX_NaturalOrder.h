// The order of texts with numbers inside, as a reader expects the order.

#ifndef HOST_BASE_HX_NATURALORDER_H
#define HOST_BASE_HX_NATURALORDER_H

#include <string_view>

/// Compares digit runs by value and the rest by byte: "v2" comes before
/// "v10". Total order: texts with different leading zeros only compare by byte.
bool HX_NaturalLess(std::string_view a, std::string_view b);

#endif  // HOST_BASE_HX_NATURALORDER_H
