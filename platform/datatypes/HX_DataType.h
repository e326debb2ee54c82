// The data types of the generated code, as far as names depend on them.
//
//   HX_DataType int16("Int16");
//   int16.setCut("i16").setBase();
//   HX_DataType speed("speed_t");
//   speed.setDerivedFrom(&int16);

#ifndef PLATFORM_DATATYPES_HX_DATATYPE_H
#define PLATFORM_DATATYPES_HX_DATATYPE_H

#include <memory>

#include "platform/strings/KyCXString.h"

class HX_DataType;
class HX_NumericalType;
class HxCSrcRef;

/// What only a base type has.
class HX_BaseTypeProperties {
 public:
  /// \param cut  the short form of the type's name
  explicit HX_BaseTypeProperties(const KyCXString& cut) : m_Cut(cut) {}
  /// The short form of the type's name; owned by the properties, never null.
  KyCXString* getCut() { return &m_Cut; }

 private:
  KyCXString m_Cut;
};

/// One type of any kind. Types, numerical types and references it points to
/// are not owned and outlive it.
class HX_DataType {
 public:
  /// Kinds that have neither a base type nor a cut.
  enum UnnamedKind { eNamed, eUnnamedStruct, eUnnamedEnum };

  /// A type that is none of the kinds below, until it is told.
  explicit HX_DataType(const KyCXString& nameInCode)
      : m_NameInCode(nameInCode) {}
  HX_DataType(const HX_DataType&) = delete;
  HX_DataType& operator=(const HX_DataType&) = delete;
  virtual ~HX_DataType() = default;

  /// Each gives this type back, so that calls can be chained.
  HX_DataType& setSrcRef(const HxCSrcRef* srcRef) {
    m_pSrcRef = srcRef;
    return *this;
  }
  HX_DataType& setCut(const KyCXString& cut) {
    m_pProperties = std::make_unique<HX_BaseTypeProperties>(cut);
    return *this;
  }
  HX_DataType& setBase() {
    m_IsBase = true;
    return *this;
  }
  HX_DataType& setBitfield() {
    m_IsBitfield = true;
    return *this;
  }
  HX_DataType& set64BitInteger() {
    m_Is64Bit = true;
    return *this;
  }
  /// Null makes a derived type whose origin is not known.
  HX_DataType& setDerivedFrom(HX_DataType* type) {
    m_IsDerived = true;
    m_pOrigin = type;
    return *this;
  }
  /// The type under this one, without making this one a derived type.
  HX_DataType& setOrigin(HX_DataType* type) {
    m_pOrigin = type;
    return *this;
  }
  HX_DataType& setNumerical(HX_NumericalType* type) {
    m_pNumerical = type;
    return *this;
  }
  HX_DataType& setUnderlyingType(HX_DataType* type) {
    m_pUnderlying = type;
    return *this;
  }
  /// \param hasName  the type has a name object of its own
  HX_DataType& setUnnamed(UnnamedKind kind, bool hasName) {
    m_Unnamed = kind;
    m_HasNameObject = hasName;
    return *this;
  }
  /// Makes this an array of \p element.
  HX_DataType& setElement(HX_DataType* element) {
    m_pElement = element;
    return *this;
  }

  /// What was set, or what the kind implies.
  const HxCSrcRef* getSrcRef() const { return m_pSrcRef; }
  const KyCXString& getNameInCode() const { return m_NameInCode; }
  virtual bool isUnnamedStruct() const { return m_Unnamed == eUnnamedStruct; }
  virtual bool isUnnamedEnum() const { return m_Unnamed == eUnnamedEnum; }
  /// The name of an unnamed kind; null if it has none.
  virtual const KyCXString* getNameObject() const {
    return m_HasNameObject ? &m_NameInCode : nullptr;
  }
  virtual bool isBitfield() const { return m_IsBitfield; }
  virtual bool isDerived() const { return m_IsDerived; }
  virtual HX_DataType* getDerivedFrom() const { return m_pOrigin; }
  virtual bool isBaseType() const { return m_IsBase; }
  virtual bool is64BitInteger() const { return m_Is64Bit; }
  virtual HX_NumericalType* getNumericalType() const { return m_pNumerical; }
  /// Null for a type without a cut.
  virtual HX_BaseTypeProperties* getBaseTypeProperties() const {
    return m_pProperties.get();
  }
  /// Where a numerical type without properties takes its cut from.
  virtual HX_DataType* getUnderlyingType() const { return m_pUnderlying; }
  /// The element type of an array, null for a scalar.
  HX_DataType* getElement() const { return m_pElement; }

 private:
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
};

#endif  // PLATFORM_DATATYPES_HX_DATATYPE_H
