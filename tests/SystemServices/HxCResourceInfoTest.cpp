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
};

TEST_F(ResourceInfoTest, ReadsNumbersAndTextsOfTheFirstTranslationOnce) {
  HxCResourceInfo info;
  EXPECT_EQ(info.getModuleName(), nullptr);
  EXPECT_TRUE(retrieves(info, resource().block()));
  const int numbers[] = {info.getProdMajor(), info.getProdMinor(),
                         info.getProdSub(),   info.getProdMaintenance(),
                         info.getFileMajor(), info.getFileMinor(),
                         info.getFileSub(),   info.getFileMaintenance()};
  EXPECT_THAT(numbers, ElementsAre(2, 3, 0, 0, 0xFFFF, 0, 7, 8));
  EXPECT_EQ(*info.getFileVersion(), "65535.0.7.8");
  EXPECT_EQ(*info.getModuleName(), kPath);
  EXPECT_EQ(*info.getLegalCopyright(), "de LegalCopyright");
  EXPECT_EQ(*info.getCompanyName(), "de CompanyName");
  EXPECT_EQ(*info.getProductName(), "de ProductName");

  HX_UnloadModule("hx_codegen");
  const HxCResourceInfo copy(info);
  EXPECT_TRUE(info.retrieveResourceInfo());
  EXPECT_EQ(copy.getProductName(), info.getProductName());
  EXPECT_THAT(messages(), IsEmpty());
}

TEST_F(ResourceInfoTest, TrailingZerosAndMissingTextsAreLeftOut) {
  const std::pair<HX_VersionResource::Version, const char*> rows[] = {
      {{2, 2, 1, 0}, "2.2.1"},
      {{2, 2, 1, 3}, "2.2.1.3"},
      {{2, 2, 0, 4}, "2.2.0.4"},
      {{0, 0, 0, 0}, "0.0"}};
  HX_VersionResource r;
  for (const auto& [version, text] : rows) {
    r.setVersions(version, version);
    HxCResourceInfo info;
    EXPECT_TRUE(retrieves(info, r.block()));
    EXPECT_EQ(*info.getProductVersion(), text);
    EXPECT_EQ(*info.getCompanyName(), "") << "no translation at all";
  }
  r.addTranslation(0x0C0A, 0x04B0);
  r.setText(0x0C0A, 0x04B0, "legalCOPYRIGHT", "");
  r.setText(0x0C0A, 0x04B0, "ProductName", "\xA9 100%s");
  r.setText(0x0409, 0x04B0, "CompanyName", "another language");
  HxCResourceInfo info;
  EXPECT_TRUE(retrieves(info, r.block()));
  EXPECT_EQ(*info.getLegalCopyright() + *info.getCompanyName(), "");
  EXPECT_EQ(*info.getProductName(), "\xA9 100%s");
}

TEST_F(ResourceInfoTest, FailuresAreTracedWithTheirPlaceAndLeakNothing) {
  const std::string whole = resource().block();
  HX_VersionResource noRoot, tooLarge = resource();
  noRoot.addTranslation(0x0409, 0x04B0);
  tooLarge.setText(1, 1, "x", std::string(0x10000, 'x'));
  HX_CountingController controller;
  // First: no version information; then too large to be written; cut off; no
  // fixed information.
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
            "'SystemServices/ResourceInfo/HxCResourceInfo.cpp', Line: .*")));
    places.insert(messages()[0]);
    EXPECT_TRUE(info.retrieveResourceInfo()) << "not repeated";
    EXPECT_EQ(*info.getModuleName(), kPath);
    EXPECT_EQ(info.getProdMajor() + info.getFileMaintenance(), -2);
    EXPECT_EQ(info.getProductVersion(), nullptr);
    EXPECT_EQ(controller.liveBlocks(), 0);
  }
  EXPECT_EQ(places.size(), 3U) << "the first two fail at one place";
  HX_WithoutEachBlock("read", [] {
    HxCResourceInfo info;
    return retrieves(info, resource().block());
  });
}

TEST_F(ResourceInfoTest, WithoutTheModuleTheExecutableIsAsked) {
  HxCResourceInfo info;
  EXPECT_FALSE(info.retrieveResourceInfo());
  EXPECT_THAT(info.getModuleName()->cstring(),
              MatchesRegex("/.*/test_SystemServices"));
  HX_LoadModule("hx_codegen", std::string(300, 'p'), "");
  HxCResourceInfo longPath;
  longPath.retrieveResourceInfo();
  EXPECT_EQ(longPath.getModuleName()->length(), 259);
}

// Every block that differs from a real one in a single byte is read without
// leaving it; the sanitizers watch.
TEST_F(ResourceInfoTest, DamagedBlocksAreReadWithoutHarm) {
  const std::string whole = resource().block();
  for (std::size_t at = 0; at < whole.size(); ++at) {
    for (const char value : {'\0', '\1', '\x7F', '\xFF'}) {
      std::string damaged = whole;
      damaged[at] = value;
      HxCResourceInfo info;
      retrieves(info, damaged);
      EXPECT_EQ(*info.getModuleName(), kPath);
    }
  }
}

}  // namespace
