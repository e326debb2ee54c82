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

// The files of a folder by name.
std::map<std::string, std::string> filesIn(const fs::path& folder) {
  std::map<std::string, std::string> files;
  for (const auto& entry : fs::directory_iterator(folder))
    files[entry.path().filename()] =
        entry.is_directory() ? "a folder" : HX_ReadText(entry.path());
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
  const fs::path golden = HX_GOLDEN_FOLDER;
  if (std::getenv("HX_RENEW_GOLDEN") != nullptr) {
    fs::remove_all(golden);
    ASSERT_EQ(0, generate(HX_DEMO_MODEL, golden).code);
  }
  const fs::path out = HX_ScratchFolder() / "out";
  const HX_ProgramResult result = generate(HX_DEMO_MODEL, out);
  EXPECT_EQ(0, result.code);
  EXPECT_EQ(filesIn(golden), filesIn(out));
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
  const fs::path path = HX_ScratchFolder() / "reversed.json";
  HX_WriteText(path, model.dump());
  const fs::path out = HX_ScratchFolder() / "out";
  EXPECT_EQ(0, generate(path.string(), out).code);
  EXPECT_EQ(filesIn(HX_GOLDEN_FOLDER), filesIn(out));
}

TEST(GenerateTest, FilesThatDoNotChangeAreNotTouched) {
  const fs::path out = HX_ScratchFolder() / "out";
  ASSERT_EQ(0, generate(HX_DEMO_MODEL, out).code);
  const auto old = fs::file_time_type::clock::now() - std::chrono::hours(1);
  for (const auto& entry : fs::directory_iterator(out))
    fs::last_write_time(entry.path(), old);
  HX_WriteText(out / "cruise_control.h", "changed by hand");
  EXPECT_THAT(generate(HX_DEMO_MODEL, out).out, HasSubstr("; 1 files written"));
  EXPECT_EQ(filesIn(HX_GOLDEN_FOLDER), filesIn(out));
  EXPECT_EQ(old, fs::last_write_time(out / "cruise_control.c"));
}

TEST(GenerateTest, FailureLeavesTheFolderAsItWas) {
  const fs::path out = HX_ScratchFolder() / "out";
  fs::create_directories(out / "name_map.json");  // in the way of a file
  HX_WriteText(out / "cruise_control.h", "old");
  const auto before = filesIn(out);
  const HX_ProgramResult result = generate(HX_DEMO_MODEL, out);
  EXPECT_EQ(2, result.code);
  EXPECT_THAT(result.err, HasSubstr("name_map.json: cannot be written: Is a directory"));
  EXPECT_EQ(before, filesIn(out));
}

struct InitialCase {
  const char* why;
  const char* variable;  // fields beside id, template and kind
  const char* definition;
  bool isSaturated;
};

const InitialCase kInitials[] = {
    {"none", R"({"type":"i8"})", "Int8 v;", false},
    {"half goes away from zero", R"({"type":"i8","initial":-2.5})",
     "Int8 v = -3;", false},
    {"step and zero", R"({"type":"i8","initial":7,"lsb":0.5,"zero":2})",
     "Int8 v = 10;", false},
    {"largest", R"({"type":"i8","initial":127.4})", "Int8 v = 127;", false},
    {"above", R"({"type":"i8","initial":127.5})", "Int8 v = 127;", true},
    {"smallest", R"({"type":"i8","initial":-128})", "Int8 v = -128;", false},
    {"below", R"({"type":"i8","initial":-129})", "Int8 v = -128;", true},
    {"largest of 32 bits", R"({"type":"u32","initial":4294967295})",
     "UInt32 v = 4294967295U;", false},
    {"beyond every integer", R"({"type":"u32","initial":1e300})",
     "UInt32 v = 4294967295U;", true},
    {"quotient overflows", R"({"type":"u32","initial":-1e300,"lsb":1e-300})",
     "UInt32 v = 0U;", true},
    {"smallest of 32 bits", R"({"type":"i32","initial":-2147483648})",
     "Int32 v = (-2147483647 - 1);", false},
    {"64 bits, smallest", R"({"type":"i64","initial":-9223372036854775808})",
     "Int64 v = {0U, (-2147483647 - 1)};", false},
    {"64 bits, beyond", R"({"type":"i64","initial":1e19})",
     "Int64 v = {4294967295U, 2147483647};", true},
    {"64 bits, unsigned", R"({"type":"u64","initial":1e19})",
     "UInt64 v = {2313682944U, 2328306436U};", false},
    {"64 bits, -1", R"({"type":"i64","initial":-1})",
     "Int64 v = {4294967295U, -1};", false},
    {"float is nearest", R"({"type":"f32","initial":0.1})", "Float32 v = 0.1F;",
     false},
    {"float is no integer", R"({"type":"f32","initial":3})",
     "Float32 v = 3.0F;", false},
    {"float beyond", R"({"type":"f32","initial":1e39})",
     "Float32 v = 3.4028235e+38F;", true},
    {"double", R"({"type":"f64","initial":0.1})", "Float64 v = 0.1;", false},
    {"array, one value for all that has one",
     R"({"type":"row","initial":[1,-1]})", "row_t v = {1, -1};", false},
    {"array of arrays", R"({"type":"grid","initial":[1,2,3,4]})",
     "grid_t v = {{1, 2, 3}, {4}};", false},
    {"derived", R"({"type":"speed","initial":300})", "speed_t v = 127;", true},
};

TEST(GenerateTest, InitialValuesAreScaledRoundedAndSaturated) {
  json model = HX_SmallModel();
  for (
      const char* type :
      {R"({"id":"i32","name":"Int32","kind":"base","c":"int","cut":""})",
       R"({"id":"f32","name":"Float32","kind":"base","c":"float","cut":""})",
       R"({"id":"f64","name":"Float64","kind":"base","c":"double","cut":""})",
       R"({"id":"i64","name":"Int64","kind":"integer64"})",
       R"({"id":"u64","name":"UInt64","kind":"integer64","signed":false})",
       R"({"id":"speed","name":"speed_t","kind":"derived","of":"i8"})",
       R"({"id":"row","name":"row_t","kind":"array","of":"i8","length":3})",
       R"({"id":"grid","name":"grid_t","kind":"array","of":"row","length":2})"})
    model["types"].push_back(json::parse(type));
  const fs::path path = HX_ScratchFolder() / "model.json";
  const fs::path out = HX_ScratchFolder() / "out";
  for (const InitialCase& row : kInitials) {
    SCOPED_TRACE(row.why);
    json variable = json::parse(row.variable);
    variable.update({{"id", "v"}, {"template", "v"}, {"kind", "variable"}});
    model["names"] = json::array({variable});
    HX_WriteText(path, model.dump());
    const HX_ProgramResult result = generate(path.string(), out);
    EXPECT_EQ(0, result.code) << result.err;
    EXPECT_THAT(HX_ReadText(out / "small.c"),
                HasSubstr(std::string("\n") + row.definition + "\n"));
    EXPECT_EQ(row.isSaturated,
              result.err.find("does not fit the type") != std::string::npos)
        << result.err;
  }
  expectCompiles(out, "small.c");
}

TEST(GenerateTest, CommentsSurviveEverySource) {
  json model = HX_SmallModel();
  model["blocks"][0]["name"] =
      "a*/b/*c?"
      "?/\n\\ \xC3\xA4 \xF0\x9F\x9A\x97";
  model["names"] = json::array({{{"id", "v"},
                                 {"template", "v"},
                                 {"kind", "variable"},
                                 {"source", "gain"},
                                 {"type", "i8"}}});
  const fs::path path = HX_ScratchFolder() / "model.json";
  HX_WriteText(path, model.dump());
  const fs::path out = HX_ScratchFolder() / "out";
  EXPECT_EQ(0, generate(path.string(), out).code);
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
  EXPECT_EQ(filesIn(HX_GOLDEN_FOLDER), filesIn(out));
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
