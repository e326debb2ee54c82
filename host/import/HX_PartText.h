// Texts of foreign files: well-formed UTF-8, line feeds, places.

#ifndef HOST_IMPORT_HX_PARTTEXT_H
#define HOST_IMPORT_HX_PARTTEXT_H

#include <string>
#include <string_view>

/// RETURNS: the offset of the first byte outside UTF-8 (RFC 3629: shortest
/// form, no surrogates), or std::string_view::npos.
/// COST: one pass; eight bytes a step over ASCII.
std::size_t HX_FindBadUtf8(std::string_view text);

/// RETURNS: \p text without line feeds: control characters become blanks, a
/// byte outside UTF-8 becomes U+FFFD.
std::string HX_OneLine(std::string_view text);

/// RETURNS: "LINE:COLUMN" of the byte \p offset; both count from 1, columns
/// count bytes.
std::string HX_PlaceOf(std::string_view text, std::size_t offset);

#endif  // HOST_IMPORT_HX_PARTTEXT_H
