// Texts on their way between documents (UTF-8), the library (16-bit units,
// messages in ISO-8859-1) and people.

#ifndef HOST_BASE_HX_TEXT_H
#define HOST_BASE_HX_TEXT_H

#include <cstddef>
#include <string>
#include <string_view>

#include "platform/strings/KyCXString.h"

/// RETURNS: the code point at \p at, behind which \p at then stands.
/// REQUIRES: \p utf8 is well-formed and \p at stands before the end.
char32_t HX_DecodeUtf8(std::string_view utf8, std::size_t& at);
void HX_AppendUtf8(std::string& utf8, char32_t code);

/// Characters above 0xFFFF become two surrogates; \p utf8 is well-formed.
KyCXString HX_FromUtf8(std::string_view utf8);
std::string HX_ToUtf8(const KyCXString& text);
std::string HX_Latin1ToUtf8(const std::string& latin1);

/// RETURNS: the columns of a terminal: bytes that continue a character have no
/// column.
std::size_t HX_WidthOf(std::string_view utf8);

/// The text with control characters as escapes of JSON: a terminal shows the
/// text and obeys nothing in the text.
std::string HX_Visible(std::string_view utf8);

/// The visible text in quotation marks; "..." for the end of a long text.
std::string HX_Quoted(std::string_view utf8);

/// Appends \p utf8 as a text of JSON with its quotation marks.
void HX_AppendJson(std::string& json, std::string_view utf8);

#endif  // HOST_BASE_HX_TEXT_H
