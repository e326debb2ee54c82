#include "host/write/HX_CTypes.h"

#include <algorithm>
#include <set>

#include "host/names/HX_CFiles.h"

namespace {

std::string wordOf(HX_CType type, bool usesStdint) {
  const auto row = std::find_if(
      std::begin(kHxStdintTypes), std::end(kHxStdintTypes),
      [&](const HX_Word<HX_CType>& each) { return each.value == type; });
  return std::string(usesStdint && row != std::end(kHxStdintTypes)
                         ? row->word
                         : HX_WordOf(kHxCTypes, type));
}

// C90 compilers need to take bit fields of int and unsigned int only.
std::string structBody(const HX_TypeItem& type) {
  std::string fields;
  for (const auto& [name, field, place] : type.fields)
    fields += field->kind == HX_TypeKind::eBitField
                  ? "  unsigned int " + name + " : " +
                        std::to_string(field->bits) + ";\n"
                  : "  " + field->name + " " + name + ";\n";
  return "struct {\n" + fields + "}";
}

std::string enumBody(const HX_TypeItem& type) {
  std::string values;
  for (const auto& [name, value, place] : type.values)
    values += (values.empty() ? "  " : ",\n  ") + name + " = " +
              std::to_string(value);
  return "enum {\n" + values + "\n}";
}

std::string typeBody(const HX_TypeItem& type, bool usesStdint) {
  switch (type.kind) {
    case HX_TypeKind::eStruct:
      return structBody(type);
    case HX_TypeKind::eEnum:
      return enumBody(type);
    case HX_TypeKind::eInteger64:
      return "struct {\n  " + wordOf(HX_CType::eUnsignedInt, usesStdint) +
             " low;\n  " +
             wordOf(type.numerical->isSigned() ? HX_CType::eInt
                                               : HX_CType::eUnsignedInt,
                    usesStdint) +
             " high;\n}";
    case HX_TypeKind::eBase:
      return wordOf(*type.cType, usesStdint);
    default:
      return type.of->name;
  }
}

struct WidthRow {
  std::set<HX_CType> types;
  const char* holds;  // of a compiler with the width of the model
  const char* text;
};

// The preprocessor of C90 computes with 32 bits.
const WidthRow kWidths[] = {
    {{HX_CType::eSignedChar, HX_CType::eUnsignedChar},
     "UCHAR_MAX == 255 && SCHAR_MIN == -128",
     "char has not 8 bits"},
    {{HX_CType::eShort, HX_CType::eUnsignedShort},
     "USHRT_MAX == 65535 && SHRT_MIN == -32768",
     "short has not 16 bits"},
    {{HX_CType::eInt, HX_CType::eUnsignedInt},
     "UINT_MAX == 4294967295U && INT_MIN == -2147483647 - 1",
     "int has not 32 bits"},
    {{HX_CType::eFloat},
     "FLT_RADIX == 2 && FLT_MANT_DIG == 24 && FLT_MAX_EXP == 128",
     "float has not 32 bits"},
    {{HX_CType::eDouble},
     "FLT_RADIX == 2 && DBL_MANT_DIG == 53 && DBL_MAX_EXP == 1024",
     "double has not 64 bits"},
};

// The types of C that the code uses, but for those of <stdint.h>.
std::set<HX_CType> usedTypes(const std::vector<const HX_TypeItem*>& types,
                             bool usesStdint) {
  std::set<HX_CType> used;
  for (const HX_TypeItem* type : types) {
    if (type->cType && (!usesStdint || type->isFloating()))
      used.insert(*type->cType);
    if (type->kind == HX_TypeKind::eBitField ||
        (type->kind == HX_TypeKind::eInteger64 && !usesStdint))
      used.insert(HX_CType::eUnsignedInt);
  }
  return used;
}

std::string widthChecks(const std::vector<const HX_TypeItem*>& types,
                        bool usesStdint) {
  const std::set<HX_CType> used = usedTypes(types, usesStdint);
  std::string checks;
  for (const WidthRow& row : kWidths) {
    if (std::none_of(row.types.begin(), row.types.end(),
                     [&](HX_CType type) { return used.count(type) != 0; }))
      continue;
    checks += std::string("#if !(") + row.holds + ")\n#error \"" + row.text +
              "\"\n#endif\n";
  }
  return checks.empty()
             ? checks
             : "#include <float.h>\n#include <limits.h>\n\n" + checks + "\n";
}

constexpr char kSectionMacro[] =
    "#ifndef HX_SECTION\n"
    "#if defined(__GNUC__) || defined(__TINYC__)\n"
    "#define HX_SECTION(name) __attribute__((section(name)))\n"
    "#else\n"
    "#error \"define HX_SECTION(name) for this compiler\"\n"
    "#endif\n"
    "#endif\n\n";

constexpr char kAlignedMacro[] =
    "#ifndef HX_ALIGNED\n"
    "#if defined(__GNUC__) || defined(__TINYC__)\n"
    "#define HX_ALIGNED(bytes) __attribute__((aligned(bytes)))\n"
    "#elif defined(__cplusplus)\n"
    "#define HX_ALIGNED(bytes) alignas(bytes)\n"
    "#elif defined(__STDC_VERSION__) && __STDC_VERSION__ >= 201112L\n"
    "#define HX_ALIGNED(bytes) _Alignas(bytes)\n"
    "#else\n"
    "#error \"define HX_ALIGNED(bytes) for this compiler\"\n"
    "#endif\n"
    "#endif\n\n";

}  // namespace

std::string HX_TypesPrologue(const HX_Model& model,
                             const std::vector<const HX_TypeItem*>& types) {
  std::string text;
  if (model.code.usesStdint) text += "#include <stdint.h>\n\n";
  if (model.code.checksWidths)
    text += widthChecks(types, model.code.usesStdint);
  const auto anyPlaced = [&](auto wish) {
    return std::any_of(
        model.names.begin(), model.names.end(),
        [&](const HX_WantedName& name) { return wish(name.rare().placement); });
  };
  if (anyPlaced([](const HX_Placement& p) { return !p.section.empty(); }))
    text += kSectionMacro;
  if (anyPlaced([](const HX_Placement& p) { return p.alignment != 0; }))
    text += kAlignedMacro;
  return text;
}

std::string HX_TypeDefinition(const HX_TypeItem& type, bool usesStdint) {
  if (type.kind == HX_TypeKind::eBitField || type.isNameless) return {};
  const std::string body = typeBody(type, usesStdint);
  if (body == type.name) return {};
  const std::string length = type.kind == HX_TypeKind::eArray
                                 ? "[" + std::to_string(type.length) + "]"
                                 : "";
  return "typedef " + body + " " + type.name + length + ";\n";
}
