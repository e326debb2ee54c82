// The C code that the program writes.
#include <gmock/gmock.h>

#include <algorithm>
#include <cstdlib>

#include "host/HX_HostProgram.h"

namespace fs = std::filesystem;
using nlohmann::json;
using testing::ElementsAre;
using testing::HasSubstr;

namespace {

const fs::path kGolden = fs::path(HX_TEST_FOLDER) / "golden/cruise_control";

// The files of a folder by name.
std::map<std::string, std::string> filesIn(const fs::path& folder) {
  std::map<std::string, std::string> files;
  for (const auto& entry : fs::directory_iterator(folder))
    files[entry.path().filename()] =
        entry.is_directory() ? "a folder" : HX_ReadText(entry.path());
  return files;
}

// Their names have a further ending there: they are data, not sources.
std::map<std::string, std::string> goldenFiles() {
  std::map<std::string, std::string> files;
  for (const auto& [name, text] : filesIn(kGolden))
    files[fs::path(name).stem()] = text;
  return files;
}

HX_ProgramResult generate(const std::string& model, const fs::path& out) {
  return HX_RunCodegen("generate " + model + " --out " + out.string());
}

void expectCompiles(const fs::path& folder, const std::string& source) {
  for (const std::string compiler : {"cc", "clang"}) {
    if (HX_RunCommand("command -v " + compiler).code != 0) continue;
    const HX_ProgramResult compiled = HX_RunCommand(
        "cd " + folder.string() + " && " + compiler +
        " -std=c90 -pedantic-errors -Wall -Wextra -c -o /dev/null " + source);
    EXPECT_EQ(0, compiled.code) << compiler;
    EXPECT_EQ("", compiled.err) << compiler;
  }
}

// HX_RENEW_GOLDEN=1 build/dev/tests/host/test_host writes the golden copy anew.
TEST(GenerateTest, DemoGivesTheGoldenCopy) {
  const fs::path out = HX_ScratchFolder() / "out";
  const HX_ProgramResult result = generate(HX_DEMO_MODEL, out);
  EXPECT_EQ(0, result.code);
  if (std::getenv("HX_RENEW_GOLDEN") != nullptr) {
    fs::remove_all(kGolden);
    fs::create_directories(kGolden);
    for (const auto& [name, text] : filesIn(out))
      HX_WriteText(kGolden / (name + ".golden"), text);
  }
  EXPECT_EQ(goldenFiles(), filesIn(out));
  expectCompiles(out, "cruise_control.c");
}

// Reverses every list whose entries are independent of each other.
void reverseLists(json& node) {
  static const std::vector<std::string> kOrdered = {"fields", "values",
                                                    "initial", "alsoFrom"};
  for (auto& [key, value] : node.items()) {
    if (value.is_structured()) reverseLists(value);
    const bool isOrdered =
        std::find(kOrdered.begin(), kOrdered.end(), key) != kOrdered.end();
    if (value.is_array() && !isOrdered)
      std::reverse(value.begin(), value.end());
  }
}

TEST(GenerateTest, OrderOfTheDocumentDoesNotMatter) {
  json model = HX_DemoModel();
  reverseLists(model);
  const fs::path out = HX_ScratchFolder() / "out";
  EXPECT_EQ(0, generate(HX_WriteModel(model), out).code);
  EXPECT_EQ(goldenFiles(), filesIn(out));
}

TEST(GenerateTest, FilesThatDoNotChangeAreNotTouched) {
  const fs::path out = HX_ScratchFolder() / "out";
  ASSERT_EQ(0, generate(HX_DEMO_MODEL, out).code);
  const auto old = fs::file_time_type::clock::now() - std::chrono::hours(1);
  for (const auto& entry : fs::directory_iterator(out))
    fs::last_write_time(entry.path(), old);
  HX_WriteText(out / "cruise_control.h", "changed by hand");
  EXPECT_THAT(generate(HX_DEMO_MODEL, out).out, HasSubstr("; 1 files written"));
  EXPECT_EQ(goldenFiles(), filesIn(out));
  EXPECT_EQ(old, fs::last_write_time(out / "cruise_control.c"));
}

TEST(GenerateTest, FailureLeavesTheFolderAsItWas) {
  const fs::path out = HX_ScratchFolder() / "out";
  fs::create_directories(out / "name_map.json");  // in the way of a file
  HX_WriteText(out / "cruise_control.h", "old");
  const auto before = filesIn(out);
  const HX_ProgramResult result = generate(HX_DEMO_MODEL, out);
  EXPECT_EQ(2, result.code);
  EXPECT_THAT(result.err,
              HasSubstr("name_map.json: cannot be written: Is a directory"));
  EXPECT_EQ(before, filesIn(out));
}

// All rows in one run; the '@' of the code stands for the variable's name.
TEST(GenerateTest, InitialValuesAreScaledRoundedAndSaturated) {
  json model = HX_SmallModel();
  for (const json& type : json::parse(R"([
      {"id":"i32","name":"Int32","kind":"base","c":"int","cut":""},
      {"id":"f32","name":"Float32","kind":"base","c":"float","cut":""},
      {"id":"f64","name":"Float64","kind":"base","c":"double","cut":""},
      {"id":"i64","name":"Int64","kind":"integer64"},
      {"id":"u64","name":"UInt64","kind":"integer64","signed":false},
      {"id":"speed","name":"speed_t","kind":"derived","of":"i8"},
      {"id":"row","name":"row_t","kind":"array","of":"i8","length":3},
      {"id":"grid","name":"grid_t","kind":"array","of":"row","length":2}])"))
    model["types"].push_back(type);
  const json rows = HX_CaseTable("initial_values.json");
  const auto nameOf = [](std::size_t row) { return "v" + std::to_string(row); };
  for (std::size_t i = 0; i < rows.size(); ++i) {
    json variable = rows[i]["variable"];
    variable.update(
        {{"id", nameOf(i)}, {"template", nameOf(i)}, {"kind", "variable"}});
    model["names"].push_back(variable);
  }
  const fs::path out = HX_ScratchFolder() / "out";
  const HX_ProgramResult result = generate(HX_WriteModel(model), out);
  EXPECT_EQ(0, result.code) << result.err;
  expectCompiles(out, "small.c");
  const std::string code = HX_ReadText(out / "small.c");
  for (std::size_t i = 0; i < rows.size(); ++i) {
    SCOPED_TRACE(rows[i]["why"]);
    std::string line = "\n" + rows[i]["code"].get<std::string>() + "\n";
    EXPECT_THAT(code, HasSubstr(line.replace(line.find('@'), 1, nameOf(i))));
    const std::string remark = " of " + nameOf(i) + " does not fit the type";
    EXPECT_EQ(rows[i]["saturated"],
              result.err.find(remark) != std::string::npos);
  }
}

TEST(GenerateTest, CommentsSurviveEverySource) {
  json model = HX_SmallModel();
  model["blocks"][0]["name"] =
      "a*/b/*c?"
      "?/\n\\ \xC3\xA4 \xF0\x9F\x9A\x97";
  model["names"].push_back({{"id", "v"},
                            {"template", "v"},
                            {"kind", "variable"},
                            {"source", "gain"},
                            {"type", "i8"}});
  const fs::path out = HX_ScratchFolder() / "out";
  EXPECT_EQ(0, generate(HX_WriteModel(model), out).code);
  expectCompiles(out, "small.c");
  EXPECT_THAT(HX_ReadText(out / "small.c"),
              HasSubstr("/* a* /b/ *c? ?/ \\ \xC3\xA4 \xF0\x9F\x9A\x97 */"));
}

TEST(GenerateTest, SyntheticModelsAreTheSameForTheSameSeed) {
  const fs::path folder = HX_ScratchFolder();
  const HX_ProgramResult first = HX_RunCodegen("synthesize --blocks 300");
  EXPECT_EQ(first.out, HX_RunCodegen("synthesize --blocks 300 --seed 1").out);
  EXPECT_NE(first.out, HX_RunCodegen("synthesize --blocks 300 --seed 2").out);
  HX_WriteText(folder / "large.json", first.out);
  const HX_ProgramResult result =
      generate((folder / "large.json").string(), folder / "out");
  EXPECT_EQ(0, result.code) << result.err;
  EXPECT_THAT(result.out, HasSubstr("300 names, 300 variables"));
  expectCompiles(folder / "out", "synthetic.c");
}

TEST(GenerateTest, ProfileTellsThePhasesOfTheRun) {
  const fs::path folder = HX_ScratchFolder() / "profile";
  const fs::path out = HX_ScratchFolder() / "out";
  EXPECT_EQ(0, HX_RunCodegen("generate " HX_DEMO_MODEL " --quiet --out " +
                             out.string() + " --profile " + folder.string())
                   .code);
  EXPECT_EQ(goldenFiles(), filesIn(out));
  for (const char* file : {"HX_StopWatch.html", "HX_DebugLog.txt"}) {
    const std::string text = HX_ReadText(folder / file);
    for (const char* phase : {"Read document", "Build model", "Order types",
                              "Form names", "Order variables", "Write C"})
      EXPECT_THAT(text, HasSubstr(phase)) << file;
  }
  EXPECT_THAT(HX_ReadText(folder / "HX_DebugProtocol.txt"),
              HasSubstr("143 names, 37 variables, 22 types"));
  EXPECT_THAT(HX_ReadText(folder / "HX_Transformations.txt"),
              HasSubstr("inline_gain: inline -> inline_a (keyword)"));
  const json trace = json::parse(HX_ReadText(folder / "HX_Trace.json"));
  std::vector<std::string> names;
  for (const json& event : trace["traceEvents"]) {
    EXPECT_EQ("X", event["ph"]);
    EXPECT_GE(event["ts"].get<double>(), 0);
    EXPECT_GE(event["dur"].get<double>(), 0);
    names.push_back(event["name"]);
  }
  EXPECT_THAT(names, ElementsAre("Read document", "Build model", "Order types",
                                 "Form names", "Order variables", "Write C"));
}

TEST(GenerateTest, VersionNamesTheProgram) {
  const HX_ProgramResult result = HX_RunCodegen("--version");
  EXPECT_EQ(0, result.code);
  EXPECT_THAT(result.out,
              testing::StartsWith("hx_codegen 1.0\nfile      1.0.0.0\n"));
}

}  // namespace
