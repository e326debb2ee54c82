#include "host/HX_HostProgram.h"

#include <gtest/gtest.h>
#include <sys/wait.h>

#include <cstdlib>
#include <fstream>
#include <iterator>

namespace fs = std::filesystem;

std::string HX_ReadText(const fs::path& path) {
  std::ifstream file(path, std::ios::binary);
  EXPECT_TRUE(file.is_open()) << path;
  return {std::istreambuf_iterator<char>(file), {}};
}

void HX_WriteText(const fs::path& path, const std::string& text) {
  std::ofstream file(path, std::ios::binary);
  file << text;
  EXPECT_TRUE(file.flush()) << path;
}

HX_ProgramResult HX_RunCommand(const std::string& command) {
  const fs::path folder = HX_ScratchFolder();
  const fs::path out = folder / "stdout.txt";
  const fs::path err = folder / "stderr.txt";
  const int status = std::system(
      (command + " >" + out.string() + " 2>" + err.string()).c_str());
  return {WIFEXITED(status) ? WEXITSTATUS(status) : -1, HX_ReadText(out),
          HX_ReadText(err)};
}

HX_ProgramResult HX_RunCodegen(const std::string& arguments) {
  return HX_RunCommand(HX_CODEGEN_COMMAND " " + arguments);
}

std::string HX_WriteModel(const nlohmann::json& model) {
  const fs::path path = HX_ScratchFolder() / "model.json";
  HX_WriteText(path, model.dump());
  return path.string();
}

nlohmann::json HX_DemoModel() {
  return nlohmann::json::parse(HX_ReadText(HX_DEMO_MODEL));
}

nlohmann::json HX_CaseTable(const std::string& file) {
  return nlohmann::json::parse(HX_ReadText(fs::path(HX_TEST_FOLDER) / file));
}

nlohmann::json HX_SmallModel() {
  return nlohmann::json::parse(R"({
    "model": {"name": "small", "systemId": "a"},
    "blocks": [{"id": "gain", "name": "Gain"}],
    "types": [
      {"id": "i8", "name": "Int8", "kind": "base", "c": "signed char",
       "cut": "i8"},
      {"id": "u32", "name": "UInt32", "kind": "base", "c": "unsigned int",
       "cut": "u32"}],
    "names": []})");
}

fs::path HX_ScratchFolder() {
  static std::string s_owner;
  static fs::path s_folder;
  const auto* test = testing::UnitTest::GetInstance()->current_test_info();
  const std::string owner =
      std::string(test->test_suite_name()) + "." + test->name();
  if (owner != s_owner) {
    s_owner = owner;
    s_folder = fs::path(HX_SCRATCH_FOLDER) / owner;
    fs::remove_all(s_folder);
    fs::create_directories(s_folder);
  }
  return s_folder;
}
