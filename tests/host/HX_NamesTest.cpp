// What the program says about names.
#include "host/HX_HostTest.h"

namespace fs = std::filesystem;

namespace {

class NamesTest : public HX_HostTest {};

// The last name has a macro of each kind and nothing that could fill it.
TEST_F(NamesTest, TableAndExplanationsAreTheGoldenCopies) {
  constexpr const char* kExplained[] = {
      "derived_base", "mode",         "os_event",        "provisional_label",
      "state_active", "sym_function", "throttle_cmd_raw"};
  std::string explanations;
  for (const std::string name : kExplained)
    explanations += codegen("explain " HX_DEMO_MODEL " --name " + name).out;
  const std::string model = save(smallModel(parsed("all_macros.json")));
  explanations += codegen("explain " + model + " --name all").out;
  expectGolden("shown", {{"explanations.txt", explanations},
                         {"table.txt", codegen("names " HX_DEMO_MODEL).out},
                         {"names.json", codegen("names --json " + model).out}});
}

// The ids tell what each name is for. The types are left out; a document with
// an error gives no code.
TEST_F(NamesTest, ConflictsAndCyclesAreResolvedOrReported) {
  std::string text;
  for (const Json& row : parsed("conflicts.json")) {
    SCOPED_TRACE(row["why"]);
    const std::string model = save(smallModel(row));
    const Result names = codegen("names " + model);
    const Result code = generate(model);
    text += "== " + row["why"].get<std::string>() + ": exit code " +
            std::to_string(names.code) + "\n" +
            names.out.substr(0, names.out.find("\nTypes")) + code.err + "\n";
    for (auto at = text.find(model); at != text.npos; at = text.find(model))
      text.replace(at, model.size(), "MODEL");
    EXPECT_EQ(names.code, code.code);
    EXPECT_EQ(names.code, codegen("explain " + model + " --name F").code);
    EXPECT_EQ(names.code == 0, fs::exists(m_Out));
    fs::remove_all(m_Out);
  }
  expectGolden("conflicts", {{"tables.txt", text}});
}

}  // namespace
