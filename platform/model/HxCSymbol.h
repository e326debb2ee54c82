// A symbol of the generated code.

#ifndef PLATFORM_MODEL_HXCSYMBOL_H
#define PLATFORM_MODEL_HXCSYMBOL_H

#include <string>

#include "platform/strings/KyCXString.h"

class HX_DataType;

/// The data type is not owned; null for a symbol without one.
class HxCSymbol {
 public:
  /// The longest generated name, in characters: what ISO C90 guarantees for
  /// internal identifiers (5.2.4.1).
  static constexpr int sm_MaxNameLength = 31;

  /// What a symbol stands for.
  enum HxESymbolKindTag { eVariable = 1, eConstant = 2, eFunction = 3 };

  /// \param kind  a HxESymbolKindTag, or a number of the host's own
  HxCSymbol(const KyCXString& name, int kind, HX_DataType* dataType = nullptr)
      : m_Name(name), m_Kind(kind), m_pDataType(dataType) {}

  /// As given to the constructor.
  const KyCXString& getName() const { return m_Name; }
  int getKind() const { return m_Kind; }
  HX_DataType* getDataType() const { return m_pDataType; }

  /// The text for the macro $X, owned by the symbol; never null.
  char* getDollarX() { return m_DollarX.data(); }
  void setDollarX(const char* text) { m_DollarX = text; }

 private:
  KyCXString m_Name;
  int m_Kind;
  HX_DataType* m_pDataType;
  std::string m_DollarX;
};

#endif  // PLATFORM_MODEL_HXCSYMBOL_H
