// The data types of the generated code, as far as names depend on them.
//
// How a host fills the stand-in: HX_DataTypeStandIn.h.

#ifndef PLATFORM_DATATYPES_HX_DATATYPE_H
#define PLATFORM_DATATYPES_HX_DATATYPE_H

#include "platform/datatypes/HX_DataTypeStandIn.h"
#include "platform/strings/KyCXString.h"

class HX_NumericalType;
class HxCSrcRef;

/// One type of any kind. Types and references that a type points to are not
/// owned and outlive the type.
class HX_DataType : public HX_DataTypeStandIn<HX_DataType> {
 public:
  using HX_DataTypeStandIn<HX_DataType>::HX_DataTypeStandIn;
  HX_DataType(const HX_DataType&) = delete;
  HX_DataType& operator=(const HX_DataType&) = delete;
  virtual ~HX_DataType() = default;

  /// The item that the type stems from; may be null.
  const HxCSrcRef* getSrcRef() const { return m_pSrcRef; }
  /// The name in the generated code.
  const KyCXString& getNameInCode() const { return m_NameInCode; }

  /// Kinds.
  virtual bool isUnnamedStruct() const { return m_Unnamed == eUnnamedStruct; }
  virtual bool isUnnamedEnum() const { return m_Unnamed == eUnnamedEnum; }
  virtual bool isBitfield() const { return m_IsBitfield; }
  virtual bool isDerived() const { return m_IsDerived; }
  virtual bool isBaseType() const { return m_IsBase; }
  virtual bool is64BitInteger() const { return m_Is64Bit; }

  /// The name object of an unnamed kind; null for a type without a name object.
  virtual const KyCXString* getNameObject() const {
    return m_HasNameObject ? &m_NameInCode : nullptr;
  }
  /// The type below a derived type; null if unknown.
  virtual HX_DataType* getDerivedFrom() const { return m_pOrigin; }
  /// The range; null for a type that is not numerical.
  virtual HX_NumericalType* getNumericalType() const { return m_pNumerical; }
  /// The cut; null for a type without a cut.
  virtual HX_BaseTypeProperties* getBaseTypeProperties() const {
    return m_pProperties.get();
  }
  /// Where a numerical type without properties takes the cut from.
  virtual HX_DataType* getUnderlyingType() const { return m_pUnderlying; }
};

#endif  // PLATFORM_DATATYPES_HX_DATATYPE_H
