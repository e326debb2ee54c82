#include "SystemServices/HX_OfficialVersion.h"

#include <memory>

#include "platform/matlab/HX_MexInterface.h"

namespace {

constexpr double kVersionRequest = 6.0;  // what "hx_config" is to tell

struct DestroyArray {
  void operator()(mxArray* array) const { MXDestroyArray(array); }
};
using OwnedArray = std::unique_ptr<mxArray, DestroyArray>;

// The answer of "hx_config", null if the call failed.
OwnedArray callConfig() {
  OwnedArray input(MXCreateInitializedScalarMxArray(kVersionRequest));
  mxArray* inputs[] = {input.get()};
  mxArray* outputs[] = {nullptr};
  const int status = MEXCallMATLAB(1, outputs, 1, inputs, "hx_config");
  OwnedArray answer(outputs[0]);
  if (status != 0) answer.reset();
  return answer;
}

// \param[out] text  the text of the field, else \p placeholder
bool readField(mxArray* structure, const char* name, const char* placeholder,
               KyCXString& text) {
  const mxArray* field = MXGetField(structure, 0, name);
  text = field == nullptr ? placeholder : "";
  if (field == nullptr) return false;
  MXCopyMXArrayToString(field, text);
  return true;
}

}  // namespace

HX_OfficialVersion::~HX_OfficialVersion() = default;

bool HX_OfficialVersion::evalBrennicVersionAndReleaseDate() {
  const OwnedArray answer = callConfig();
  m_IsValid =
      answer != nullptr &&
      readField(answer.get(), "Version", "- version -", m_Version) &&
      readField(answer.get(), "ReleaseDate", "- release date -", m_ReleaseDate);
  return m_IsValid;
}
