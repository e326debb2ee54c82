#include "host/HX_HostTest.h"

#include <sys/wait.h>

#include <cstdlib>
#include <fstream>
#include <iterator>
#include <regex>
#include <sstream>

namespace fs = std::filesystem;

namespace {

fs::path folderOfTest() {
  const auto* test = testing::UnitTest::GetInstance()->current_test_info();
  return fs::path(HX_SCRATCH_FOLDER) /
         (std::string(test->test_suite_name()) + "." + test->name());
}

}  // namespace

HX_HostTest::HX_HostTest() : m_Folder(folderOfTest()) {
  fs::remove_all(m_Folder);
  fs::create_directories(m_Folder);
}

HX_HostTest::Result HX_HostTest::shell(const std::string& command) const {
  const std::string out = m_Folder / "stdout.txt";
  const std::string err = m_Folder / "stderr.txt";
  const int status = std::system((command + " >" + out + " 2>" + err).c_str());
  static const std::regex number(R"( \[[1-9][0-9]{2}\]\n)");
  const std::string whole = read(err);
  return {WIFEXITED(status) ? WEXITSTATUS(status) : -1, read(out),
          std::regex_replace(whole, number, "\n"), whole};
}

HX_HostTest::Result HX_HostTest::codegen(const std::string& arguments) const {
  return shell(HX_CODEGEN_COMMAND " " + arguments);
}

HX_HostTest::Result HX_HostTest::generate(const std::string& model) const {
  return codegen("generate " + model + " --out " + m_Out.string());
}

HX_HostTest::Result HX_HostTest::generateValid(const Json& model) const {
  const Result result = generate(save(model));
  EXPECT_EQ(0, result.code) << result.err;
  for (const std::string compiler : {"cc", "clang"}) {
    if (shell("command -v " + compiler).code != 0) continue;
    const Result compiled =
        shell("cd " + m_Out.string() + " && " + compiler +
              " -std=c90 -pedantic-errors -Wall -Wextra -c -o /dev/null *.c");
    EXPECT_EQ(0, compiled.code) << compiler;
    EXPECT_EQ("", compiled.err) << compiler;
  }
  return result;
}

std::string HX_HostTest::save(const Json& model) const {
  const fs::path path = m_Folder / "model.json";
  write(path, model.dump());
  return path;
}

void HX_HostTest::write(const fs::path& path, const std::string& text) {
  std::ofstream file(path, std::ios::binary);
  file << text;
  EXPECT_TRUE(file.flush()) << path;
}

std::string HX_HostTest::read(const fs::path& path) {
  std::ifstream file(path, std::ios::binary);
  EXPECT_TRUE(file.is_open()) << path;
  return {std::istreambuf_iterator<char>(file), {}};
}

std::vector<std::string> HX_HostTest::linesOf(const std::string& text) {
  std::vector<std::string> lines;
  std::istringstream stream(text);
  for (std::string line; std::getline(stream, line);) lines.push_back(line);
  return lines;
}

HX_HostTest::Files HX_HostTest::filesIn(const fs::path& folder) {
  Files files;
  for (const auto& entry : fs::directory_iterator(folder))
    files[entry.path().filename()] = read(entry.path());
  return files;
}

HX_HostTest::Json HX_HostTest::parsed(const fs::path& file) {
  return Json::parse(read(fs::path(HX_TEST_FOLDER) / file));
}

HX_HostTest::Json HX_HostTest::smallModel(const Json& additions) {
  Json model = parsed("small_model.json");
  for (const char* list : {"types", "names"}) {
    for (const Json& entry : additions.value(list, Json::array()))
      model[list].push_back(entry);
  }
  return model;
}

void HX_HostTest::expectGolden(const std::string& folder, const Files& files) {
  const fs::path golden = fs::path(HX_TEST_FOLDER) / "golden" / folder;
  if (std::getenv("HX_RENEW_GOLDEN") != nullptr) {
    fs::remove_all(golden);
    fs::create_directories(golden);
    for (const auto& [name, text] : files)
      write(golden / (name + ".golden"), text);
  }
  Files expected;
  for (const auto& [name, text] : filesIn(golden))
    expected[fs::path(name).stem()] = text;
  EXPECT_EQ(expected, files);
}
