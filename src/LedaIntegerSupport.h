// Conversions between 64-bit integers and integers of any size.
//
//   LedaIntegerSupportBoot();                        // once, by the host
//   leda::integer sum = toInteger(a) + toInteger(b); // cannot overflow
//   long long saturated = toInt64(sum);

#ifndef LEDAINTEGERSUPPORT_H
#define LEDAINTEGERSUPPORT_H

#include <limits>

#include "Control/HX_SelfCheck.h"
#include "HX_Export.h"
#include "platform/containers/integer.h"

/// Sets the two bounds that toInt64 compares with; may be called again.
HX_UTILS_API void LedaIntegerSupportBoot();

namespace hx_detail {

// The bounds of toInt64; 0 until the boot.
HX_UTILS_API extern leda::integer ledaLargestInt64;
HX_UTILS_API extern leda::integer ledaSmallestInt64;

}  // namespace hx_detail

/// The same value.
HX_UTILS_INLINE_API inline leda::integer toInteger(long long v) {
  const leda::integer low(static_cast<unsigned int>(v));
  const leda::integer high(static_cast<int>(v >> 32));
  return (high << 32) + low;
}
HX_UTILS_INLINE_API inline leda::integer toInteger(unsigned long long v) {
  const leda::integer low(static_cast<unsigned int>(v));
  const leda::integer high(static_cast<unsigned int>(v >> 32));
  return (high << 32) + low;
}

/// The same value if 64 bits hold \p x, otherwise the nearest bound of 64 bits.
///
/// Before LedaIntegerSupportBoot() the bounds are 0: every positive value gives
/// the largest, every negative value the smallest result. The debug check
/// "usedWords <= 2" cannot fail behind the bounds of a boot.
// NOLINTNEXTLINE(performance-unnecessary-value-param): callers pass a value
HX_UTILS_INLINE_API inline long long toInt64(leda::integer x) {
  if (x > hx_detail::ledaLargestInt64) {
    return std::numeric_limits<long long>::max();
  }
  if (x < hx_detail::ledaSmallestInt64) {
    return std::numeric_limits<long long>::min();
  }
  HX_DebugCheck(x.used_words() <= 2, "usedWords <= 2");
  const unsigned long long high = x.contents(1);
  const unsigned long long magnitude = high << 32 | x.contents(0);
  return static_cast<long long>(sign(x) < 0 ? 0 - magnitude : magnitude);
}

#endif  // LEDAINTEGERSUPPORT_H
