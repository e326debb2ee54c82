// Models in any script, and the progress of long phases.
#include <set>

#include "host/HX_HostTest.h"

using testing::HasSubstr;

namespace {

class ScriptsTest : public HX_HostTest {};

struct ScriptCase {
  const char* name;    // of a block and a label
  const char* actual;  // with the template "$B"
};

// Names that would be empty or equal stay apart.
const ScriptCase kScripts[] = {
    {"Speed", "Speed"},
    {"Größe", "Grosse"},
    {"Größe°", "Grosse_"},
    {"Ångström œuvre", "Angstrom_oeuvre"},
    {"A\xCC\x88 combined", "A_combined"},
    {"ω_m", "omega_m"},
    {"скорость", "skorost_"},
    {"速度", "_u901F__u5EA6_"},
    {"速", "_u901F_"},
    {"🚗", "_u1F697_"},
    {"مرحبا", "_u0645__u0631__u062D__u0628__u0627_"},
    {"–", "__a"},
    {"—", "__b"},
    {"\xCC\x88", "_"},
};

TEST_F(ScriptsTest, NamesAreAsciiAndPathsKeepTheText) {
  Json model{{"model", {{"name", "模型"}}}};
  std::string expected;
  char id = 'a';
  for (const ScriptCase& row : kScripts) {
    const std::string number(1, id++);
    model["blocks"].push_back(
        {{"id", "b" + number},
         {"name", "车"},
         {"blocks", {{{"id", number}, {"name", row.name}}}}});
    model["names"].push_back(
        {{"id", number}, {"template", "$B"}, {"source", number}});
    expected += number + ": " + row.actual + " from 车/" + row.name + '\n';
  }
  // Names are formed in the order of the paths: the combining mark is first.
  std::string found;
  const Json names =
      Json::parse(codegen("names --json " + save(model)).out)["names"];
  for (const Json& name : names)
    found += name["id"].get<std::string>() + ": " +
             name["actual"].get<std::string>() + " from " +
             name["source"].get<std::string>() + '\n';
  EXPECT_EQ(expected, found);
}

TEST_F(ScriptsTest, CodeOfAForeignModelCompiles) {
  const Json model{{"model", {{"name", "模型"}}},
                   {"blocks", {{{"id", "b"}, {"name", "速度"}}}},
                   {"types",
                    {{{"id", "i"},
                      {"name", "Int"},
                      {"kind", "base"},
                      {"c", "int"},
                      {"cut", "短"}}}},
                   {"names",
                    {{{"id", "n"},
                      {"template", "前$B_$T$M"},
                      {"source", "b"},
                      {"kind", "variable"},
                      {"type", "i"}}}}};
  generateValid(model);
  const Files files = filesIn(m_Out);
  EXPECT_THAT(files.at("_u6A21__u578B_.c"),
              HasSubstr("/* 速度 */\nInt "
                        "_u524D__u901F__u5EA6___u77ED__u6A21__u578B_;"));
  EXPECT_THAT(files.at("name_map.csv"), HasSubstr(",前$B_$T$M,"));
}

TEST_F(ScriptsTest, MessagesShowEscapesForControlCharacters) {
  const Json model{
      {"model", {{"name", "m"}}},
      {"blocks", {{{"id", "b"}, {"name", "\x1B[31m"}}}},
      {"names", {{{"id", "n"}, {"template", "$Q"}, {"source", "b"}}}}};
  const Result result = codegen("names " + save(model));
  EXPECT_THAT(result.out, HasSubstr("\\u001b[31m"));
  EXPECT_EQ(result.out.npos, result.out.find('\x1B'));
}

// Every phase of 6000 names shows where it is.
TEST_F(ScriptsTest, EveryLongPhaseShowsProgress) {
  const std::string model = m_Folder / "model.json";
  write(model, codegen("synthesize --blocks 6000").out);
  const auto phasesOf = [&](const std::string& arguments) {
    const std::string shown =
        shell("script -qec '" HX_CODEGEN_COMMAND " " + arguments +
              " >/dev/null' /dev/null </dev/null")
            .out;
    std::set<std::string> phases;
    for (std::size_t at = shown.find('\r'); at != shown.npos;
         at = shown.find('\r', at + 1)) {
      const std::size_t end = shown.find_first_of(":.\r", at + 1);
      const std::string phase = shown.substr(at + 1, end - at - 1);
      if (phase.find_first_not_of(' ') != phase.npos) phases.insert(phase);
    }
    return phases;
  };
  EXPECT_EQ(
      (std::set<std::string>{"reading, bytes", "building the model", "names",
                             "ordering variables", "measuring the table",
                             "printing", "writing C"}),
      phasesOf("names " + model));
  EXPECT_EQ((std::set<std::string>{"reading, bytes", "building the model",
                                   "names", "ordering variables", "writing C",
                                   "writing the name map"}),
            phasesOf("generate " + model + " --out " + m_Out.string()));
}

}  // namespace
