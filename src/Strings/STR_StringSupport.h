// Helpers for 8-bit, zero-terminated C strings.
//
//   char* text = STR_Concatenate3Strings("gain", "_", "1");   // "gain_1"
//   ...
//   pHXMemory->freeMemBlock(text);
//
// OWNERSHIP: every string returned as char* is a new block of the memory
// controller and belongs to the caller. Null if the controller has no memory.
// REQUIRES of functions that return char*: pHXMemory is installed. The C heap
// never stands in for the controller.

#ifndef STRINGS_STR_STRINGSUPPORT_H
#define STRINGS_STR_STRINGSUPPORT_H

#include "HX_Export.h"

/// Whether letter case counts. The type is fixed, so that values outside the
/// enumeration are defined.
enum STR_case_sensitive_etp : int {
  STR_CASE_SENSITIVE = 0,   ///< all bytes have to be the same
  STR_CASE_INSENSITIVE = 1  ///< 'A' to 'Z' equal 'a' to 'z'; no other letter
};

/// What STR_ProcessString() replaces.
enum STR_process_mode_tp : int {
  STR_WHITESPACE_TO_BLANK = 0,
  STR_WHITESPACE_TO_UNDERSCORE = 1,
  STR_INVALID_TO_UNDERSCORE = 2
};

/// \p a followed by \p b. A null side counts as absent; null if both are.
HX_UTILS_API char* STR_ConcatenateStrings(const char* a, const char* b);

/// The three strings in order, up to the first null after \p a.
HX_UTILS_API char* STR_Concatenate3Strings(const char* a, const char* b,
                                           const char* c);

/// All arguments in order: const char* each, ended by a null const char*.
/// A null \p first does not end the list; null if \p first is null and no
/// string follows. COST: every argument copies the result so far.
HX_UTILS_API char* STR_ConcatenateNStrings(const char* first, ...);

/// Decimal digits, after '-' for a negative value.
HX_UTILS_API char* STR_IntToString(int value);

/// Decimal with \p precision digits after the point, no point for 0, rounded as
/// printf does, with a point in every locale; a negative precision counts as 6.
/// The infinities and NaN read "inf", "-inf", "nan" and "-nan". Every finite
/// value is written in full; null for more than INT_MAX characters.
///
/// The block of a value with a 32-bit integer part has digits + precision + 3
/// bytes, one more for a negative value, where digits counts the integer part.
HX_UTILS_API char* STR_DoubleToString(double value, int precision);

/// A copy of \p s; null for null.
HX_UTILS_API char* STR_DuplicateString(const char* s);

/// True for null and for a string of length 0.
HX_UTILS_API bool STR_IsNullOrEmpty(const char* s);

/// Two nulls are equal; null and any string, even "", are not. Every \p mode
/// but STR_CASE_SENSITIVE ignores the case of ASCII letters.
HX_UTILS_API bool STR_StringsAreEqual(const char* a, const char* b,
                                      STR_case_sensitive_etp mode);

/// True for '_' and for ASCII letters and digits, whatever the locale; never
/// for a byte from 0x80 upward.
HX_UTILS_API bool STR_IsValidCharForCIdentifier(char ch);

/// Writes \p src to \p dst with the characters that \p mode selects replaced.
///
/// STR_INVALID_TO_UNDERSCORE replaces characters not allowed in a C identifier;
/// a leading digit stays. Every other mode replaces line feed, tab and blank;
/// a \p mode outside the enumeration writes blanks.
/// \param[out] dst  as many bytes as \p src has, the final zero included; may
///   be \p src itself. Neither may be null.
HX_UTILS_API void STR_ProcessString(char* dst, const char* src,
                                    STR_process_mode_tp mode);

#endif  // STRINGS_STR_STRINGSUPPORT_H
