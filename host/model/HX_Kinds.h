// The words of a document that choose between a few kinds, as enumerations.
//
//   HX_ValueOf(kHxTypeKinds, "array");      // HX_TypeKind::eArray
//   HX_WordOf(kHxNameKinds, HX_NameKind::eTask);   // "task"

#ifndef HOST_MODEL_HX_KINDS_H
#define HOST_MODEL_HX_KINDS_H

#include <cstddef>
#include <string_view>

enum class HX_TypeKind {
  eBase,
  eDerived,
  eNumerical,
  eInteger64,
  eArray,
  eBitField,
  eStruct,
  eEnum
};

/// The arithmetic types of C90.
enum class HX_CType {
  eSignedChar,
  eUnsignedChar,
  eShort,
  eUnsignedShort,
  eInt,
  eUnsignedInt,
  eFloat,
  eDouble
};

enum class HX_ScopeKind { eFile, eFunction, eBlock, eFlat };

enum class HX_NameKind { eVariable, eFunction, eTask, eIsr, eObject, eFile };

/// A word of the schema and its value.
template <class Value>
struct HX_Word {
  std::string_view word;
  Value value;
};

inline constexpr HX_Word<HX_TypeKind> kHxTypeKinds[] = {
    {"base", HX_TypeKind::eBase},
    {"derived", HX_TypeKind::eDerived},
    {"numerical", HX_TypeKind::eNumerical},
    {"integer64", HX_TypeKind::eInteger64},
    {"array", HX_TypeKind::eArray},
    {"bitField", HX_TypeKind::eBitField},
    {"struct", HX_TypeKind::eStruct},
    {"enum", HX_TypeKind::eEnum},
};

inline constexpr HX_Word<HX_CType> kHxCTypes[] = {
    {"signed char", HX_CType::eSignedChar},
    {"unsigned char", HX_CType::eUnsignedChar},
    {"short", HX_CType::eShort},
    {"unsigned short", HX_CType::eUnsignedShort},
    {"int", HX_CType::eInt},
    {"unsigned int", HX_CType::eUnsignedInt},
    {"float", HX_CType::eFloat},
    {"double", HX_CType::eDouble},
};

inline constexpr HX_Word<HX_ScopeKind> kHxScopeKinds[] = {
    {"file", HX_ScopeKind::eFile},
    {"function", HX_ScopeKind::eFunction},
    {"block", HX_ScopeKind::eBlock},
    {"flat", HX_ScopeKind::eFlat},
};

inline constexpr HX_Word<HX_NameKind> kHxNameKinds[] = {
    {"variable", HX_NameKind::eVariable}, {"function", HX_NameKind::eFunction},
    {"task", HX_NameKind::eTask},         {"isr", HX_NameKind::eIsr},
    {"object", HX_NameKind::eObject},     {"file", HX_NameKind::eFile},
};

/// REQUIRES: the table has \p word.
template <class Value, std::size_t count>
constexpr Value HX_ValueOf(const HX_Word<Value> (&table)[count],
                           std::string_view word) {
  const HX_Word<Value>* row = table;
  while (row->word != word) ++row;
  return row->value;
}

/// REQUIRES: the table has \p value.
template <class Value, std::size_t count>
constexpr std::string_view HX_WordOf(const HX_Word<Value> (&table)[count],
                                     Value value) {
  const HX_Word<Value>* row = table;
  while (row->value != value) ++row;
  return row->word;
}

#endif  // HOST_MODEL_HX_KINDS_H
