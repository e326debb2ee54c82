// Reads the version resource of a loaded module through the calls of Windows.
// The header of the system and ours agree in one source.
#include <windows.h>

#include <filesystem>

#include "SystemServices/ResourceInfo/HxCResourceInfo.h"
#include "support/HX_TestFixture.h"

namespace {

TEST(RealModuleTest, ItsResourceTellsVersionsAndTexts) {
  const std::string path =
      std::filesystem::path(HX_REAL_MODULE).make_preferred().string();
  HMODULE module = LoadLibraryA(path.c_str());
  ASSERT_NE(module, nullptr) << path;
  HxCResourceInfo info;
  ASSERT_TRUE(info.retrieveResourceInfo());
  const std::string version = std::to_string(info.getProdMajor()) + "." +
                              std::to_string(info.getProdMinor()) + "." +
                              std::to_string(info.getProdSub());
  EXPECT_EQ(version, HX_PROJECT_VERSION);
  EXPECT_EQ(*info.getFileVersion(), HX_PROJECT_VERSION ".0");
  EXPECT_EQ(*info.getProductName(), "hx_utils");
  EXPECT_EQ(*info.getCompanyName(), "The hx_utils maintainers");
  EXPECT_TRUE(info.getModuleName()->contains("hx_codegen.dll"));
  FreeLibrary(module);
}

}  // namespace
