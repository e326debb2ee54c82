// Answers questions that concern several data types.

#ifndef PLATFORM_DATATYPES_HX_DATATYPESERVER_H
#define PLATFORM_DATATYPES_HX_DATATYPESERVER_H

#include "platform/datatypes/HX_DataType.h"

class HxCSrcRef;

/// The base types as a whole.
class HX_BaseTypeServer : public HX_BaseTypeServerStandIn {
 public:
  /// The type that bit fields are declared with; null for none.
  HX_DataType* getBitfieldBaseType() const { return m_pBitfieldBase; }
};

/// Owns the server of the base types; types are not owned.
class HX_DataTypeServer {
 public:
  /// The element type of an array (of arrays); any other type is returned.
  HX_DataType* getAsScalar(HX_DataType* type, const HxCSrcRef*) const {
    while (type->getElement() != nullptr) type = type->getElement();
    return type;
  }
  /// Never null.
  HX_BaseTypeServer* getBaseServer() { return &m_BaseServer; }

 private:
  HX_BaseTypeServer m_BaseServer;
};

#endif  // PLATFORM_DATATYPES_HX_DATATYPESERVER_H
