// Fills the stand-in of the data types: constructors, setters and data. A host
// with data types of its own needs none of them; HX_DataType.h and
// HX_DataTypeServer.h show the calls of the library alone.
//
//   HX_DataType int16("Int16");
//   int16.setCut("i16").setBase();
//   HX_DataType speed("speed_t");
//   speed.setDerivedFrom(&int16);

#ifndef PLATFORM_DATATYPES_HX_DATATYPESTANDIN_H
#define PLATFORM_DATATYPES_HX_DATATYPESTANDIN_H

#include <memory>

#include "platform/strings/KyCXString.h"

class HX_DataType;
class HX_NumericalType;
class HxCSrcRef;

/// Properties of a base type.
class HX_BaseTypeProperties {
 public:
  /// \param cut  the short form of the name of the type
  explicit HX_BaseTypeProperties(const KyCXString& cut) : m_Cut(cut) {}
  /// The short form of the name of the type; never null.
  /// OWNERSHIP: the properties'.
  KyCXString* getCut() { return &m_Cut; }

 private:
  KyCXString m_Cut;
};

/// Base of HX_DataType, which is \p Type: each setter returns the type, so that
/// calls can be chained. Types and references set here are not owned.
template <class Type>
class HX_DataTypeStandIn {
 public:
  /// Kinds that have neither a base type nor a cut.
  enum UnnamedKind { eNamed, eUnnamedStruct, eUnnamedEnum };

  /// A type of no kind, until a setter gives the type a kind.
  explicit HX_DataTypeStandIn(const KyCXString& nameInCode)
      : m_NameInCode(nameInCode) {}

  /// The item that the type stems from.
  Type& setSrcRef(const HxCSrcRef* srcRef) {
    m_pSrcRef = srcRef;
    return self();
  }
  /// The short form of the name.
  Type& setCut(const KyCXString& cut) {
    m_pProperties = std::make_unique<HX_BaseTypeProperties>(cut);
    return self();
  }
  /// The kind.
  Type& setBase() {
    m_IsBase = true;
    return self();
  }
  Type& setBitfield() {
    m_IsBitfield = true;
    return self();
  }
  Type& set64BitInteger() {
    m_Is64Bit = true;
    return self();
  }
  /// Null makes a derived type of unknown origin.
  Type& setDerivedFrom(HX_DataType* type) {
    m_IsDerived = true;
    m_pOrigin = type;
    return self();
  }
  /// The type below, without making a derived type.
  Type& setOrigin(HX_DataType* type) {
    m_pOrigin = type;
    return self();
  }
  /// The range of a numerical type.
  Type& setNumerical(HX_NumericalType* type) {
    m_pNumerical = type;
    return self();
  }
  /// Where a numerical type without properties takes the cut from.
  Type& setUnderlyingType(HX_DataType* type) {
    m_pUnderlying = type;
    return self();
  }
  /// \param hasName  the type has a name object of its own
  Type& setUnnamed(UnnamedKind kind, bool hasName) {
    m_Unnamed = kind;
    m_HasNameObject = hasName;
    return self();
  }
  /// Makes an array of \p element.
  Type& setElement(HX_DataType* element) {
    m_pElement = element;
    return self();
  }
  /// The element type of an array, null for a scalar.
  HX_DataType* getElement() const { return m_pElement; }

 protected:
  KyCXString m_NameInCode;
  const HxCSrcRef* m_pSrcRef = nullptr;
  std::unique_ptr<HX_BaseTypeProperties> m_pProperties;
  HX_DataType* m_pOrigin = nullptr;
  HX_DataType* m_pUnderlying = nullptr;
  HX_DataType* m_pElement = nullptr;
  HX_NumericalType* m_pNumerical = nullptr;
  UnnamedKind m_Unnamed = eNamed;
  bool m_HasNameObject = false;
  bool m_IsBase = false;
  bool m_IsBitfield = false;
  bool m_IsDerived = false;
  bool m_Is64Bit = false;

 private:
  Type& self() { return static_cast<Type&>(*this); }
};

/// Base of HX_BaseTypeServer. The type is not owned.
class HX_BaseTypeServerStandIn {
 public:
  /// Sets the type that bit fields are declared with; null for none.
  void setBitfieldBaseType(HX_DataType* type) { m_pBitfieldBase = type; }

 protected:
  HX_DataType* m_pBitfieldBase = nullptr;
};

#endif  // PLATFORM_DATATYPES_HX_DATATYPESTANDIN_H
