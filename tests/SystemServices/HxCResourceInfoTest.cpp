#include "SystemServices/ResourceInfo/HxCResourceInfo.h"

#include <set>

#include "Trace/HxCTraceFallThrough.h"
#include "platform/os/HX_VersionResource.h"
#include "support/HX_TestFixture.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using testing::MatchesRegex;

constexpr char kPath[] = "/opt/hx/hx_codegen";

class ResourceInfoTest : public HX_TestFixture {
 protected:
  ResourceInfoTest() { HxCTraceFallThrough::setVerbose(true); }
  ~ResourceInfoTest() override {
    HxCTraceFallThrough::setVerbose(false);
    HX_UnloadModule("hx_codegen");
  }

  static HX_VersionResource resource() {
    HX_VersionResource r;
    r.setVersions({2, 3, 0, 0}, {0xFFFF, 0, 7, 8});
    r.addTranslation(0x0407, 0x04E4);
    r.addTranslation(0x0409, 0x04B0);
    for (const char* name : {"CompanyName", "LegalCopyright", "ProductName"}) {
      r.setText(0x0407, 0x04E4, name, std::string("de ") + name);
      r.setText(0x0409, 0x04B0, name, std::string("en ") + name);
    }
    return r;
  }
  static bool retrieves(HxCResourceInfo& info, const std::string& block) {
    HX_LoadModule("hx_codegen", kPath, block);
    return info.retrieveResourceInfo();
  }
  static std::string shown(const HxCResourceInfo& info) {
    std::string text;
    for (const int number :
         {info.getProdMajor(), info.getProdMinor(), info.getProdSub(),
          info.getProdMaintenance(), info.getFileMajor(), info.getFileMinor(),
          info.getFileSub(), info.getFileMaintenance()})
      text += std::to_string(number) + ".";
    for (const KyCXString* part :
         {info.getProductVersion(), info.getFileVersion(), info.getModuleName(),
          info.getLegalCopyright(), info.getCompanyName(),
          info.getProductName()})
      text += std::string("|") + (part == nullptr ? "null" : part->cstring());
    return text;
  }
};

TEST_F(ResourceInfoTest, ReadsNumbersAndTextsOfTheFirstTranslationOnce) {
  const char expected[] =
      "2.3.0.0.65535.0.7.8.|2.3|65535.0.7.8|/opt/hx/hx_codegen|"
      "de LegalCopyright|de CompanyName|de ProductName";
  HxCResourceInfo info;
  EXPECT_EQ(shown(info),
            "-1.-1.-1.-1.-1.-1.-1.-1.|null|null|null|null|null|null");
  EXPECT_TRUE(retrieves(info, resource().block()));
  EXPECT_EQ(shown(info), expected);
  HX_UnloadModule("hx_codegen");
  const HxCResourceInfo copy(info);
  EXPECT_TRUE(info.retrieveResourceInfo());
  EXPECT_EQ(copy.getProductName(), info.getProductName());
  EXPECT_THAT(messages(), IsEmpty());
}

TEST_F(ResourceInfoTest, TrailingZerosAndMissingTextsAreLeftOut) {
  HX_VersionResource r;
  const auto read = [&] {
    HxCResourceInfo info;
    EXPECT_TRUE(retrieves(info, r.block()));
    const std::string text = shown(info);
    return text.substr(text.find('|'));
  };
  const std::string path = std::string("|") + kPath;
  r.setVersions({2, 2, 1, 0}, {0, 0, 0, 0});
  EXPECT_EQ(read(), "|2.2.1|0.0.0.0" + path + "|||") << "no translation";
  r.addTranslation(0x0C0A, 0x04B0);
  r.setText(0x0C0A, 0x04B0, "legalCOPYRIGHT", "");
  r.setText(0x0C0A, 0x04B0, "ProductName", "\xA9 100%s");
  r.setText(0x0409, 0x04B0, "CompanyName", "another language");
  r.setVersions({2, 2, 1, 3}, {6, 1, 0, 0});
  EXPECT_EQ(read(), "|2.2.1.3|6.1.0.0" + path + "|||\xA9 100%s");
  r.setVersions({2, 2, 0, 4}, {0, 0, 0, 1});
  EXPECT_EQ(read(), "|2.2.0.4|0.0.0.1" + path + "|||\xA9 100%s");
}

TEST_F(ResourceInfoTest, FailuresAreTracedWithTheirPlaceAndLeakNothing) {
  const std::string whole = resource().block();
  HX_VersionResource noRoot, tooLarge = resource();
  noRoot.addTranslation(0x0409, 0x04B0);
  tooLarge.setText(1, 1, "x", std::string(0x10000, 'x'));
  HX_CountingController controller;
  // No version information; too large; cut off; no fixed information.
  const std::string blocks[] = {
      "", tooLarge.block(), whole.substr(0, whole.size() - 1), noRoot.block()};
  std::set<std::string> places;
  for (const std::string& block : blocks) {
    SCOPED_TRACE(&block - blocks);
    clearMessages();
    HxCResourceInfo info;
    EXPECT_FALSE(retrieves(info, block));
    ASSERT_THAT(
        messages(),
        ElementsAre(MatchesRegex(
            "1274/6 trace fall through - early abortion. .Internal: Module: "
            "'SystemServices/ResourceInfo/HxCResourceInfo', Line: .*")));
    places.insert(messages()[0]);
    EXPECT_TRUE(info.retrieveResourceInfo()) << "not repeated";
    EXPECT_EQ(shown(info),
              "-1.-1.-1.-1.-1.-1.-1.-1.|null|null|/opt/hx/hx_codegen|null|null|"
              "null");
    EXPECT_EQ(controller.liveBlocks(), 1) << "the module name";
  }
  EXPECT_EQ(places.size(), 3U) << "the first two fail at one place";
  // Six texts and the block of the resource; all texts or the module name.
  HX_WithoutEachBlock("read", [] {
    HxCResourceInfo info;
    const bool isRead = retrieves(info, resource().block());
    EXPECT_EQ(info.getProdMajor(), isRead ? 2 : -1);
    EXPECT_EQ(info.getProductVersion() != nullptr, isRead);
    return isRead;
  });
}

TEST_F(ResourceInfoTest, ModulesAreNamedWithoutCaseOrTheExecutableIsAsked) {
  HxCResourceInfo executable, upperCase;
  EXPECT_FALSE(executable.retrieveResourceInfo());
  EXPECT_THAT(executable.getModuleName()->cstring(),
              MatchesRegex("/.*/test_SystemServices"));
  HX_LoadModule("HX_CodeGen", std::string(300, 'p'), "");
  upperCase.retrieveResourceInfo();
  EXPECT_EQ(*upperCase.getModuleName(), std::string(259, 'p').c_str());
  HX_UnloadModule("hx_codegen");
  HxCResourceInfo unloaded;
  unloaded.retrieveResourceInfo();
  EXPECT_EQ(*unloaded.getModuleName(), *executable.getModuleName());
}

// Every block that differs from a real block in one byte; the sanitizers watch.
TEST_F(ResourceInfoTest, DamagedBlocksAreReadWithoutHarm) {
  std::string damaged = resource().block();
  for (char& byte : damaged) {
    const char whole = byte;
    for (const char value : {'\0', '\1', '\x7F', '\xFF'}) {
      byte = value;
      HxCResourceInfo info;
      retrieves(info, damaged);
      EXPECT_EQ(*info.getModuleName(), kPath);
    }
    byte = whole;
  }
}

}  // namespace
