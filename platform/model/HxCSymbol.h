// A symbol of the generated code.

#ifndef PLATFORM_MODEL_HXCSYMBOL_H
#define PLATFORM_MODEL_HXCSYMBOL_H

#include "platform/model/HX_ModelStandIn.h"
#include "platform/strings/KyCXString.h"

class HX_DataType;

/// A name with a kind.
class HxCSymbol : public HX_SymbolStandIn {
 public:
  /// The longest generated name, in characters: the length that ISO C90
  /// guarantees for internal identifiers (5.2.4.1).
  static constexpr int sm_MaxNameLength = 31;

  /// Kinds of symbols.
  enum HxESymbolKindTag { eVariable = 1, eConstant = 2, eFunction = 3 };

  using HX_SymbolStandIn::HX_SymbolStandIn;

  /// The name in the code.
  const KyCXString& getName() const { return m_Name; }
  /// A HxESymbolKindTag, or a number of the host.
  int getKind() const { return m_Kind; }
  /// Null for a symbol without a type.
  HX_DataType* getDataType() const { return m_pDataType; }

  /// The text for the macro $X; never null.
  /// OWNERSHIP: the symbol's.
  char* getDollarX() { return m_DollarX.data(); }
};

#endif  // PLATFORM_MODEL_HXCSYMBOL_H
