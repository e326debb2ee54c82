#include "SystemServices/ResourceInfo/HxCResourceInfo.h"

#include <set>

#include "Trace/HxCTraceFallThrough.h"
#include "platform/os/HX_VersionResource.h"
#include "support/HX_TestFixture.h"

namespace {

using testing::ElementsAre;

bool retrieves(HxCResourceInfo& info, const std::string& block) {
  HX_LoadModule("HX_CodeGen", "/opt/hx_codegen", block);
  return info.retrieveResourceInfo();
}

std::string shown(const HxCResourceInfo& info) {
  std::string text;
  for (const int number :
       {info.getProdMajor(), info.getProdMinor(), info.getProdSub(),
        info.getProdMaintenance(), info.getFileMajor(), info.getFileMinor(),
        info.getFileSub(), info.getFileMaintenance()})
    text += std::to_string(number) + ".";
  for (const KyCXString* part :
       {info.getModuleName(), info.getProductVersion(), info.getFileVersion(),
        info.getLegalCopyright(), info.getCompanyName(), info.getProductName()})
    text += std::string("|") + (part == nullptr ? "null" : part->cstring());
  return text;
}

HX_VersionResource resource(const HX_VersionResource::Version& product) {
  HX_VersionResource r;
  r.setVersions(product, {0xFFFF, 0, 7, 8});
  r.addTranslation(0x0407, 0x04E4);
  r.addTranslation(0x0409, 0x04B0);
  r.setText(0x0407, 0x04E4, "legalCOPYRIGHT", "\xA9 100%s");
  r.setText(0x0407, 0x04E4, "CompanyName", "");
  for (const char* name : {"CompanyName", "LegalCopyright", "ProductName"})
    r.setText(0x0409, 0x04B0, name, "another language");
  return r;
}

class ResourceInfoTest : public HX_TestFixture {
 protected:
  ResourceInfoTest() { HxCTraceFallThrough::setVerbose(true); }
  ~ResourceInfoTest() override {
    HxCTraceFallThrough::setVerbose(false);
    HX_UnloadModule("hx_codegen");
  }
};

TEST_F(ResourceInfoTest, ReadsTheResourceOnceOrOnlyTheName) {
  HX_VersionResource german = resource({2, 3, 0, 0}), bare, noRoot, tooLarge;
  german.setText(0x0407, 0x04E4, "ProductName", "de");
  bare.setVersions({2, 2, 1, 0}, {0, 0, 0, 0});
  noRoot.addTranslation(0x0409, 0x04B0);
  tooLarge.setText(1, 1, "x", std::string(0x10000, 'x'));
  const std::string none =
      "-1.-1.-1.-1.-1.-1.-1.-1.|/opt/hx_codegen|null|null"
      "|null|null|null";
  const std::string file = "65535.0.7.8.|/opt/hx_codegen|";
  const std::tuple<const char*, std::string, std::string> rows[] = {
      {"all texts", german.block(),
       "2.3.0.0." + file + "2.3|65535.0.7.8|\xA9 100%s||de"},
      {"a text is missing", resource({2, 2, 1, 3}).block(),
       "2.2.1.3." + file + "2.2.1.3|65535.0.7.8|\xA9 100%s||"},
      {"a zero inside", resource({2, 2, 0, 4}).block(),
       "2.2.0.4." + file + "2.2.0.4|65535.0.7.8|\xA9 100%s||"},
      {"no translation", bare.block(),
       "2.2.1.0.0.0.0.0.|/opt/hx_codegen|2.2.1|0.0.0.0|||"},
      {"no version information", "", none},
      {"too large to be written", tooLarge.block(), none},
      {"cut off", german.block().substr(0, 200), none},
      {"no fixed information", noRoot.block(), none}};
  std::set<std::string> places;
  HX_CountingController controller;
  for (const auto& [why, block, expected] : rows) {
    SCOPED_TRACE(why);
    HxCResourceInfo info;
    EXPECT_EQ(info.getModuleName(), nullptr);
    EXPECT_EQ(retrieves(info, block), expected != none);
    for (const std::string& message : messages()) {
      EXPECT_THAT(
          message,
          HX_Fits(
              "1274/6 trace fall through - early abortion. .Internal: Module: "
              "'SystemServices/ResourceInfo/HxCResourceInfo', Line: .*"));
      places.insert(message);
    }
    clearMessages();
    HX_UnloadModule("hx_codegen");
    EXPECT_TRUE(info.retrieveResourceInfo()) << "not repeated";
    EXPECT_EQ(shown(HxCResourceInfo(info)), expected);
    EXPECT_EQ(controller.liveBlocks(), expected == none ? 1 : 6);
  }
  EXPECT_EQ(places.size(), 3U) << "the first two fail at one place";
}

TEST_F(ResourceInfoTest, MissingMemoryLeavesNumbersAndTextsUnset) {
  HX_WithoutEachBlock("read", [] {
    HxCResourceInfo info;
    const bool isRead = retrieves(info, resource({2, 3, 0, 0}).block());
    EXPECT_EQ(info.getProdMajor(), isRead ? 2 : -1);
    EXPECT_EQ(info.getProductVersion() != nullptr, isRead);
    return isRead;
  });
}

TEST_F(ResourceInfoTest, WithoutTheModuleTheExecutableIsAsked) {
  HxCResourceInfo info, longPath;
  EXPECT_FALSE(info.retrieveResourceInfo());
  EXPECT_THAT(info.getModuleName()->cstring(),
              HX_Fits(".*[/\\\\]test_SystemServices([.]exe)?"));
  HX_LoadModule("hx_codegen", std::string(300, 'p'), "");
  longPath.retrieveResourceInfo();
  EXPECT_EQ(*longPath.getModuleName(), std::string(259, 'p').c_str());
}

// Every block that differs from a real block in one byte; the sanitizers watch.
TEST_F(ResourceInfoTest, DamagedBlocksAreReadWithoutHarm) {
  std::string damaged = resource({2, 3, 0, 0}).block();
  for (char& byte : damaged) {
    const char whole = byte;
    for (const char value : {'\0', '\1', '\x7F', '\xFF', whole}) {
      byte = value;
      HxCResourceInfo info;
      retrieves(info, damaged);
      EXPECT_EQ(*info.getModuleName(), "/opt/hx_codegen");
    }
  }
}

}  // namespace
