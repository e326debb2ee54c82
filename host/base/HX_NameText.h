// Texts of any script for use in C names.
//
//   HX_NameText("Größe");     // "Grosse"
//   HX_NameText("ωm");        // "omegam"
//   HX_NameText("скорость");  // "skorost"
//   HX_NameText("速度 1");     // "_u901F__u5EA6_ 1"

#ifndef HOST_BASE_HX_NAMETEXT_H
#define HOST_BASE_HX_NAMETEXT_H

#include <string_view>

#include "platform/strings/KyCXString.h"

/// Writes every character beyond ASCII with ASCII characters, the same on every
/// machine:
/// - Latin, Greek and Cyrillic letters by one or more letters; marks that
///   combine with the letter before are left out;
/// - punctuation and spaces (also of ISO-8859-1) by '_';
/// - any other character by "_u" with at least four hexadecimal digits and "_".
/// ASCII characters stay. A text that is not empty gives a text that is not
/// empty, except for texts of combining marks alone, which give "_".
KyCXString HX_NameText(std::string_view utf8);

/// Whether HX_NameText() changes the text.
bool HX_IsForeign(std::string_view utf8);

#endif  // HOST_BASE_HX_NAMETEXT_H
