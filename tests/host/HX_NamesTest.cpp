// What the program says about names.
#include "host/HX_HostTest.h"

namespace fs = std::filesystem;

namespace {

class NamesTest : public HX_HostTest {};

// Every name that the demo finishes is accepted by C compilers of both ends of
// the years; one that is not finished says so.
TEST_F(NamesTest, CompilersAcceptEveryNameOfTheDemo) {
  std::string code;
  int finished = 0;
  const Json result = Json::parse(codegen("names --json " HX_DEMO_MODEL).out);
  for (const Json& name : result["names"]) {
    EXPECT_TRUE(name["defined"] || !name["complete"]) << name;
    if (!name["defined"]) continue;
    code += "void f" + std::to_string(++finished) + "_(void) { int " +
            name["actual"].get<std::string>() + "; }\n";
  }
  EXPECT_GE(finished, 130);
  write(m_Folder / "names.c", code);
  for (const std::string standard : {"c90 -pedantic-errors", "c17"})
    EXPECT_EQ("", shell("cc -fsyntax-only -std=" + standard + " " +
                        (m_Folder / "names.c").string())
                      .err);
}

// The explanations show each kind of macro, and each place its value is from.
TEST_F(NamesTest, TableAndExplanationsAreTheGoldenCopies) {
  std::string explanations;
  for (const std::string name : {"block_without_source",
                                 "derived_base",
                                 "fn_limit",
                                 "letter_C",
                                 "letter_P",
                                 "letter_X",
                                 "letter_dollar",
                                 "long_same_1",
                                 "mode",
                                 "offset_100ms",
                                 "os_event",
                                 "os_isr",
                                 "os_isr_as_task",
                                 "period_100ms",
                                 "placeholder_d",
                                 "provisional_label",
                                 "state_active",
                                 "state_dd",
                                 "sym_constant",
                                 "sym_function",
                                 "sym_function_upper",
                                 "task_100ms",
                                 "throttle_cmd_raw",
                                 "untyped"})
    explanations += codegen("explain " HX_DEMO_MODEL " --name " + name).out;
  const std::string model = save(smallModel(
      Json::parse(R"({"names": [{"id": "t", "template": "$(Task)$(Open"}]})")));
  explanations += codegen("explain " + model + " --name t").out;
  expectGolden("shown", {{"explanations.txt", explanations},
                         {"table.txt", codegen("names " HX_DEMO_MODEL).out}});
}

// A run each; one that reports an error writes no code. The types are left out.
TEST_F(NamesTest, ConflictsAndCyclesAreResolvedOrReported) {
  std::string text;
  for (const Json& row : parsed("conflicts.json")) {
    SCOPED_TRACE(row["why"]);
    const std::string model = save(smallModel(row));
    const Result names = codegen("names " + model);
    fs::remove_all(m_Out);
    const Result code = generate(model);
    text += "== " + row["why"].get<std::string>() + "\n" +
            names.out.substr(0, names.out.find("\nTypes")) + code.err + "\n";
    EXPECT_EQ(names.code, code.code);
    EXPECT_EQ(names.code == 0, fs::exists(m_Out));
    if (names.code != 0) {
      EXPECT_EQ(1, codegen("explain " + model + " --name 1").code);
    }
  }
  expectGolden("conflicts", {{"tables.txt", text}});
}

}  // namespace
