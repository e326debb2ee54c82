// Numbers in the parameters of blocks.

#ifndef HOST_IMPORT_HX_LITERALS_H
#define HOST_IMPORT_HX_LITERALS_H

#include <optional>
#include <string>
#include <string_view>
#include <vector>

/// RETURNS: the numbers of a literal, row by row, and nothing for any other
/// expression.
///
/// | text               | result     |
/// |--------------------|------------|
/// | `-1.5e3`           | -1500      |
/// | `[1 2; 3, 4]`      | 1, 2, 3, 4 |
/// | `single(0.5)`      | 0.5        |
/// | `true`             | 1          |
/// | `Ts`, `2*pi`, `[]` | nothing    |
std::optional<std::vector<double>> HX_ReadNumbers(std::string_view text);

/// RETURNS: the number, if \p text is a literal of one.
std::optional<double> HX_ReadNumber(std::string_view text);

/// RETURNS: the product of dimensions such as "3", "[3 1]" or "[2,2]"; 1 for
/// "-1", an expression, and everything above 65535.
int HX_ReadDimensions(std::string_view text);

/// True for a C identifier of ASCII letters, digits and '_'.
bool HX_IsIdentifier(std::string_view text);

std::string_view HX_Trimmed(std::string_view text);

#endif  // HOST_IMPORT_HX_LITERALS_H
