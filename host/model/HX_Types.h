// A data type of the generated code, as the document describes the type.

#ifndef HOST_MODEL_HX_TYPES_H
#define HOST_MODEL_HX_TYPES_H

#include <optional>
#include <string>
#include <vector>

#include "host/base/HX_Faults.h"
#include "host/model/HX_Kinds.h"
#include "platform/datatypes/HX_DataType.h"
#include "platform/datatypes/HX_NumericalType.h"

/// Fields without a comment mean what the schema says.
struct HX_TypeItem {
  struct Field {
    std::string name;
    HX_TypeItem* type;
    HX_TokenEnd place;  // of the name
  };
  struct Constant {
    std::string name;
    int value;
    HX_TokenEnd place;  // of the name
  };

  explicit HX_TypeItem(const KyCXString& nameInCode) : type(nameInCode) {}

  std::string id;
  std::string name;
  HX_TokenEnd place = 0;  // of the name
  std::size_t index = 0;  // in the document
  HX_TypeKind kind = HX_TypeKind::eBase;
  std::optional<HX_CType> cType;
  int bits = 0;
  int length = 0;
  std::size_t elements = 1;  // scalars in arrays and structures
  bool isNameless = false;
  HX_TypeItem* of = nullptr;
  std::vector<Field> fields;
  std::vector<Constant> values;
  std::optional<HX_NumericalType> numerical;  // range of the kinds without `of`
  HX_DataType type;                           // as the library sees the type

  /// RETURNS: the last type of the chain of `of`, the storage of one value or
  /// of one array element.
  const HX_TypeItem* scalar() const;
  bool isFloating() const {
    return cType == HX_CType::eFloat || cType == HX_CType::eDouble;
  }
};

#endif  // HOST_MODEL_HX_TYPES_H
