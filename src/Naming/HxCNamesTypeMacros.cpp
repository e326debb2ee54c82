// Evaluators of the macros that name data types.

#include "Control/HX_SelfCheck.h"
#include "Naming/HX_MacroRows.h"
#include "Naming/HxCNamesScan.h"
#include "platform/datatypes/HX_DataTypeServer.h"
#include "platform/datatypes/HX_NumericalType.h"
#include "platform/model/HxCGlobal.h"

namespace {

constexpr char kUnknownBaseType[] = "_UnknownHXBaseType_";

// An array takes the name of the element type.
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

// Short name of a scalar type. The first question that holds decides.
KyCXString shortName(const HX_DataType& type) {
  if (isUnnamed(type)) return {};
  if (type.isDerived()) return cutOf(type.getDerivedFrom());
  if (type.isBaseType()) return cutOf(&type);
  if (type.is64BitInteger()) {
    const HX_NumericalType* numerical = type.getNumericalType();
    return numerical != nullptr && numerical->isSigned() ? "I64" : "U64";
  }
  if (type.getNumericalType() != nullptr) return cutOfNumerical(type);
  HX_Assert(false, kNamesErrorCode);
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
  if (isRetained(result, retainedMacros, provisionalMacros, HX_MacroOf("$T")))
    return kMacroLength;
  if (type == nullptr)
    result += HX_MacroOf("$T").placeholder;
  else
    result += shortName(*scalarOf(type));
  return kMacroLength;
}

void HxCNames::evaluateLongTypeMacro(KyCXString& result,
                                     unsigned int retainedMacros,
                                     unsigned int provisionalMacros,
                                     HX_DataType* type) {
  if (isRetained(result, retainedMacros, provisionalMacros,
                 HX_MacroOf("$(Type)")))
    return;
  if (type == nullptr) {
    result += HX_MacroOf("$(Type)").placeholder;
    return;
  }
  HX_DataType* scalar = scalarOf(type);
  KyCXString text;
  if (isUnnamed(*scalar)) {
    if (scalar->getNameObject() != nullptr) text = getTypeNameInCode(scalar);
  } else if (HX_Assert(scalar->isDerived() || scalar->isBaseType() ||
                           scalar->getNumericalType() != nullptr,
                       kNamesErrorCode)) {
    text = getTypeNameInCode(scalar);
  }
  text.makeCIdentifier(false);
  result += text;
}

void HxCNames::evaluateBaseTypeMacro(KyCXString& result,
                                     unsigned int retainedMacros,
                                     unsigned int provisionalMacros,
                                     HX_DataType* type) {
  if (isRetained(result, retainedMacros, provisionalMacros,
                 HX_MacroOf("$(BaseType)")))
    return;
  if (type == nullptr) {
    result += HX_MacroOf("$(BaseType)").placeholder;
    return;
  }
  KyCXString text = baseTypeName(scalarOf(type));
  text.makeCIdentifier(false);
  result += text;
}

// The first question that holds decides; the base type may be missing.
KyCXString HxCNames::baseTypeName(HX_DataType* scalar) {
  const auto nameOf = [this](HX_DataType* base) {
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
  HX_Assert(false, kNamesErrorCode);
  return {};
}
