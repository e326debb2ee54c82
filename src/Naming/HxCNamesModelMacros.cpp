// Evaluators of the macros that name model objects.

#include "FLAG.h"
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
  result += name.makeCIdentifier(false);
}

}  // namespace

// The rule of all evaluators: a provisional macro makes the name incomplete; a
// retained one does as well, and leaves its own text in place of its value.
bool HxCNames::isRetained(KyCXString& result, unsigned int retainedMacros,
                          unsigned int provisionalMacros, unsigned int bit,
                          const char* macro) {
  if (FLAG_GetFlag(&provisionalMacros, bit)) m_NameComplete = false;
  if (!FLAG_GetFlag(&retainedMacros, bit)) return false;
  result += macro;
  m_NameComplete = false;
  return true;
}

int HxCNames::evaluateLabelMacro(KyCXString& result,
                                 unsigned int retainedMacros,
                                 unsigned int provisionalMacros,
                                 const KyCXString& label,
                                 const HX_Block* block) {
  if (isRetained(result, retainedMacros, provisionalMacros, eMacroLabel, "$L"))
    return kMacroLength;
  // A propagated label stands in angle brackets.
  KyCXString text(label);
  text.trim(true, true).filterAngleBrackets().trim(true, true);
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
  if (isRetained(result, retainedMacros, provisionalMacros, eMacroBlockName,
                 "$B"))
    return kMacroLength;
  if (block != nullptr)
    appendAsCIdentifier(result, block->getName());
  else if (ivBlock != nullptr)
    appendAsCIdentifier(result, ivBlock->getRawName());
  else
    result += "_B";
  return kMacroLength;
}

int HxCNames::evaluateSystemNumberMacro(KyCXString& result,
                                        unsigned int retainedMacros,
                                        unsigned int provisionalMacros,
                                        HX_Block* block,
                                        const KyCXString& systemId,
                                        bool& changeable) {
  if (isRetained(result, retainedMacros, provisionalMacros, eMacroSystemNumber,
                 "$S"))
    return kMacroLength;
  changeable = true;
  if (block == nullptr && systemId.isEmpty()) {
    result += "_S";
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
  if (!isRetained(result, retainedMacros, provisionalMacros, eMacroSystemId,
                  "$I"))
    result += systemId;
  return kMacroLength;
}

int HxCNames::evaluateModelNameMacro(KyCXString& result,
                                     unsigned int retainedMacros,
                                     unsigned int provisionalMacros) {
  if (!isRetained(result, retainedMacros, provisionalMacros, eMacroModelName,
                  "$M"))
    result += GLB_GetModelName();
  return kMacroLength;
}

int HxCNames::evaluateSubsystemNameMacro(KyCXString& result,
                                         unsigned int retainedMacros,
                                         unsigned int provisionalMacros) {
  if (!isRetained(result, retainedMacros, provisionalMacros,
                  eMacroSubsystemName, "$N"))
    result += GLB_GetSubsystemName();
  return kMacroLength;
}

int HxCNames::evaluateStateHierarchyMacro(KyCXString& result,
                                          unsigned int retainedMacros,
                                          unsigned int provisionalMacros,
                                          const SC_Model* object) {
  if (isRetained(result, retainedMacros, provisionalMacros,
                 eMacroStateHierarchy, "$H"))
    return kMacroLength;
  if (object == nullptr)
    result += "_H";
  else
    result += object->getHierarchy();
  return kMacroLength;
}

int HxCNames::evaluateSFObjectNameMacro(KyCXString& result,
                                        unsigned int retainedMacros,
                                        unsigned int provisionalMacros,
                                        const SC_Model* object) {
  if (isRetained(result, retainedMacros, provisionalMacros, eMacroSFObjectName,
                 "$O"))
    return kMacroLength;
  if (object == nullptr)
    result += "_O";
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
  if (isRetained(result, retainedMacros, provisionalMacros, eMacroSFObjectId,
                 "$C"))
    return kMacroLength;
  if (object == nullptr) {
    result += "_C";
    return kMacroLength;
  }
  changeable = true;
  result += 'C';
  result += systemId;
  result += number(object->getObjectNumber());
  return kMacroLength;
}

// A provisional $D has its placeholder written in front of whatever follows.
int HxCNames::evaluateDdObjectNameMacro(KyCXString& result,
                                        unsigned int retainedMacros,
                                        unsigned int provisionalMacros,
                                        const KyCXString& ddName) {
  if (FLAG_GetFlag(&provisionalMacros, eMacroDdObjectName)) result += "_D";
  if (isRetained(result, retainedMacros, provisionalMacros, eMacroDdObjectName,
                 "$D"))
    return kMacroLength;
  if (ddName.isEmpty())
    result += "_D";
  else
    result += ddName;
  return kMacroLength;
}

int HxCNames::evaluateXNameMacro(KyCXString& result,
                                 unsigned int retainedMacros,
                                 unsigned int provisionalMacros,
                                 const KyCXString& xValue) {
  if (isRetained(result, retainedMacros, provisionalMacros, eMacroXName, "$X"))
    return kMacroLength;
  if (xValue.isEmpty())
    result += "_X";
  else
    result += xValue;
  return kMacroLength;
}

int HxCNames::evaluateSFObjectRMacro(KyCXString& result,
                                     unsigned int retainedMacros,
                                     unsigned int provisionalMacros,
                                     bool& changeable) {
  if (!isRetained(result, retainedMacros, provisionalMacros, eMacroChangeable,
                  "$R"))
    changeable = true;
  return kMacroLength;
}
