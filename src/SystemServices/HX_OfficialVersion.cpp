#include "SystemServices/HX_OfficialVersion.h"

#include <memory>
#include <utility>

#include "Control/HX_Memory.h"
#include "platform/matlab/HX_MexInterface.h"

namespace {

constexpr double kVersionRequest = 6.0;  // asks "hx_config" for the version

struct DestroyArray {
  void operator()(mxArray* array) const { MXDestroyArray(array); }
};
using OwnedAnswer = std::unique_ptr<mxArray, DestroyArray>;

// Returns the answer of "hx_config", null if the call failed.
OwnedAnswer callConfig() {
  OwnedAnswer input(MXCreateInitializedScalarMxArray(kVersionRequest));
  if (input == nullptr) return input;
  mxArray* inputs[] = {input.get()};
  mxArray* outputs[] = {nullptr};
  const int status = MEXCallMATLAB(1, outputs, 1, inputs, "hx_config");
  OwnedAnswer answer(outputs[0]);
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

HX_OfficialVersion::HX_OfficialVersion(const HX_OfficialVersion& other)
    : HX_Allocated(other) {
  *this = other;
}

HX_OfficialVersion& HX_OfficialVersion::operator=(
    const HX_OfficialVersion& other) {
  HX_WithinMemory([&] {
    KyCXString version = other.m_Version;
    KyCXString releaseDate = other.m_ReleaseDate;
    m_Version = std::move(version);
    m_ReleaseDate = std::move(releaseDate);
    m_IsValid = other.m_IsValid;
  });
  return *this;
}

HX_OfficialVersion::~HX_OfficialVersion() = default;

bool HX_OfficialVersion::evalBrennicVersionAndReleaseDate() {
  m_IsValid = false;
  HX_WithinMemory([&] {
    const OwnedAnswer answer = callConfig();
    if (answer == nullptr) return;
    KyCXString version = m_Version;
    KyCXString releaseDate = m_ReleaseDate;
    const bool isComplete =
        readField(answer.get(), "Version", "- version -", version) &&
        readField(answer.get(), "ReleaseDate", "- release date -", releaseDate);
    m_Version = std::move(version);
    m_ReleaseDate = std::move(releaseDate);
    m_IsValid = isComplete;
  });
  return m_IsValid;
}
