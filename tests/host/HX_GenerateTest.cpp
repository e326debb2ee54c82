// The C code that the program writes.
#include <algorithm>

#include "host/HX_HostTest.h"

namespace fs = std::filesystem;
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
  const Files files = filesIn(m_Out);
  expectGolden("cruise_control", files);

  // Files that do not change are not touched.
  const auto old = fs::file_time_type::clock::now() - std::chrono::hours(1);
  fs::last_write_time(m_Out / "cruise_control.c", old);
  write(m_Out / "cruise_control.h", "changed by hand");
  reverseLists(model);
  EXPECT_THAT(generate(save(model)).out, HasSubstr("; 1 files written"));
  EXPECT_EQ(files, filesIn(m_Out));
  EXPECT_EQ(old, fs::last_write_time(m_Out / "cruise_control.c"));
}

// The ids tell what each variable is for.
TEST_F(GenerateTest, ValuesCommentsAndNameMapAreTheGoldenCopies) {
  const Result result =
      generateValid(smallModel({{"names", parsed("initial_values.json")}}));
  Files files = filesIn(m_Out);
  expectGolden("initial_values", {{"small.c", files["small.c"]},
                                  {"name_map.csv", files["name_map.csv"]},
                                  {"messages.txt", result.err}});
}

// Every option of the code, and a model name that begins with '_'.
TEST_F(GenerateTest, CodeOptionsGiveTheGoldenCopies) {
  generateValid(parsed("code_options.json"));
  Files files = filesIn(m_Out);
  const std::string sum =
      shell("sha256sum " + (m_Folder / "model.json").string()).out;
  const std::string banner = "document SHA-256 ";
  for (auto& [name, text] : files) {
    if (name.starts_with("name_map")) continue;
    const std::size_t at = text.find(banner) + banner.size();
    EXPECT_EQ(sum.substr(0, 64), text.substr(at, 64)) << name;
    text.replace(at, 64, "SUM");
  }
  files.erase("name_map.json");
  expectGolden("code_options", files);
}

// Texts whose ends lie on both sides of a block of the sum.
TEST_F(GenerateTest, BannerHasTheSumOfDocumentsOfAnyLength) {
  for (int blanks = 0; blanks < 130; blanks += 3) {
    const fs::path model = m_Folder / "model.json";
    write(model, R"({"model": {"name": "m"}, "names": [], )"
                 R"("options": {"code": {"banner": true}}})" +
                     std::string(static_cast<std::size_t>(blanks), ' '));
    EXPECT_EQ(0, generate(model).code);
    EXPECT_THAT(
        read(m_Out / "m.c"),
        HasSubstr(shell("sha256sum " + model.string()).out.substr(0, 64)));
  }
}

TEST_F(GenerateTest, SyntheticModelsAreTheSameForTheSameSeed) {
  const std::string first = codegen("synthesize --blocks 100").out;
  EXPECT_EQ(first, codegen("synthesize --blocks 100 --seed 1").out);
  EXPECT_NE(first, codegen("synthesize --blocks 100 --seed 2").out);
  EXPECT_THAT(generateValid(Json::parse(first)).out,
              HasSubstr("100 names, 100 variables"));
}

TEST_F(GenerateTest, ProfileTellsThePhasesOfTheRun) {
  const fs::path folder = m_Folder / "profile";
  const Result result =
      generate(HX_DEMO_MODEL " --quiet --profile " + folder.string());
  EXPECT_EQ(0, result.code);
  EXPECT_EQ("", result.out);
  expectGolden("cruise_control", filesIn(m_Out));
  Files reports = filesIn(folder);
  EXPECT_THAT(reports["HX_DebugProtocol.txt"],
              HasSubstr("143 names, 37 variables, 22 types"));
  EXPECT_THAT(reports["HX_Transformations.txt"],
              HasSubstr("inline_gain: inline -> inline_a (keyword)"));
  std::string phases;
  const Json trace = Json::parse(reports["HX_Trace.json"]);
  for (const Json& event : trace["traceEvents"]) {
    const std::string phase = event["name"];
    phases += phase + '\n';
    EXPECT_EQ("X", event["ph"]);
    EXPECT_GE(event["ts"].get<double>(), 0);
    EXPECT_GE(event["dur"].get<double>(), 0);
    EXPECT_THAT(reports["HX_StopWatch.html"], HasSubstr(phase));
    EXPECT_THAT(reports["HX_DebugLog.txt"], HasSubstr(phase));
  }
  EXPECT_EQ(
      "Read document\nBuild model\nOrder types\nForm names\n"
      "Order variables\nWrite C\n",
      phases);
}

}  // namespace
