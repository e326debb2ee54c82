// What the expansion of one name works on; private to HxCNames.

#ifndef NAMING_HXCNAMESSCAN_H
#define NAMING_HXCNAMESSCAN_H

#include "Naming/HxCNames.h"

class SC_State;

/// The model objects that the macros of one name speak of.
struct HxCNames::Context {
  const HxCSrcRef* srcRef = nullptr;     ///< may move to a parent or a chart
  const HxCSrcRef* reportRef = nullptr;  ///< the reference before any move
  HX_Block* block = nullptr;
  SC_Model* sfObject = nullptr;
  KyCXString systemId;  ///< of the block or chart, else of the root
  KyCXString ddName;
  HX_BdBlock* ivBlock = nullptr;
  bool changeable = false;   ///< set by $R, $S and $C
  bool hasSystemId = false;  ///< a block or chart has set it, maybe to empty

  void setSystemId(const KyCXString& id) {
    systemId = id;
    hasSystemId = true;
  }
};

/// The state of the scan of one template.
struct HxCNames::Scan {
  HxCNames& names;
  HxCCIdentifier& id;
  HX_DataType* type;
  unsigned int retained;
  unsigned int provisional;
  bool suppressMessages;
  Context& context;
  const KyCXString& form;  ///< the template
  KyCXString result;
  int pos = 0;
};

/// One row per macro. The expansion appends to the result and returns the
/// number of template characters it consumed, from the '$' on.
struct HxCNames::MacroRow {
  char letter;
  int (*expand)(Scan& scan);
};

#endif  // NAMING_HXCNAMESSCAN_H
