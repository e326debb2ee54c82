// What the program says about names.
#include <gmock/gmock.h>

#include <regex>

#include "host/HX_HostProgram.h"

namespace fs = std::filesystem;
using nlohmann::json;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

namespace {

json namesOf(const json& model, int code) {
  const HX_ProgramResult result =
      HX_RunCodegen("names --json " + HX_WriteModel(model));
  EXPECT_EQ(code, result.code) << result.err;
  return json::parse(result.out);
}

json nameOf(const json& result, const std::string& id) {
  for (const json& name : result["names"]) {
    if (name["id"] == id) return name;
  }
  ADD_FAILURE() << "no name " << id;
  return {};
}

// Every name that the demo finishes is accepted by C compilers of both ends of
// the years; one that is not finished says so.
TEST(NamesTest, CompilersAcceptEveryNameOfTheDemo) {
  const json result = namesOf(HX_DemoModel(), 0);
  std::string code;
  int finished = 0;
  for (const json& name : result["names"]) {
    if (!name["defined"]) {
      EXPECT_FALSE(name["complete"]) << name;
      continue;
    }
    ++finished;
    const std::string actual = name["actual"];
    code += "void f" + std::to_string(finished) + "_(void) { int " + actual +
            "; " + actual + " = 0; (void)" + actual + "; }\n";
  }
  EXPECT_GE(finished, 130);
  const fs::path source = HX_ScratchFolder() / "names.c";
  HX_WriteText(source, code);
  for (const char* compiler : {"cc -std=c90 -pedantic-errors", "cc -std=c17"}) {
    const HX_ProgramResult compiled = HX_RunCommand(
        std::string(compiler) + " -fsyntax-only " + source.string());
    EXPECT_EQ(0, compiled.code) << compiler << '\n' << compiled.err;
  }
}

TEST(NamesTest, DemoUsesEveryMacroOfTheLanguage) {
  std::string templates;
  const json demo = HX_DemoModel();
  for (const json& name : demo["names"])
    templates += name["template"].get<std::string>() + " ";
  for (const char letter : std::string("LBSIMNHOCDTXR$PVvFfExt"))
    EXPECT_THAT(templates, HasSubstr(std::string("$") + letter));
  for (const std::string word :
       {"Task", "ISR", "Msg", "Ctr", "Event", "MsgVar", "PObj", "Section",
        "Module", "FunctionName", "DataVariantName", "PageNumber",
        "VariantItemName", "Type", "BaseType", "Component"})
    EXPECT_THAT(templates, HasSubstr("$(" + word + ")"));
  for (const std::string kind : {"Time", "Period", "Offset"}) {
    for (const char* unit : {"", "1us", "10us", "100us", "1ms", "10ms", "100ms",
                             "1s", "1m", "1h", "1d"})
      EXPECT_THAT(templates, HasSubstr("$(" + kind + unit + ")"));
  }
}

TEST(NamesTest, TableShowsNamesWithChangesAndMessages) {
  const HX_ProgramResult result = HX_RunCodegen("names " HX_DEMO_MODEL);
  EXPECT_EQ(0, result.code);
  EXPECT_EQ("", result.err);
  const std::string table =
      std::regex_replace(result.out, std::regex(" +"), " ");
  EXPECT_THAT(table, testing::StartsWith("name source template formal "
                                         "actual complete\n"));
  EXPECT_THAT(table, HasSubstr("\nerror_plant cruise_control/Plant/Speed Error "
                               "$B Speed_Error Speed_Error_a yes\n changed: "
                               "taken by 'error'\n"));
  EXPECT_THAT(
      table,
      HasSubstr("\nretained_number ..._control/Controller/Proportional Gain"));
  EXPECT_THAT(table, HasSubstr("\nletter_P - m_p_$P m_p__P m_p__P yes\n "
                               "changed: made an identifier\n warning 30303 "
                               "The '$P' name macro in the m_p_$P name "
                               "template is not supported here. It is "
                               "ignored.\n"));
}

// The scopes are "file" with the bodies "f" and "g", "f" with the block "b",
// and the flat "os". What is expected is expected of the last name; the message
// is its only one.
TEST(NamesTest, ConflictsAreResolvedOrReported) {
  json model = HX_SmallModel();
  model["options"] = {{"limitNames", true},
                      {"keywords", {"c23", "std_macros"}}};
  model["types"].push_back({{"id", "state"},
                            {"name", "state_t"},
                            {"kind", "enum"},
                            {"values", {{{"name", "ON"}, {"value", 1}}}}});
  model["scopes"] = json::parse(
      R"([{"id":"file","kind":"file","scopes":[
            {"id":"f","kind":"function","function":"F",
             "scopes":[{"id":"b","kind":"block"}]},
            {"id":"g","kind":"function","function":"G"}]},
          {"id":"os","kind":"flat"}])");
  for (const json& row : HX_CaseTable("conflicts.json")) {
    SCOPED_TRACE(row["why"]);
    model["names"] = row["names"];
    for (const char* function : {"F", "G"})
      model["names"].insert(
          model["names"].begin(),
          json{{"id", function}, {"template", function}, {"kind", "function"}});
    const std::string message = row.value("message", "");
    const int code = message.rfind("error", 0) == 0 ? 1 : 0;
    const json name = namesOf(model, code)["names"].back();
    EXPECT_EQ(row["actual"], name["actual"]);
    EXPECT_EQ(row["changes"], name["changes"]);
    std::string messages;
    for (const json& found : name["messages"])
      messages += found["severity"].get<std::string>() + " " +
                  found["id"].dump() + " " + found["text"].get<std::string>();
    EXPECT_EQ(message, messages);
  }
}

TEST(NamesTest, SourceIsTheBestOfTheSet) {
  const json result = namesOf(HX_DemoModel(), 0);
  EXPECT_EQ("cruise_control/Controller/Integral Gain",
            nameOf(result, "integral")["source"]);  // the last block
  EXPECT_EQ(3U, nameOf(result, "integral")["sources"].size());
  EXPECT_EQ("//DD0/Pool/Variables/Ctrl/v_set",
            nameOf(result, "letter_D")["source"]);
  EXPECT_EQ("cruise_control/Controller/Cruise Modes/Active/Hold",
            nameOf(result, "state_active")["source"]);
}

TEST(NamesTest, CyclesAreReportedWithTheirNames) {
  json types = HX_SmallModel();
  for (const char* name : {"a", "b"})
    types["types"].push_back(
        {{"id", name},
         {"name", std::string(name) + "_t"},
         {"kind", "struct"},
         {"fields", {{{"name", "x"}, {"type", *name == 'a' ? "b" : "a"}}}}});
  json variables = HX_SmallModel();
  for (const char* name : {"a", "b"})
    variables["names"].push_back({{"id", name},
                                  {"template", std::string("v_") + name},
                                  {"kind", "variable"},
                                  {"type", "i8"},
                                  {"dependsOn", {*name == 'a' ? "b" : "a"}}});
  const struct {
    const json& model;
    const char* text;
  } kRows[] = {{types, "data types : "}, {variables, "variables : "}};
  for (const auto& row : kRows) {
    const json messages = namesOf(row.model, 1)["messages"];
    ASSERT_EQ(1U, messages.size());
    EXPECT_EQ(17051, messages[0]["id"]);
    EXPECT_THAT(messages[0]["text"].get<std::string>(), HasSubstr(row.text));
    EXPECT_THAT(messages[0]["text"].get<std::string>(), HasSubstr("b"));

    const fs::path out = HX_ScratchFolder() / "out";
    EXPECT_EQ(1, HX_RunCodegen("generate " + HX_WriteModel(row.model) +
                               " --out " + out.string())
                     .code);
    EXPECT_FALSE(fs::exists(out));
    EXPECT_EQ(
        1,
        HX_RunCodegen("explain " + HX_WriteModel(types) + " --name any").code);
  }
}

TEST(NamesTest, ExplanationShowsEachMacro) {
  const HX_ProgramResult result =
      HX_RunCodegen("explain " HX_DEMO_MODEL " --name throttle_cmd_raw");
  EXPECT_EQ(0, result.code);
  const std::string path =
      "cruise_control/Controller/Throttle Command Saturation and Rate Limiter";
  EXPECT_EQ("name throttle_cmd_raw\ntemplate $S_$B\nsource " + path +
                "\n\n macro gives which is\n"
                " $S Sa2 subsystem id and number, from " +
                path +
                "\n _ _ as written\n"
                " $B Throttle_Command_Saturation_and_Rate_Limiter block name, "
                "from " +
                path +
                "\n\nformal Sa2_Throttle_Co__d_Rate_Limiter\n"
                "actual Sa2_Throttle_Co__d_Rate_Limit_a\n"
                "changed shortened\nchanged taken by 'throttle_cmd'\n"
                "complete yes\n",
            std::regex_replace(result.out, std::regex(" +"), " "));
}

}  // namespace
