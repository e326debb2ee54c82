// What every back end of platform/os promises, on the system of the test.

#include <filesystem>
#include <fstream>
#include <iterator>
#include <thread>

#include "platform/os/HX_OsClock.h"
#include "platform/os/HX_OsFile.h"
#include "platform/os/HX_OsThread.h"
#include "platform/os/HX_OsVersion.h"
#include "platform/os/HX_VersionResource.h"
#include "support/HX_Environment.h"
#include "support/HX_RealTime.h"
#include "support/HX_TestFixture.h"

namespace {

using testing::ElementsAre;

class OsContractTest : public HX_TestFixture {};

TEST_F(OsContractTest, ClocksKeepRealTimeAndTellTheirFrequency) {
  HX_ExpectRealTime(
      [] { return static_cast<double>(HX_ProcessClock()) / 1000.0; });
  std::int64_t frequency = 0;
  ASSERT_EQ(QueryPerformanceFrequency(&frequency), 1);
  // An interval of six days in ticks times 1000000 must fit into 64 bits.
  EXPECT_GE(frequency, 1000);
  EXPECT_LE(frequency, 17'000'000);
  HX_ExpectRealTime([&] {
    std::int64_t ticks = 0;
    QueryPerformanceCounter(&ticks);
    return static_cast<double>(ticks) / static_cast<double>(frequency);
  });
}

TEST_F(OsContractTest, LevelsOfPriorityReadBackAndOthersAreRefused) {
  if (GetThreadPriority(GetCurrentThread()) != THREAD_PRIORITY_NORMAL)
    GTEST_SKIP() << "the process has a priority of its own";
  std::thread([] {
    HX_ThreadHandle thread = GetCurrentThread();
    ASSERT_NE(thread, nullptr);
    EXPECT_EQ(GetThreadPriority(thread), THREAD_PRIORITY_NORMAL);
    for (const int level : {7, -3, 100})
      EXPECT_EQ(SetThreadPriority(thread, level), 0) << level;
    for (const int level : {-1, THREAD_PRIORITY_LOWEST, -15}) {
      EXPECT_EQ(SetThreadPriority(thread, level), 1) << level;
      EXPECT_EQ(GetThreadPriority(thread), level);
    }
  }).join();
  EXPECT_EQ(GetThreadPriority(GetCurrentThread()), THREAD_PRIORITY_NORMAL);
}

TEST_F(OsContractTest, FilesAreReplacedOrAppendedTo) {
  const std::filesystem::path folder = HX_MakeTemporaryFolder();
  const std::string name = (folder / "log.txt").string();
  const auto lines = [&] {
    std::ifstream file(name);  // in text mode, as the file was written
    return std::string(std::istreambuf_iterator<char>(file), {});
  };
  EXPECT_TRUE(HX_AppendToFile(name.c_str(), "a\n", 2));
  EXPECT_TRUE(HX_AppendToFile(name.c_str(), "b\n", 2));
  EXPECT_EQ(lines(), "a\nb\n");
  EXPECT_TRUE(HX_RewriteFile(name.c_str(), "c\nd", 3));
  EXPECT_EQ(lines(), "c\nd");
  EXPECT_TRUE(HX_RewriteFile(name.c_str(), "", 0));
  EXPECT_EQ(lines(), "");
  const std::string none = (folder / "none" / "log.txt").string();
  EXPECT_FALSE(HX_AppendToFile(none.c_str(), "a", 1));
  EXPECT_FALSE(HX_RewriteFile(none.c_str(), "a", 1));
  std::filesystem::remove_all(folder);
}

TEST_F(OsContractTest, ModulesOfTheHostHaveNamePathAndVersion) {
  HX_VersionResource resource;
  resource.setVersions({6, 1, 0, 0}, {6, 1, 0, 17});
  resource.addTranslation(0x0409, 0x04B0);
  resource.setText(0x0409, 0x04B0, "ProductName", "Generator");
  HX_LoadModule("Host_Module", "/opt/host_module", resource.block());
  HX_ModuleHandle module = GetModuleHandleA("host_MODULE");
  ASSERT_NE(module, nullptr);
  char path[8] = "";
  EXPECT_EQ(GetModuleFileNameA(module, path, sizeof path), 7U);
  EXPECT_STREQ(path, "/opt/ho");
  const std::uint32_t size =
      GetFileVersionInfoSizeA("/opt/host_module", nullptr);
  std::vector<std::uint32_t> block(size / 4 + 1);
  EXPECT_EQ(GetFileVersionInfoA("/opt/host_module", 0, 1, block.data()), 0);
  ASSERT_EQ(GetFileVersionInfoA("/opt/host_module", 0, size, block.data()), 1);
  void* value = nullptr;
  unsigned int length = 0;
  ASSERT_EQ(VerQueryValueA(block.data(), "\\", &value, &length), 1);
  EXPECT_EQ(static_cast<VS_FIXEDFILEINFO*>(value)->dwFileVersionLS, 17U);
  ASSERT_EQ(
      VerQueryValueA(block.data(), "\\StringFileInfo\\040904B0\\ProductName",
                     &value, &length),
      1);
  EXPECT_STREQ(static_cast<const char*>(value), "Generator");
  HX_UnloadModule("HOST_MODULE");
  EXPECT_EQ(GetModuleHandleA("host_module"), nullptr);
  EXPECT_EQ(GetFileVersionInfoSizeA("/opt/host_module", nullptr), 0U);
}

TEST_F(OsContractTest, TheExecutableHasAPathAndUnknownFilesNoVersion) {
  char path[260] = "";
  const std::uint32_t length = GetModuleFileNameA(nullptr, path, sizeof path);
  ASSERT_GT(length, 0U);
  EXPECT_EQ(path[length], '\0');
  const std::string stem = std::filesystem::path(path).stem().string();
  EXPECT_TRUE(stem == "test_platform" || stem.starts_with("qemu")) << path;
  EXPECT_EQ(GetModuleHandleA("no_such_module"), nullptr);
  std::uint32_t handle = 1;
  EXPECT_EQ(GetFileVersionInfoSizeA("/no/such/file", &handle), 0U);
  EXPECT_EQ(handle, 0U);
}

#if defined(_WIN32)
// The resource of the library, as the build wrote it.
TEST_F(OsContractTest, ARealModuleTellsTheVersionInItsResource) {
  HX_ModuleHandle module = GetModuleHandleA("hx_utils.dll");
  ASSERT_NE(module, nullptr);
  char path[260] = "";
  ASSERT_GT(GetModuleFileNameA(module, path, sizeof path), 0U);
  const std::uint32_t size = GetFileVersionInfoSizeA(path, nullptr);
  ASSERT_GT(size, 0U);
  std::vector<std::uint32_t> block(size / 4 + 1);
  ASSERT_EQ(GetFileVersionInfoA(path, 0, size, block.data()), 1);
  void* value = nullptr;
  unsigned int length = 0;
  ASSERT_EQ(VerQueryValueA(block.data(), "\\", &value, &length), 1);
  const auto* info = static_cast<const VS_FIXEDFILEINFO*>(value);
  const std::string version =
      std::to_string(info->dwProductVersionMS >> 16) + "." +
      std::to_string(info->dwProductVersionMS & 0xFFFF) + "." +
      std::to_string(info->dwProductVersionLS >> 16);
  EXPECT_EQ(version, HX_PROJECT_VERSION);
}
#endif

}  // namespace
