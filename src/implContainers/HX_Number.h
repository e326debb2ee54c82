// Numbers as text, with a decimal point in every locale. printf() would write
// the decimal point of the current locale.
//
//   char text[32];
//   HX_WriteFixed(text, sizeof text, 2.5, 3);   // 5, "2.500"

#ifndef IMPLCONTAINERS_HX_NUMBER_H
#define IMPLCONTAINERS_HX_NUMBER_H

#include <charconv>
#include <cstddef>
#include <cstdint>
#include <system_error>

/// Writes \p value as "%.*f" with \p precision would, and a zero behind.
/// RETURNS: the number of characters without the zero; 0, with an empty text,
/// if \p size is too small.
/// REQUIRES: \p size > 0, \p precision >= 0.
inline std::size_t HX_WriteFixed(char* text, std::size_t size, double value,
                                 int precision) {
  const auto [end, error] = std::to_chars(text, text + size - 1, value,
                                          std::chars_format::fixed, precision);
  char* const stop = error == std::errc() ? end : text;
  *stop = 0;
  return static_cast<std::size_t>(stop - text);
}

/// Writes the decimal digits of \p value, after '-' if negative, and a zero
/// behind. RETURNS and REQUIRES: as HX_WriteFixed().
inline std::size_t HX_WriteInt(char* text, std::size_t size,
                               std::int64_t value) {
  const auto [end, error] = std::to_chars(text, text + size - 1, value);
  char* const stop = error == std::errc() ? end : text;
  *stop = 0;
  return static_cast<std::size_t>(stop - text);
}

#endif  // IMPLCONTAINERS_HX_NUMBER_H
