// SHA-256 (FIPS 180-4) of a text.
//
//   HX_Sha256("abc");   // "ba7816bf 8f01cfea ..." without the blanks

#ifndef HOST_BASE_HX_SHA256_H
#define HOST_BASE_HX_SHA256_H

#include <string>
#include <string_view>

/// RETURNS: 64 hexadecimal digits.
std::string HX_Sha256(std::string_view text);

#endif  // HOST_BASE_HX_SHA256_H
