// What a document asks of its C code; everything is off by default.

#ifndef HOST_MODEL_HX_CODEOPTIONS_H
#define HOST_MODEL_HX_CODEOPTIONS_H

#include <optional>
#include <set>
#include <string>

#include "host/model/HX_Kinds.h"

/// Parts of the comment above a declaration.
enum class HX_CommentPart { eId, ePath, eUnit };

inline constexpr HX_Word<HX_CommentPart> kHxCommentParts[] = {
    {"id", HX_CommentPart::eId},
    {"path", HX_CommentPart::ePath},
    {"unit", HX_CommentPart::eUnit},
};

/// Types of <stdint.h> in place of plain types; floating types have none.
inline constexpr HX_Word<HX_CType> kHxStdintTypes[] = {
    {"int8_t", HX_CType::eSignedChar}, {"uint8_t", HX_CType::eUnsignedChar},
    {"int16_t", HX_CType::eShort},     {"uint16_t", HX_CType::eUnsignedShort},
    {"int32_t", HX_CType::eInt},       {"uint32_t", HX_CType::eUnsignedInt},
};

/// Fields mean what the schema says of "options.code".
struct HX_CodeOptions {
  bool usesStdint = false;
  bool checksWidths = false;
  bool hasBanner = false;
  std::optional<std::set<HX_CommentPart>> comments;  // none: path, else id
};

/// Wishes of a variable for its definition.
struct HX_Placement {
  bool isConst = false;
  bool isVolatile = false;
  bool isStatic = false;
  int alignment = 0;    // bytes; 0 for none
  std::string section;  // empty for none
};

#endif  // HOST_MODEL_HX_CODEOPTIONS_H
