// Helpers for 8-bit, zero-terminated C strings.
//
//   char* text = STR_Concatenate3Strings("gain", "_", "1");   // "gain_1"
//   ...
//   pHXMemory->freeMemBlock(text);
//
// Every string returned as char* is a new block of the memory controller and
// belongs to the caller. The C heap never stands in for the controller: the
// host must have installed pHXMemory before the first call that returns one.
// Where the controller has no memory, the result is null.

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
/// \p first alone may be null without ending the list; null if it is and no
/// other string follows. Meant for short lists: each argument copies the
/// result so far.
HX_UTILS_API char* STR_ConcatenateNStrings(const char* first, ...);

/// Decimal digits, after '-' for a negative value.
HX_UTILS_API char* STR_IntToString(int value);

/// Decimal with \p precision digits after the point, no point for 0, rounded as
/// printf does, whatever the locale; a negative precision counts as 6. The
/// infinities and NaN read "inf", "-inf", "nan" and "-nan". Every finite value
/// is written out in full; null if that takes more than INT_MAX characters.
HX_UTILS_API char* STR_DoubleToString(double value, int precision);

/// A copy of \p s; null for null.
HX_UTILS_API char* STR_DuplicateString(const char* s);

/// True for null and for a string of length 0.
HX_UTILS_API bool STR_IsNullOrEmpty(const char* s);

/// Two nulls are equal; null and a string, even an empty one, are not. Any
/// \p mode but STR_CASE_SENSITIVE ignores the case of ASCII letters.
HX_UTILS_API bool STR_StringsAreEqual(const char* a, const char* b,
                                      STR_case_sensitive_etp mode);

/// True for '_' and for ASCII letters and digits, whatever the locale; never
/// for a byte from 0x80 upward.
HX_UTILS_API bool STR_IsValidCharForCIdentifier(char ch);

/// Writes \p src to \p dst with the characters that \p mode selects replaced.
///
/// STR_INVALID_TO_UNDERSCORE replaces what may not stand in a C identifier, a
/// leading digit may; every other mode replaces line feed, tab and blank, and
/// a \p mode that is not in the enumeration writes blanks.
/// \param[out] dst  as many bytes as \p src has, the final zero included; may
///   be \p src itself. Neither may be null.
HX_UTILS_API void STR_ProcessString(char* dst, const char* src,
                                    STR_process_mode_tp mode);

#endif  // STRINGS_STR_STRINGSUPPORT_H
