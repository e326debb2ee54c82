// Evaluators of the macros that name model objects.

#include "FLAG.h"
#include "Naming/HX_MacroRows.h"
#include "Naming/HxCNames.h"
#include "platform/model/HX_BdBlock.h"
#include "platform/model/HX_Block.h"
#include "platform/model/HxCGlobal.h"
#include "platform/model/SC_Model.h"

namespace {

constexpr int kMacroLength = 2;  // '$' and the letter

KyCXString number(int value) { return KyCXString(value, false, true); }

void appendAsCIdentifier(KyCXString& result, const KyCXString& text) {
  if (text.isValidCIdentifier()) {
    result += text;
    return;
  }
  KyCXString name(text);
  name.makeCIdentifier(false);
  result += name;
}

}  // namespace

// Rule of all evaluators: a provisional macro makes the name incomplete. A
// retained macro makes the name incomplete, too, and stays as text.
bool HxCNames::isRetained(KyCXString& result, unsigned int retainedMacros,
                          unsigned int provisionalMacros,
                          const HX_Macro& macro) {
  if (FLAG_GetFlag(&provisionalMacros, macro.bit)) m_NameComplete = false;
  if (!FLAG_GetFlag(&retainedMacros, macro.bit)) return false;
  result += macro.text;
  m_NameComplete = false;
  return true;
}

int HxCNames::evaluateLabelMacro(KyCXString& result,
                                 unsigned int retainedMacros,
                                 unsigned int provisionalMacros,
                                 const KyCXString& label,
                                 const HX_Block* block) {
  if (isRetained(result, retainedMacros, provisionalMacros, HX_MacroOf("$L")))
    return kMacroLength;
  // A propagated label stands in angle brackets.
  KyCXString text(label);
  text.trim(true, true);
  text.filterAngleBrackets();
  text.trim(true, true);
  if (!text.isEmpty())
    appendAsCIdentifier(result, text);
  else if (block != nullptr)
    appendAsCIdentifier(result, block->getName());
  return kMacroLength;
}

int HxCNames::evaluateBlockNameMacro(KyCXString& result,
                                     unsigned int retainedMacros,
                                     unsigned int provisionalMacros,
                                     const HX_Block* block,
                                     HX_BdBlock* ivBlock) {
  if (isRetained(result, retainedMacros, provisionalMacros, HX_MacroOf("$B")))
    return kMacroLength;
  if (block != nullptr)
    appendAsCIdentifier(result, block->getName());
  else if (ivBlock != nullptr)
    appendAsCIdentifier(result, ivBlock->getRawName());
  else
    result += HX_MacroOf("$B").placeholder;
  return kMacroLength;
}

int HxCNames::evaluateSystemNumberMacro(KyCXString& result,
                                        unsigned int retainedMacros,
                                        unsigned int provisionalMacros,
                                        HX_Block* block,
                                        const KyCXString& systemId,
                                        bool& changeable) {
  if (isRetained(result, retainedMacros, provisionalMacros, HX_MacroOf("$S")))
    return kMacroLength;
  changeable = true;
  if (block == nullptr && systemId.isEmpty()) {
    result += HX_MacroOf("$S").placeholder;
    return kMacroLength;
  }
  const int found =
      block == nullptr ? 0 : static_cast<int>(block->getSubsystemNumber());
  result += 'S';
  result += systemId;
  result += number(found < 0 ? 0 : found);
  return kMacroLength;
}

int HxCNames::evaluateSystemIDMacro(KyCXString& result,
                                    unsigned int retainedMacros,
                                    unsigned int provisionalMacros,
                                    const KyCXString& systemId) {
  if (!isRetained(result, retainedMacros, provisionalMacros, HX_MacroOf("$I")))
    result += systemId;
  return kMacroLength;
}

int HxCNames::evaluateModelNameMacro(KyCXString& result,
                                     unsigned int retainedMacros,
                                     unsigned int provisionalMacros) {
  if (!isRetained(result, retainedMacros, provisionalMacros, HX_MacroOf("$M")))
    result += GLB_GetModelName();
  return kMacroLength;
}

int HxCNames::evaluateSubsystemNameMacro(KyCXString& result,
                                         unsigned int retainedMacros,
                                         unsigned int provisionalMacros) {
  if (!isRetained(result, retainedMacros, provisionalMacros, HX_MacroOf("$N")))
    result += GLB_GetSubsystemName();
  return kMacroLength;
}

int HxCNames::evaluateStateHierarchyMacro(KyCXString& result,
                                          unsigned int retainedMacros,
                                          unsigned int provisionalMacros,
                                          const SC_Model* object) {
  if (isRetained(result, retainedMacros, provisionalMacros, HX_MacroOf("$H")))
    return kMacroLength;
  if (object == nullptr)
    result += HX_MacroOf("$H").placeholder;
  else
    result += object->getHierarchy();
  return kMacroLength;
}

int HxCNames::evaluateSFObjectNameMacro(KyCXString& result,
                                        unsigned int retainedMacros,
                                        unsigned int provisionalMacros,
                                        const SC_Model* object) {
  if (isRetained(result, retainedMacros, provisionalMacros, HX_MacroOf("$O")))
    return kMacroLength;
  if (object == nullptr)
    result += HX_MacroOf("$O").placeholder;
  else
    appendAsCIdentifier(result, object->getName());
  return kMacroLength;
}

int HxCNames::evaluateSFObjectIDMacro(KyCXString& result,
                                      unsigned int retainedMacros,
                                      unsigned int provisionalMacros,
                                      const SC_Model* object,
                                      const KyCXString& systemId,
                                      bool& changeable) {
  if (isRetained(result, retainedMacros, provisionalMacros, HX_MacroOf("$C")))
    return kMacroLength;
  if (object == nullptr) {
    result += HX_MacroOf("$C").placeholder;
    return kMacroLength;
  }
  changeable = true;
  result += 'C';
  result += systemId;
  result += number(object->getObjectNumber());
  return kMacroLength;
}

// A provisional $D writes the placeholder in front of value or macro.
int HxCNames::evaluateDdObjectNameMacro(KyCXString& result,
                                        unsigned int retainedMacros,
                                        unsigned int provisionalMacros,
                                        const KyCXString& ddName) {
  if (FLAG_GetFlag(&provisionalMacros, eMacroDdObjectName))
    result += HX_MacroOf("$D").placeholder;
  if (isRetained(result, retainedMacros, provisionalMacros, HX_MacroOf("$D")))
    return kMacroLength;
  if (ddName.isEmpty())
    result += HX_MacroOf("$D").placeholder;
  else
    result += ddName;
  return kMacroLength;
}

int HxCNames::evaluateXNameMacro(KyCXString& result,
                                 unsigned int retainedMacros,
                                 unsigned int provisionalMacros,
                                 const KyCXString& xValue) {
  if (isRetained(result, retainedMacros, provisionalMacros, HX_MacroOf("$X")))
    return kMacroLength;
  if (xValue.isEmpty())
    result += HX_MacroOf("$X").placeholder;
  else
    result += xValue;
  return kMacroLength;
}

int HxCNames::evaluateSFObjectRMacro(KyCXString& result,
                                     unsigned int retainedMacros,
                                     unsigned int provisionalMacros,
                                     bool& changeable) {
  if (!isRetained(result, retainedMacros, provisionalMacros, HX_MacroOf("$R")))
    changeable = true;
  return kMacroLength;
}
