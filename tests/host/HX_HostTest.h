// Runs hx_codegen as a user does.
//
//   class NamesTest : public HX_HostTest {};
//   TEST_F(NamesTest, TableIsPrinted) {
//     EXPECT_EQ(0, codegen("names " HX_DEMO_MODEL).code);
//   }

#ifndef HOST_HX_HOSTTEST_H
#define HOST_HX_HOSTTEST_H

#include <gmock/gmock.h>

#include <filesystem>
#include <map>
#include <nlohmann/json.hpp>
#include <string>
#include <vector>

/// Every test has a folder, empty at the start.
class HX_HostTest : public testing::Test {
 protected:
  using Json = nlohmann::json;
  using Files = std::map<std::string, std::string>;  // texts by name

  struct Result {
    int code;
    std::string out;
    std::string err;  // without the numbers of messages at ends of lines
    std::string wholeErr;
  };

  HX_HostTest();

  /// Runs a shell command and catches the output.
  Result shell(const std::string& command) const;
  Result codegen(const std::string& arguments) const;
  /// Writes code into m_Out.
  Result generate(const std::string& model) const;
  /// Generates code of a document; the code has to compile without a warning.
  Result generateValid(const Json& model) const;

  /// Writes a document. RETURNS: the path.
  std::string save(const Json& model) const;
  static void write(const std::filesystem::path& path, const std::string& text);
  static std::string read(const std::filesystem::path& path);
  static std::vector<std::string> linesOf(const std::string& text);
  static Files filesIn(const std::filesystem::path& folder);

  /// A file by path, or by name in this folder.
  static Json parsed(const std::filesystem::path& file);
  /// A block, some types, scopes and functions; \p additions has further
  /// "types" and "names".
  static Json smallModel(const Json& additions);

  /// Compares with a copy in golden/, whose names have a further ending: they
  /// are data, not sources.
  /// HX_RENEW_GOLDEN=1 build/dev/tests/host/test_host writes the copies anew.
  static void expectGolden(const std::string& folder, const Files& files);

  const std::filesystem::path m_Folder;
  const std::filesystem::path m_Out = m_Folder / "out";
};

#endif  // HOST_HX_HOSTTEST_H
