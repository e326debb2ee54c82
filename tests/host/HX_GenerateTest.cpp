// The C code that the program writes.
#include <algorithm>

#include "host/HX_HostTest.h"

namespace fs = std::filesystem;
using testing::ElementsAreArray;
using testing::HasSubstr;

namespace {

class GenerateTest : public HX_HostTest {
 protected:
  // Reverses every list whose entries are independent of each other.
  static void reverseLists(Json& node) {
    for (auto& [key, value] : node.items()) {
      if (value.is_structured()) reverseLists(value);
      const bool isOrdered = key == "fields" || key == "values" ||
                             key == "initial" || key == "alsoFrom";
      if (value.is_array() && !isOrdered)
        std::reverse(value.begin(), value.end());
    }
  }
};

TEST_F(GenerateTest, DemoGivesTheGoldenCopyInAnyOrder) {
  Json model = parsed(HX_DEMO_MODEL);
  generateValid(model);
  expectGolden("cruise_control", filesIn(m_Out));

  fs::remove_all(m_Out);
  reverseLists(model);
  EXPECT_EQ(0, generate(save(model)).code);
  expectGolden("cruise_control", filesIn(m_Out));
}

TEST_F(GenerateTest, FilesThatDoNotChangeAreNotTouched) {
  ASSERT_EQ(0, generate(HX_DEMO_MODEL).code);
  const Files before = filesIn(m_Out);
  const auto old = fs::file_time_type::clock::now() - std::chrono::hours(1);
  for (const auto& entry : fs::directory_iterator(m_Out))
    fs::last_write_time(entry.path(), old);
  write(m_Out / "cruise_control.h", "changed by hand");
  EXPECT_THAT(generate(HX_DEMO_MODEL).out, HasSubstr("; 1 files written"));
  EXPECT_EQ(before, filesIn(m_Out));
  EXPECT_EQ(old, fs::last_write_time(m_Out / "cruise_control.c"));
}

TEST_F(GenerateTest, FailureLeavesTheFolderAsItWas) {
  fs::create_directories(m_Out / "name_map.json");  // in the way of a file
  write(m_Out / "cruise_control.h", "old");
  const Files before = filesIn(m_Out);
  const Result result = generate(HX_DEMO_MODEL);
  EXPECT_EQ(2, result.code);
  EXPECT_THAT(result.err,
              HasSubstr("name_map.json: cannot be written: Is a directory"));
  EXPECT_EQ(before, filesIn(m_Out));
}

// The ids tell what each variable is for.
TEST_F(GenerateTest, InitialValuesAreScaledRoundedAndSaturated) {
  const Result result =
      generateValid(smallModel({{"names", parsed("initial_values.json")}}));
  expectGolden("initial_values", {{"small.c", read(m_Out / "small.c")},
                                  {"messages.txt", result.err}});
}

TEST_F(GenerateTest, CommentsAndNameMapSurviveEverySource) {
  Json model = smallModel(Json::parse(R"({"names": [
      {"id": "v", "template": "v", "type": "i8", "kind": "variable",
       "source": "gain"}]})"));
  model["blocks"][0]["name"] = "a*/b/*c?\?/\n\\ \"\u00E4\", \U0001F697";
  generateValid(model);
  EXPECT_THAT(read(m_Out / "small.c"),
              HasSubstr("/* a* /b/ *c? ?/ \\ \"\u00E4\", \U0001F697 */"));
  EXPECT_THAT(
      read(m_Out / "name_map.csv"),
      HasSubstr(
          "\r\nv,v,v,v,,\"a*/b/*c?\?/ \\ \"\"\u00E4\"\", \U0001F697\"\r\n"));
}

TEST_F(GenerateTest, SyntheticModelsAreTheSameForTheSameSeed) {
  const std::string first = codegen("synthesize --blocks 300").out;
  EXPECT_EQ(first, codegen("synthesize --blocks 300 --seed 1").out);
  EXPECT_NE(first, codegen("synthesize --blocks 300 --seed 2").out);
  EXPECT_THAT(generateValid(Json::parse(first)).out,
              HasSubstr("300 names, 300 variables"));
}

TEST_F(GenerateTest, ProfileTellsThePhasesOfTheRun) {
  const std::vector<std::string> phases = {"Read document",   "Build model",
                                           "Order types",     "Form names",
                                           "Order variables", "Write C"};
  const fs::path folder = m_Folder / "profile";
  const Result result =
      generate(HX_DEMO_MODEL " --quiet --profile " + folder.string());
  EXPECT_EQ(0, result.code);
  EXPECT_EQ("", result.out);
  expectGolden("cruise_control", filesIn(m_Out));
  for (const std::string& phase : phases) {
    EXPECT_THAT(read(folder / "HX_StopWatch.html"), HasSubstr(phase));
    EXPECT_THAT(read(folder / "HX_DebugLog.txt"), HasSubstr(phase));
  }
  EXPECT_THAT(read(folder / "HX_DebugProtocol.txt"),
              HasSubstr("143 names, 37 variables, 22 types"));
  EXPECT_THAT(read(folder / "HX_Transformations.txt"),
              HasSubstr("inline_gain: inline -> inline_a (keyword)"));
  std::vector<std::string> names;
  const Json trace = Json::parse(read(folder / "HX_Trace.json"));
  for (const Json& event : trace["traceEvents"]) {
    EXPECT_EQ("X", event["ph"]);
    EXPECT_GE(event["ts"].get<double>(), 0);
    EXPECT_GE(event["dur"].get<double>(), 0);
    names.push_back(event["name"]);
  }
  EXPECT_THAT(names, ElementsAreArray(phases));
}

}  // namespace
