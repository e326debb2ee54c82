// Commands, options, and what tells of them.
#include <regex>
#include <set>

#include "host/HX_HostTest.h"

using testing::HasSubstr;

namespace {

class CommandLineTest : public HX_HostTest {};

TEST_F(CommandLineTest, WrongOnesAreRefused) {
  for (const char* arguments :
       {"", "names", "explain " HX_DEMO_MODEL, "generate " HX_DEMO_MODEL,
        "names " HX_DEMO_MODEL " --wrong",
        "explain " HX_DEMO_MODEL " --name nobody", "synthesize --blocks -1"}) {
    SCOPED_TRACE(arguments);
    const Result result = codegen(arguments);
    EXPECT_EQ(2, result.code);
    EXPECT_EQ("", result.out);
    EXPECT_NE("", result.err);
  }
}

TEST_F(CommandLineTest, VersionNamesTheProgram) {
  const std::string version = HX_PROGRAM_VERSION ".0";
  const std::string shown = codegen("--version").out;
  EXPECT_THAT(shown, HasSubstr("\nfile      " + version + "\nbuilt     "));
  const std::size_t end = shown.find('\n');
  EXPECT_EQ(version.find(shown.substr(0, end).substr(11)), 0U) << shown;
}

TEST_F(CommandLineTest, ManualPageHasTheOptionsOfTheHelp) {
  const auto optionsIn = [](const std::string& text) {
    static const std::regex option("--[a-z-]+");
    return std::set<std::string>(
        std::sregex_token_iterator(text.begin(), text.end(), option), {});
  };
  const std::string page =
      std::regex_replace(read(HX_MANUAL_PAGE), std::regex(R"(\\-)"), "-");
  std::string help = codegen("--help").out;
  for (const std::string command :
       {"names", "explain", "generate", "check", "components", "lock", "diff",
        "lint", "import", "rules", "report", "help", "synthesize"}) {
    EXPECT_THAT(help, HasSubstr("\n  " + command + " "));
    EXPECT_THAT(page, HasSubstr("\n.SS " + command + "\n"));
    help += codegen(command + " --help").out;
  }
  EXPECT_EQ(optionsIn(help), optionsIn(page));
}

TEST_F(CommandLineTest, TerminalShowsProgress) {
  Json model{{"model", {{"name", "m"}, {"systemId", "a"}}}};
  for (int i = 0; i < 5000; ++i) {
    const std::string name = "n" + std::to_string(i);
    model["names"].push_back({{"id", name}, {"template", name}});
  }
  const std::string command =
      "script -qec '" HX_CODEGEN_COMMAND " explain --name n1 " + save(model);
  const std::string unseen = " >/dev/null' /dev/null </dev/null";
  EXPECT_THAT(shell(command + unseen).out, HasSubstr("\rnames: 4000 of 5000"));
  EXPECT_EQ("", shell(command + " --quiet" + unseen).out);
}

}  // namespace
