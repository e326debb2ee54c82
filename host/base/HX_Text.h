// Texts on their way between documents (UTF-8) and the library (16-bit units,
// messages in ISO-8859-1).

#ifndef HOST_BASE_HX_TEXT_H
#define HOST_BASE_HX_TEXT_H

#include <string>

#include "platform/strings/KyCXString.h"

/// Characters above 0xFFFF become two surrogates; \p utf8 is well-formed.
KyCXString HX_FromUtf8(const std::string& utf8);
std::string HX_ToUtf8(const KyCXString& text);

/// The 8-bit form that data dictionary paths and messages have; characters
/// above 0xFF show as '?'.
std::string HX_Utf8ToLatin1(const std::string& utf8);
std::string HX_Latin1ToUtf8(const std::string& latin1);

#endif  // HOST_BASE_HX_TEXT_H
