// The program in a build: components, checks, dependency files, arguments in
// files.
#include "host/HX_HostTest.h"

namespace fs = std::filesystem;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::Not;
using testing::StartsWith;

namespace {

class BuildTest : public HX_HostTest {
 protected:
  static Files treeOf(const fs::path& folder) {
    Files files;
    for (const auto& entry : fs::recursive_directory_iterator(folder))
      if (entry.is_regular_file())
        files[fs::relative(entry.path(), folder)] = read(entry.path());
    return files;
  }
  // The words of a component's line: path and file name.
  std::vector<std::string> componentsOf(const std::string& model) const {
    std::vector<std::string> paths;
    for (const std::string& line : linesOf(codegen("components " + model).out))
      paths.push_back(line.substr(0, line.find('\t')));
    return paths;
  }
  const std::string m_Lock = m_Folder / "names.lock";
  const std::string m_WithLock = " --quiet --lock " + m_Lock;
};

// Equal file names, names that differ by case, and names in conflict across
// components.
constexpr char kTwins[] = R"json({"model": {"name": "m", "systemId": "a"},
  "types": [{"id": "i", "name": "Int", "kind": "base", "c": "int", "cut": ""}],
  "scopes": [{"id": "file", "kind": "file", "scopes": [
    {"id": "f", "kind": "function", "function": "F"}]}],
  "blocks": [{"id": "r", "name": "root", "blocks": [
    {"id": "a", "name": "A b", "blocks": [{"id": "x", "name": "In"}]},
    {"id": "b", "name": "A_b", "blocks": [{"id": "y", "name": "In"}]},
    {"id": "c", "name": "a b", "blocks": [{"id": "z", "name": "In"}]},
    {"id": "g", "name": "Gain"}]}],
  "names": [
    {"id": "1", "template": "$B", "kind": "variable", "type": "i", "source": "x"},
    {"id": "2", "template": "$B", "kind": "variable", "type": "i", "source": "y", "dependsOn": ["1"]},
    {"id": "3", "template": "$B", "kind": "variable", "type": "i", "source": "z", "initial": 1e12},
    {"id": "4", "template": "$B", "kind": "variable", "type": "i", "source": "g"},
    {"id": "T", "template": "T_$(Time)",
               "kind" : "task", "period" : 0.01, "source" : "x"
},
    {"id": "5", "template": "$(Task)_v", "kind": "variable", "type": "i", "source": "y", "task": "T"},
    {"id": "F", "template": "F", "kind": "function", "source": "b"},
    {"id": "6", "template": "$B", "kind": "variable", "type": "i", "source": "z", "scope": "f"}]})json";

TEST_F(BuildTest, ComponentsTogetherAreTheWholeRun) {
  const std::string twins = m_Folder / "twins.json";
  write(twins, kTwins);
  const std::string synthetic = m_Folder / "synthetic.json";
  write(synthetic, codegen("synthesize --blocks 300").out);
  for (const std::string& model :
       {twins, synthetic, std::string(HX_DEMO_MODEL)}) {
    SCOPED_TRACE(model);
    fs::remove(m_Lock);
    const fs::path whole = m_Folder / "whole";
    const fs::path parts = m_Folder / "parts";
    for (const fs::path& folder : {m_Out, whole, parts}) fs::remove_all(folder);
    ASSERT_EQ(0, generate(model + m_WithLock).code);  // makes the names
    ASSERT_EQ(0, codegen("generate " + model + m_WithLock +
                         " --locked --by-component --out " + whole.string())
                     .code);
    const std::string lock = read(m_Lock);
    std::vector<std::string> components = componentsOf(model);
    EXPECT_LT(2U, components.size());
    std::reverse(components.begin(), components.end());
    for (const std::string& path : components) {
      const Result result =
          codegen("generate " + model + m_WithLock + " --component '" + path +
                  "' --out " + parts.string());
      EXPECT_EQ(0, result.code) << result.err;
    }
    EXPECT_EQ(treeOf(whole), treeOf(parts));
    EXPECT_EQ(lock, read(m_Lock));
    const Result compiled =
        shell("cd " + parts.string() +
              " && for c in */*.c; do cc -std=c90 -pedantic-errors -Wall "
              "-Wextra $(printf -- '-I%s ' */) -c -o $c.o $c || exit; done; "
              "ld -r -o all.o */*.o");
    EXPECT_EQ(0, compiled.code) << compiled.err;
    EXPECT_EQ("", compiled.err);
  }
}

// The function is in one component, the block of the variable in another.
TEST_F(BuildTest, LocalVariablesGoWithTheirFunction) {
  const std::string model = m_Folder / "twins.json";
  write(model, kTwins);
  ASSERT_EQ(0, generate(model + " --by-component").code);
  EXPECT_THAT(read(m_Out / "m_A_b_2" / "m_A_b_2.c"),
              HasSubstr("void F(void) {\n  /* root/a b/In */\n  Int In_c;\n"));
}

TEST_F(BuildTest, FileNamesOfComponentsAreDistinct) {
  write(m_Folder / "twins.json", kTwins);
  EXPECT_EQ(".\tm\nroot/A b\tm_A_b\nroot/A_b\tm_A_b_2\nroot/a b\tm_a_b_3\n",
            codegen("components " + (m_Folder / "twins.json").string()).out);
}

TEST_F(BuildTest, ComponentWithoutNamesOfTheLockIsRefused) {
  const std::string model = m_Folder / "twins.json";
  write(model, kTwins);
  const std::string component =
      " --component 'root/A b' --out " + m_Out.string();
  EXPECT_EQ(2, codegen("generate " + model + component).code);
  EXPECT_EQ(2, codegen("generate " + model + m_WithLock + component).code);
  ASSERT_EQ(0, generate(model + m_WithLock).code);
  fs::remove_all(m_Out);
  Json changed = Json::parse(kTwins);
  changed["names"][0]["template"] = "new_$B";  // in the component
  const Result refused =
      codegen("generate " + save(changed) + m_WithLock + component);
  EXPECT_EQ(1, refused.code);
  EXPECT_THAT(refused.err, StartsWith("1: error   421 "));
  EXPECT_FALSE(fs::exists(m_Out));
  EXPECT_THAT(codegen("generate " + model + m_WithLock +
                      " --component x --out " + m_Out.string())
                  .err,
              HasSubstr("found no component \"x\", expected one of: \".\", "
                        "\"root/A b\", "));
}

TEST_F(BuildTest, CheckDoesAllButWriting) {
  const std::string demo = HX_DEMO_MODEL;
  const Result result = codegen("check " + demo);
  EXPECT_EQ(0, result.code);
  EXPECT_EQ(generate(demo).err, result.err);
  EXPECT_EQ(codegen("names " + demo + " --diagnostics json").wholeErr,
            codegen("check " + demo + " --diagnostics json").wholeErr);
  EXPECT_EQ(1, codegen("check " + demo + " --werror").code);

  const std::string upToDate =
      "check " + demo + " --up-to-date --out " + m_Out.string();
  const Files files = filesIn(m_Out);
  EXPECT_EQ(0, codegen(upToDate).code);
  write(m_Out / "cruise_control.h", files.at("cruise_control.h") + " ");
  write(m_Out / "name_map.csv", "");
  fs::remove(m_Out / "cruise_control.c");
  const Result outdated = codegen(upToDate);
  EXPECT_EQ(1, outdated.code);
  std::vector<std::string> expected;
  for (const char* name :
       {"cruise_control.c", "cruise_control.h", "name_map.csv"})
    expected.push_back((m_Out / name).string() + ": would change [521]");
  std::vector<std::string> lines = linesOf(outdated.wholeErr);
  lines.resize(3);
  EXPECT_EQ(expected, lines);
  EXPECT_THAT(outdated.wholeErr, Not(HasSubstr("name_map.json")));
  EXPECT_FALSE(fs::exists(m_Out / "cruise_control.c"));
}

TEST_F(BuildTest, DependencyFileHasOutputsAndInputs) {
  const fs::path spaced = m_Folder / "a $b#.json";
  write(spaced, smallModel(Json::object()).dump());
  const std::string depfile = m_Folder / "code.d";
  const Result result = codegen("generate '" + spaced.string() + "' --out " +
                                m_Out.string() + " --depfile " + depfile);
  ASSERT_EQ(0, result.code) << result.err;
  std::string outputs;
  for (const std::string& line :
       linesOf(codegen("generate '" + spaced.string() + "' --list-outputs" +
                       " --out " + m_Out.string())
                   .out)) {
    EXPECT_TRUE(fs::exists(line)) << line;
    outputs += line + " ";
  }
  const std::string text = read(depfile);
  EXPECT_THAT(text, StartsWith(outputs + ":"));
  EXPECT_THAT(text,
              HasSubstr(" \\\n  " + m_Folder.string() + "/a\\ $$b\\#.json\n"));
  EXPECT_THAT(text, HasSubstr("/c23.txt \\\n"));
  const std::string target = (m_Out / "small.c").string();
  write(m_Folder / "recipe", target + ":\n\ttrue\n");
  const std::string make = "make -r -q -f " + (m_Folder / "recipe").string() +
                           " -f " + depfile + " " + target;
  EXPECT_EQ(0, shell(make).code);
  fs::last_write_time(spaced,
                      fs::file_time_type::clock::now() + std::chrono::hours(1));
  EXPECT_EQ(1, shell(make).code);
}

TEST_F(BuildTest, ArgumentsComeFromFiles) {
  const std::string arguments = m_Folder / "arguments";
  write(m_Folder / "more", "--filter 'name=de*_base'\r\n\"--sort\"\tname");
  write(arguments, "names " HX_DEMO_MODEL " --columns name,act\\ual\n@" +
                       (m_Folder / "more").string());
  const Result result = codegen("@" + arguments);
  EXPECT_EQ(0, result.code) << result.err;
  EXPECT_THAT(result.out, StartsWith("name          actual\n"));
  EXPECT_THAT(result.out, HasSubstr("\nderived_base  "));
  write(arguments, "@" + arguments);
  EXPECT_EQ(2, codegen("@" + arguments).code);
  EXPECT_EQ(2, codegen("@" + arguments + "x").code);
}

struct TableCase {
  const char* options;
  std::vector<const char*> ids;
};

TEST_F(BuildTest, TablesAreFilteredAndSorted) {
  const TableCase cases[] = {
      {"", {"F", "G", "v10", "v2", "k"}},
      {"--sort name", {"F", "G", "k", "v2", "v10"}},
      {"--filter kind=variable --sort name", {"v2", "v10"}},
      {"--filter name!=v*", {"F", "G", "k"}},
      {"--filter changes=*keyword*", {"k"}},
      {"--filter int_a", {"k"}},
      {"--filter name=v --filter name=v2", {}},
      {"--filter type=Int8 --filter name=*2", {"v2"}},
      {"--filter scope=os", {"k"}},
  };
  const std::string model = save(
      smallModel({{"names",
                   {{{"id", "v10"},
                     {"template", "v10"},
                     {"kind", "variable"},
                     {"type", "i8"}},
                    {{"id", "v2"},
                     {"template", "v2"},
                     {"kind", "variable"},
                     {"type", "i8"}},
                    {{"id", "k"}, {"template", "int"}, {"scope", "os"}}}}}));
  for (const TableCase& row : cases) {
    SCOPED_TRACE(row.options);
    const Json names = Json::parse(
        codegen("names --json " + model + " " + row.options).out)["names"];
    std::vector<std::string> ids;
    for (const Json& name : names) ids.push_back(name["id"]);
    EXPECT_EQ(std::vector<std::string>(row.ids.begin(), row.ids.end()), ids);
  }
  EXPECT_EQ(2, codegen("names " + model + " --filter colour=red").code);
  EXPECT_EQ(2, codegen("names " + model + " --columns colour").code);
}

TEST_F(BuildTest, ExplanationHasTheUncutNameAndEachStep) {
  const Json shown = Json::parse(
      codegen("explain " HX_DEMO_MODEL " --json --name throttle_cmd_raw").out);
  std::vector<std::string> steps;
  for (const Json& step : shown["steps"])
    steps.push_back(step["what"].get<std::string>().substr(0, 9) + " " +
                    step["name"].get<std::string>() +
                    (step["conflict"] ? " !" : ""));
  EXPECT_THAT(
      steps,
      ElementsAre("uncut Sa2_Throttle_Command_Saturation_and_Rate_Limiter",
                  "shortened Sa2_Throttle_Co__d_Rate_Limiter",
                  "taken by  Sa2_Throttle_Co__d_Rate_Limiter !",
                  "variant Sa2_Throttle_Co__d_Rate_Limit_a"));
  EXPECT_EQ("$S", shown["macros"][0]["macro"]);
  EXPECT_EQ("Sa2_Throttle_Co__d_Rate_Limit_a", shown["actual"]);
}

}  // namespace
