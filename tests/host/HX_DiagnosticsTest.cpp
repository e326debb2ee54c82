// Messages: numbers, help, choice, and the forms for machines.
#include <algorithm>
#include <set>

#include "host/HX_HostTest.h"

namespace fs = std::filesystem;
using testing::AllOf;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::Not;
using testing::StartsWith;

namespace {

class DiagnosticsTest : public HX_HostTest {
 protected:
  // Three names of one cause, one name of a second cause.
  std::string saveWarnings() const {
    Json names;
    for (const char* id : {"a", "b", "c"})
      names.push_back({{"id", id}, {"template", "$Q$B"}, {"source", "gain"}});
    names.push_back({{"id", "d"}, {"template", "x:y:z"}});
    return save(smallModel({{"names", names}}));
  }
  Json list(const std::string& command) const {
    const Result result = codegen(command + " --diagnostics json");
    return Json::parse(result.wholeErr)["diagnostics"];
  }
};

TEST_F(DiagnosticsTest, HelpTellsTextCauseAndCure) {
  EXPECT_EQ("hx_codegen: no message has the number 9 [102]\n",
            codegen("help 9").wholeErr);
  EXPECT_EQ(
      "411  error\n\n"
      "text   The name is empty: nothing is defined.\n"
      "cause  All macros of the template are empty for this item.\n"
      "cure   Add literal text to the template, or a macro with a value.\n",
      codegen("help 411").out);
  // Row and id of the library's catalogue.
  EXPECT_THAT(codegen("help 408").out, StartsWith("17056  error\n"));
  EXPECT_EQ(codegen("help 408").out, codegen("help 17056").out);
  const std::string all = codegen("help").out;
  for (const char* number : {"411", "408", "1292"})
    EXPECT_THAT(all, HasSubstr(codegen(std::string("help ") + number).out));
}

TEST_F(DiagnosticsTest, OneCauseIsOneMessageWithTheNumberOfFurtherPlaces) {
  const Result result = generate(saveWarnings());
  EXPECT_THAT(linesOf(result.wholeErr),
              ElementsAre(AllOf(StartsWith("a: warning 30304  "),
                                testing::EndsWith("]  (and 2 more)")),
                          StartsWith("d: warning 415    The name template")));
  const Json json =
      list("generate " + saveWarnings() + " --out " + m_Out.string());
  ASSERT_EQ(2U, json.size());
  EXPECT_EQ(2, json[0]["further"]);
  EXPECT_EQ("a", json[0]["item"]);
  EXPECT_EQ(30304, json[0]["number"]);
  EXPECT_EQ("warning", json[0]["severity"]);
}

struct ChoiceCase {
  const char* options;
  int code;
  std::vector<int> numbers;  // of the messages, in their order
  const char* severity;
};

TEST_F(DiagnosticsTest, WarningsCanBeSilencedOrRaised) {
  const ChoiceCase cases[] = {
      {"", 0, {30304, 415}, "warning"},
      {"--silence 415", 0, {30304}, "warning"},
      {"--silence 415,30304", 0, {}, ""},
      {"--werror", 1, {30304, 415}, "error"},
      {"--werror --silence 30304", 1, {415}, "error"},
      {"--werror --silence 30304,415", 0, {}, ""},
  };
  const std::string model = saveWarnings();
  for (const ChoiceCase& row : cases) {
    for (const char* command : {"generate --out out ", "names "}) {
      SCOPED_TRACE(std::string(command) + row.options);
      fs::remove_all(m_Out);
      const Result result =
          shell("cd " + m_Folder.string() + " && " HX_CODEGEN_COMMAND " " +
                command + model + " --diagnostics json " + row.options);
      EXPECT_EQ(row.code, result.code);
      std::vector<int> numbers;
      const Json log = Json::parse(result.wholeErr);
      for (const Json& entry : log["diagnostics"]) {
        numbers.push_back(entry["number"]);
        EXPECT_EQ(row.severity, entry["severity"]);
      }
      EXPECT_EQ(row.numbers, numbers);
      EXPECT_EQ(row.code, log["exitCode"]);
      const bool isGenerated = *command == 'g' && row.code == 0;
      EXPECT_EQ(isGenerated, fs::exists(m_Out));
    }
  }
}

// A warning of the writer comes after the names: it must stop the files too.
TEST_F(DiagnosticsTest, ErrorsAreNotSilencedAndRaisedOnesPlaceNoFile) {
  const std::string saturated =
      save(smallModel({{"names", parsed("initial_values.json")}}));
  EXPECT_EQ(1, generate(saturated + " --werror").code);
  EXPECT_FALSE(fs::exists(m_Out));
  EXPECT_EQ(0, generate(saturated + " --werror --silence 511").code);

  const std::string empty =
      save(smallModel({{"names", {{{"id", "e"}, {"template", "$L"}}}}}));
  EXPECT_THAT(generate(empty + " --silence 411,17260").err,
              HasSubstr("error   411 "));
}

struct SarifCase {
  const char* why;
  const char* command;  // $M a model, $B a faulty one, $S a silent one
  const char* rule;
  const char* level;
};

TEST_F(DiagnosticsTest, SarifIsValidAndNamesRuleAndPlace) {
  const std::string model = saveWarnings();
  const std::string silent = m_Folder / "silent.json";
  write(silent, smallModel(Json::object()).dump());
  const std::string bad = m_Folder / "b\xC3\xA4 d.json";
  write(bad, "{\"model\":\n {\"name\": 7}, \"names\": []}");
  const SarifCase cases[] = {
      {"warning", "names $M", "HX30304", "warning"},
      {"raised", "names $M --werror", "HX30304", "error"},
      {"fault of a document", "names \"$B\"", "HX302", "error"},
      {"command line", "names", "HX101", "error"},
      {"file", "names /", "HX201", "error"},
      {"nothing", "names $S", "", ""},
  };
  for (const SarifCase& row : cases) {
    SCOPED_TRACE(row.why);
    const Result result = shell("M=" + model + "; S=" + silent + "; B='" + bad +
                                "'; " HX_CODEGEN_COMMAND " " + row.command +
                                " --diagnostics sarif");
    const fs::path log = m_Folder / "log.sarif";
    write(log, result.wholeErr);
    const Result checked = shell(
        "/usr/bin/python3 " HX_TEST_FOLDER "/check_sarif.py " + log.string());
    EXPECT_EQ("", checked.wholeErr) << result.wholeErr;
    EXPECT_EQ(0, checked.code);
    const Json run = Json::parse(result.wholeErr)["runs"][0];
    EXPECT_EQ(result.code, run["invocations"][0]["exitCode"]);
    if (*row.rule == '\0') {
      EXPECT_EQ(Json::array(), run["results"]);
      continue;
    }
    const Json& first = run["results"][0];
    EXPECT_EQ(row.rule, first["ruleId"]);
    EXPECT_EQ(row.level, first["level"]);
    if (first["ruleId"] != "HX302") continue;
    const Json& place = first["locations"][0]["physicalLocation"];
    EXPECT_EQ("file://" + m_Folder.string() + "/b%C3%A4%20d.json",
              place["artifactLocation"]["uri"]);
    EXPECT_EQ((Json{{"startLine", 2}, {"startColumn", 11}}), place["region"]);
  }
}

TEST_F(DiagnosticsTest, TerminalsGetColorsAndWrappedLines) {
  const auto shown = [this](const std::string& environment) {
    return shell("script -qec 'stty cols 60; " + environment +
                 " TERM=xterm " HX_CODEGEN_COMMAND " generate " +
                 saveWarnings() + " --quiet --out " + m_Out.string() +
                 "' /dev/null </dev/null")
        .out;
  };
  const std::string colored = shown("");
  EXPECT_THAT(colored, HasSubstr("a: \x1B[1;33mwarning\x1B[0m 30304"));
  const std::string plain = shown("NO_COLOR=1");
  EXPECT_THAT(plain,
              AllOf(HasSubstr("a: warning 30304"), Not(HasSubstr("\x1B["))));
  for (const std::string& line : linesOf(plain)) EXPECT_GE(61U, line.size());
  EXPECT_LT(3U, linesOf(plain).size());
}

}  // namespace
