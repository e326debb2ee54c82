// State of one expansion, and rows of the scan loop; private to HxCNames.

#ifndef NAMING_HXCNAMESSCAN_H
#define NAMING_HXCNAMESSCAN_H

#include "Naming/HxCNames.h"

/// Error code of the assertions in all sources of HxCNames.
constexpr char kNamesErrorCode[] = "HxCNames";

/// Naming context of one name, and position and result of the scan.
struct HxCNames::Scan {
  HxCCIdentifier* pId;
  HX_DataType* type;
  unsigned int retained;
  unsigned int provisional;
  bool suppressMessages;

  // Naming context.
  const HxCSrcRef* srcRef = nullptr;     ///< may move to a parent or a chart
  const HxCSrcRef* reportRef = nullptr;  ///< source reference before a move
  HX_Block* block = nullptr;
  SC_Model* sfObject = nullptr;
  KyCXString systemId{};  ///< of block or chart, else of the root
  KyCXString ddName{};
  HX_BdBlock* ivBlock = nullptr;
  bool changeable = false;   ///< set by $R, $S and $C
  bool hasSystemId = false;  ///< set by a block or chart, even if empty

  // Scan.
  KyCXString standIn{};         ///< replaces an empty template
  KyCXString* pForm = nullptr;  ///< the template
  int pos = 0;
  KyCXString result{};

  HxCCIdentifier& id() { return *pId; }
  KyCXString& form() { return *pForm; }
  const KyCXString& label() { return pId->m_SignalLabel; }
  const KyCXString& xValue() { return pId->m_DollarXValue; }
  void setSystemId(const KyCXString& text) {
    systemId = text;
    hasSystemId = true;
  }
};

/// Row of the scan loop. The operation appends to the result and returns the
/// number of template characters consumed, '$' included.
struct HxCNames::MacroRow {
  const char* text;  ///< text of the macro, or "$("
  int (*expand)(HxCNames& names, Scan& scan);
  void (HxCCIdentifier::*noteUse)(bool,
                                  HxCCIdentifier::HxENameTypeTag) = nullptr;
};

#endif  // NAMING_HXCNAMESSCAN_H
