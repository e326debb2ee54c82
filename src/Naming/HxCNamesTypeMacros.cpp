// Evaluators of the macros that name data types.

#include "Control/HX_SelfCheck.h"
#include "Naming/HxCNames.h"
#include "platform/datatypes/HX_DataTypeServer.h"
#include "platform/datatypes/HX_NumericalType.h"
#include "platform/model/HxCGlobal.h"

namespace {

constexpr char kErrorCode[] = __FILE__ "_";
constexpr char kUnknownBaseType[] = "_UnknownHXBaseType_";

// An array is named by its elements.
HX_DataType* scalarOf(HX_DataType* type) {
  return HxCGlobal::getDataTypeServer()->getAsScalar(type, type->getSrcRef());
}

bool isUnnamed(const HX_DataType& type) {
  return type.isUnnamedStruct() || type.isUnnamedEnum();
}

KyCXString cutOf(const HX_DataType* type) {
  HX_BaseTypeProperties* properties =
      type == nullptr ? nullptr : type->getBaseTypeProperties();
  return properties == nullptr ? KyCXString() : *properties->getCut();
}

KyCXString cutOfNumerical(const HX_DataType& type) {
  const bool hasOwn = type.getBaseTypeProperties() != nullptr;
  return cutOf(hasOwn ? &type : type.getUnderlyingType());
}

// The short name of a scalar type; the questions stand in their order.
KyCXString shortName(const HX_DataType& type) {
  if (isUnnamed(type)) return {};
  if (type.isDerived()) return cutOf(type.getDerivedFrom());
  if (type.isBaseType()) return cutOf(&type);
  if (type.is64BitInteger()) {
    const HX_NumericalType* numerical = type.getNumericalType();
    return numerical != nullptr && numerical->isSigned() ? "I64" : "U64";
  }
  if (type.getNumericalType() != nullptr) return cutOfNumerical(type);
  HX_Assert(false, kErrorCode);
  return {};
}

}  // namespace

KyCXString HxCNames::getTypeNameInCode(HX_DataType* type) {
  return type->getNameInCode();
}

int HxCNames::evaluateTypeNameMacro(KyCXString& result,
                                    unsigned int retainedMacros,
                                    unsigned int provisionalMacros,
                                    HX_DataType* type) {
  constexpr int kMacroLength = 2;
  if (isRetained(result, retainedMacros, provisionalMacros, eMacroTypeName,
                 "$T"))
    return kMacroLength;
  if (type == nullptr)
    result += "_T";
  else
    result += shortName(*scalarOf(type));
  return kMacroLength;
}

void HxCNames::evaluateLongTypeMacro(KyCXString& result,
                                     unsigned int retainedMacros,
                                     unsigned int provisionalMacros,
                                     HX_DataType* type) {
  if (isRetained(result, retainedMacros, provisionalMacros, eMacroLongTypeName,
                 "$(Type)"))
    return;
  if (type == nullptr) {
    result += "__Type_";
    return;
  }
  HX_DataType* scalar = scalarOf(type);
  KyCXString text;
  if (isUnnamed(*scalar)) {
    if (scalar->getNameObject() != nullptr) text = getTypeNameInCode(scalar);
  } else if (HX_Assert(scalar->isDerived() || scalar->isBaseType() ||
                           scalar->getNumericalType() != nullptr,
                       kErrorCode)) {
    text = getTypeNameInCode(scalar);
  }
  result += text.makeCIdentifier(false);
}

void HxCNames::evaluateBaseTypeMacro(KyCXString& result,
                                     unsigned int retainedMacros,
                                     unsigned int provisionalMacros,
                                     HX_DataType* type) {
  if (isRetained(result, retainedMacros, provisionalMacros, eMacroLongTypeName,
                 "$(BaseType)"))
    return;
  if (type == nullptr) {
    result += "__BaseType_";
    return;
  }
  KyCXString text = baseTypeName(scalarOf(type));
  result += text.makeCIdentifier(false);
}

// The questions stand in their order; the base type may be missing.
KyCXString HxCNames::baseTypeName(HX_DataType* scalar) {
  const auto nameOf = [](HX_DataType* base) {
    return base == nullptr ? KyCXString(kUnknownBaseType)
                           : getTypeNameInCode(base);
  };
  if (isUnnamed(*scalar)) return {};
  if (scalar->isBitfield()) {
    const KyCXString name = nameOf(
        HxCGlobal::getDataTypeServer()->getBaseServer()->getBitfieldBaseType());
    return name.isEmpty() ? KyCXString(kUnknownBaseType) : name;
  }
  if (scalar->isDerived()) return nameOf(scalar->getDerivedFrom());
  if (scalar->isBaseType()) return getTypeNameInCode(scalar);
  if (scalar->getNumericalType() != nullptr)
    return nameOf(scalar->getDerivedFrom());
  HX_Assert(false, kErrorCode);
  return {};
}
