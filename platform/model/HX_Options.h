// The options of a code generation run.

#ifndef PLATFORM_MODEL_HX_OPTIONS_H
#define PLATFORM_MODEL_HX_OPTIONS_H

#include "platform/model/HX_ModelStandIn.h"
#include "platform/strings/KyCXString.h"

/// A host sets the options before the run.
class HX_Options : public HX_OptionsStandIn {
 public:
  /// Whether generated names are cut to HxCSymbol::sm_MaxNameLength.
  bool getLimitVariableNameLength() const { return m_LimitNames; }
  /// The subsystem identifier where the model names none.
  const KyCXString& getHxSystemID() const { return m_SystemId; }
};

/// The options as the generator extends them.
class HX_OptionsExt : public HX_Options {};

#endif  // PLATFORM_MODEL_HX_OPTIONS_H
