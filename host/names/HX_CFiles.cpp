#include "host/names/HX_CFiles.h"

#include "Naming/HxCCIdentifier.h"
#include "Naming/HxCNames.h"

namespace {

// A file name as the naming engine gives it.
std::string fileName(const char* nameTemplate) {
  HxCCIdentifier id(nameTemplate);
  HxCNames().handleFileNameMacro(id, true);
  id.makeCIdentifier();
  // File systems take 255 bytes with the ending.
  KyCXString name = id.getCookedName(HxCCIdentifier::eActualName);
  name.shortenString(120, 2, '_', KyCXString::ePositionMiddle);
  return name.cstring();
}

}  // namespace

HX_CFiles HX_CFiles::ofModel() {
  return {fileName("$M_types"), fileName("$M")};
}

std::string HX_CFiles::guardOf(const std::string& file) {
  std::string guard = file + "_h";
  for (char& c : guard) {
    if (c >= 'a' && c <= 'z') c = static_cast<char>(c - 'a' + 'A');
    if (c == '-') c = '_';
  }
  return guard.starts_with('_') ? "HX" + guard : guard;
}

std::vector<std::string> HX_CFiles::macros() const {
  return {guardOf(types), guardOf(code), kSection, kAligned};
}
