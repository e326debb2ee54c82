// The header with the types of a model.

#ifndef HOST_WRITE_HX_CTYPES_H
#define HOST_WRITE_HX_CTYPES_H

#include <string>
#include <vector>

#include "host/model/HX_Model.h"

/// Headers that the types need, checks of widths, and macros that place
/// variables, as far as the model asks for them.
std::string HX_TypesPrologue(const HX_Model& model,
                             const std::vector<const HX_TypeItem*>& types);

/// The definition of a type; empty for a bit field, for a type without a name
/// and for a type that <stdint.h> defines.
std::string HX_TypeDefinition(const HX_TypeItem& type, bool usesStdint);

#endif  // HOST_WRITE_HX_CTYPES_H
