// The limits of the generator's base types, by type code.
//
//   if (x > DT_GetMax(DT_GetINT64())) ...

#ifndef PLATFORM_DATATYPES_DT_DATATYPES_H
#define PLATFORM_DATATYPES_DT_DATATYPES_H

namespace dt_detail {

struct LimitRow {
  int typeCode;
  long long minimum;
  long long maximum;
};

// Base types whose limits are asked for by code.
inline constexpr LimitRow kLimits[] = {
    {11, 0, 4294967295},            // unsigned 32 bit
    {15, -2147483648, 2147483647},  // signed 32 bit
    {16, -9223372036854775807 - 1, 9223372036854775807},
};

constexpr LimitRow limitsOf(int typeCode) {
  for (const LimitRow& row : kLimits) {
    if (row.typeCode == typeCode) return row;
  }
  return {typeCode, 0, 0};
}

}  // namespace dt_detail

/// The type code of the signed 64-bit type.
constexpr int DT_GetINT64() { return 16; }

/// The limits of the base type \p typeCode; 0 for a code without a row above.
constexpr long long DT_GetMaxAsInt64(int typeCode) {
  return dt_detail::limitsOf(typeCode).maximum;
}
constexpr long long DT_GetMinAsInt64(int typeCode) {
  return dt_detail::limitsOf(typeCode).minimum;
}

/// The same as doubles. The maximum of the signed 64-bit type is rounded up: it
/// comes as 2^63, one more than the type holds.
constexpr double DT_GetMax(int typeCode) {
  return static_cast<double>(DT_GetMaxAsInt64(typeCode));
}
constexpr double DT_GetMin(int typeCode) {
  return static_cast<double>(DT_GetMinAsInt64(typeCode));
}

#endif  // PLATFORM_DATATYPES_DT_DATATYPES_H
