// The options of a code generation run.

#ifndef PLATFORM_MODEL_HX_OPTIONS_H
#define PLATFORM_MODEL_HX_OPTIONS_H

#include "platform/strings/KyCXString.h"

/// The host sets them before the run; see HxCGlobal::setOptions().
class HX_Options {
 public:
  /// Whether generated names are cut to HxCSymbol::sm_MaxNameLength.
  bool getLimitVariableNameLength() const { return m_LimitNames; }
  void setLimitVariableNameLength(bool limit) { m_LimitNames = limit; }

  /// The subsystem identifier where the model names none.
  const KyCXString& getHxSystemID() const { return m_SystemId; }
  void setHxSystemID(const KyCXString& id) { m_SystemId = id; }

 private:
  bool m_LimitNames = false;
  KyCXString m_SystemId;
};

/// The options as the generator extends them.
class HX_OptionsExt : public HX_Options {};

#endif  // PLATFORM_MODEL_HX_OPTIONS_H
