// Model files in the hands of the program.
#include <array>
#include <cstdio>

#include "import/HX_ImportTest.h"

using testing::HasSubstr;
using testing::StartsWith;

namespace {

class ProgramTest : public HX_ImportTest {
 protected:
  // Both outputs in one text, in the folder of the test.
  std::string shell(const std::string& command) const {
    const std::string line = "cd " + m_Folder.string() + " && " + command;
    FILE* pipe = popen(("{ " + line + " ; } 2>&1").c_str(), "r");
    std::string text;
    std::array<char, 4096> part;
    while (const std::size_t size = fread(part.data(), 1, part.size(), pipe))
      text.append(part.data(), size);
    m_Code = WEXITSTATUS(pclose(pipe));
    return text;
  }
  std::string codegen(const std::string& arguments) const {
    return shell(HX_CODEGEN_COMMAND " " + arguments);
  }

  mutable int m_Code = 0;
};

TEST_F(ProgramTest, ModelFileStandsForItsDocument) {
  pack("climate.slx", partsOf("climate"));
  pack("climate_types.sldd", partsOf("climate_types"));
  const std::string quiet = " climate.slx --quiet";
  codegen("import" + quiet + " > climate.json");
  EXPECT_EQ(0, m_Code);
  EXPECT_EQ(codegen("names climate.json"), codegen("names" + quiet));
  EXPECT_EQ(codegen("names climate.json"),
            codegen("names --path . --dictionary climate_types.sldd" + quiet));
  EXPECT_THAT(codegen("names climate.slx"),
              HasSubstr("hx_codegen: 'Inherit: Same as input' takes the type "
                        "of the naming rule (Controller/Delay) [603]\n"));
  EXPECT_THAT(codegen("explain --name 14#out:1" + quiet),
              HasSubstr("template  $L\nrule      labelled signal\n"));
  EXPECT_EQ("", codegen("generate --out code --profile times" + quiet));
  EXPECT_EQ("", shell("cc -std=c90 -pedantic-errors -Wall -c code/*.c"));
}

TEST_F(ProgramTest, SampleModelCompiles) {
  EXPECT_THAT(codegen("generate " HX_SAMPLE_MODEL " --out code"),
              HasSubstr(" variables; 5 files written to code\n"));
  EXPECT_EQ("", shell("cc -std=c90 -pedantic-errors -Wall -c code/*.c"));
}

TEST_F(ProgramTest, RulesArePrinted) {
  write(m_Folder / "r.json", codegen("rules"));
  pack("m.slx", modelWith("<Block BlockType='Gain' Name='G' SID='1'/>"));
  EXPECT_EQ(codegen("import m.slx"), codegen("import m.slx --rules r.json"));
  EXPECT_EQ(0, m_Code);
  EXPECT_THAT(codegen("rules --schema"), HasSubstr("\"definitions\""));
}

TEST_F(ProgramTest, RefusalsAreOneLine) {
  write(m_Folder / "old.mdl", "Model {\n}");
  pack("m.slx", {{"simulink/blockdiagram.xml", "<a>"}});
  EXPECT_THAT(codegen("names old.mdl"),
              StartsWith("hx_codegen: old.mdl: the text form of models"));
  EXPECT_EQ(2, m_Code);
  EXPECT_EQ(
      "hx_codegen: m.slx: simulink/blockdiagram.xml:1:3: expected "
      "well-formed XML: Start-end tags mismatch [601]\n",
      codegen("generate m.slx --out code"));
  EXPECT_EQ(2, m_Code);
}

// All items want one name. Who gets the name follows from the paths.
TEST_F(ProgramTest, NamesAreFormedPathByPath) {
  write(m_Folder / "r.json",
        R"({"rules": [{"name": "r", "for": "state", "template": "v"}]})");
  const auto block = [](const char* name, const char* sid,
                        const std::string& inner = "") {
    return std::string("<Block BlockType='B' Name='") + name + "' SID='" + sid +
           "'>" + inner + "</Block>";
  };
  pack("m.slx",
       modelWith(block("Gain10", "1") + block("Gain2", "10") +
                 block("A b", "3") +
                 block("A", "11", "<System>" + block("x", "2") + "</System>") +
                 block("Gain2", "9")));
  const std::string map = codegen("names --json m.slx --rules r.json");
  const std::pair<const char*, const char*> rows[] = {
      {"11", "v"},  {"2", "v_a"},  {"3", "v_b"},
      {"9", "v_c"}, {"10", "v_d"}, {"1", "v_e"}};
  for (const auto& [sid, name] : rows) {
    const std::size_t at = map.find("\"" + std::string(sid) + "#state\"");
    ASSERT_NE(std::string::npos, at) << map;
    const std::size_t actual = map.find("\"actual\": ", at);
    EXPECT_EQ("\"actual\": \"" + std::string(name) + "\"",
              map.substr(actual, map.find(',', actual) - actual));
  }
  EXPECT_THAT(map, HasSubstr("taken by m/A ('11#state')"));
}

}  // namespace
