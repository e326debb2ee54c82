#include "host/program/HX_Version.h"

#include <cstdint>

#include "SystemServices/HX_OfficialVersion.h"
#include "SystemServices/ResourceInfo/HxCResourceInfo.h"
#include "platform/matlab/HX_MatlabSession.h"
#include "platform/matlab/HX_MxContent.h"
#include "platform/os/HX_VersionResource.h"
#include "platform/strings/KyCXString.h"

namespace {

// The program answers the question that a generator asks MATLAB.
int describeProduct(int outputs, mxArray** output, int, mxArray**) {
  if (outputs < 1) return 1;
  const char* fields[] = {"Version", "ReleaseDate"};
  output[0] = mxCreateStructMatrix(1, 1, {fields[0], fields[1]});
  mxSetField(output[0], 0, fields[0], mxCreateString(HX_PRODUCT_VERSION));
  mxSetField(output[0], 0, fields[1], mxCreateString(HX_RELEASE_DATE));
  return 0;
}

// What the linker does elsewhere: gives the program its version resource.
void loadVersionResource() {
  constexpr std::uint16_t kEnglish = 0x0409;
  constexpr std::uint16_t kUnicode = 0x04B0;
  HX_VersionResource resource;
  const HX_VersionResource::Version version = {
      HX_VERSION_MAJOR, HX_VERSION_MINOR, HX_VERSION_PATCH, 0};
  resource.setVersions(version, version);
  resource.addTranslation(kEnglish, kUnicode);
  resource.setText(kEnglish, kUnicode, "ProductName", "hx_codegen");
  HX_LoadModule("hx_codegen", "hx_codegen", resource.block());
}

}  // namespace

HX_BuildNumber HX_BuildOfProgram() {
  HX_BuildNumber build;
  build.definedBuildNumber(HX_VERSION_MAJOR, HX_VERSION_MINOR, HX_VERSION_PATCH,
                           0, "release", false, true, 0, HX_PRODUCT_VERSION,
                           HX_RELEASE_DATE, HX_BUILD_DATE, HX_BUILD_TIME);
  return build;
}

std::string HX_VersionText() {
  loadVersionResource();
  HxCResourceInfo resource;
  resource.retrieveResourceInfo();
  HX_RegisterMatlabFunction("hx_config", describeProduct);
  HX_OfficialVersion official;
  official.evalBrennicVersionAndReleaseDate();
  const HX_BuildNumber build = HX_BuildOfProgram();
  return std::string(resource.getProductName()->cstring()) + " " +
         build.getVersionString()->cstring() + "\nfile      " +
         resource.getFileVersion()->cstring() + "\nbuilt     " +
         build.getBuildDateTime()->cstring() + "\nproduct   " +
         official.getHXVersionString().cstring() + ", released " +
         official.getHXReleaseDate().cstring();
}
