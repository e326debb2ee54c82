// Names that stay from run to run, comparison of names, reserved words and
// patterns of documents, as a user sees them.
#include <algorithm>
#include <string>
#include <vector>

#include "host/HX_HostTest.h"

namespace fs = std::filesystem;
using testing::HasSubstr;

namespace {

class HostSafeNamesTest : public HX_HostTest {
 protected:
  Result generateLocked(const Json& model, const std::string& options = "") {
    return codegen("generate " + save(model) + " --out " + m_Out.string() +
                   " --lock " + m_Lock.string() + " " + options);
  }
  std::map<std::string, std::string> names() const {
    std::map<std::string, std::string> all;
    const Json map = parsed(m_Out / "name_map.json");
    for (const Json& name : map["names"]) all[name["id"]] = name["actual"];
    return all;
  }
  static Json variable(const std::string& id, const std::string& form) {
    return {{"id", id}, {"template", form}};
  }
  static Json modelOf(const std::vector<Json>& names,
                      const Json& options = Json::object()) {
    return {{"model", {{"name", "m"}, {"systemId", "a"}}},
            {"options", options},
            {"names", names}};
  }

  const fs::path m_Lock = m_Folder / "names.lock";
};

TEST_F(HostSafeNamesTest, ChangesOfTheDemoRenameNoOtherName) {
  Json model = parsed(HX_DEMO_MODEL);
  ASSERT_EQ(0, generateLocked(model).code);
  const auto before = names();
  const std::string lock = read(m_Lock);
  ASSERT_EQ(0, generateLocked(model).code);
  EXPECT_EQ(lock, read(m_Lock));

  // New items in front share the templates with all old items.
  Json& list = model["names"];
  std::reverse(list.begin(), list.end());
  for (int i = 0; i < 100; ++i) {
    Json added = variable("000" + std::to_string(i), "speed");
    const Json& old = list[static_cast<std::size_t>(i)];
    if (old.contains("kind") && old["kind"] != "variable") continue;
    for (const char* field : {"template", "source", "dd", "scope", "label"})
      if (old.contains(field)) added[field] = old[field];
    list.insert(list.begin(), added);
  }
  const Result result = generateLocked(model);
  ASSERT_EQ(0, result.code) << result.err;
  const auto after = names();
  EXPECT_LT(before.size() + 50, after.size());
  for (const auto& [id, name] : before) EXPECT_EQ(name, after.at(id)) << id;
}

TEST_F(HostSafeNamesTest, LockedRefusesNewAndChangedNames) {
  ASSERT_EQ(
      0,
      generateLocked(modelOf({variable("a", "x"), variable("b", "y")})).code);
  const std::string lock = read(m_Lock);
  const Files files = filesIn(m_Out);
  const Json changed =
      modelOf({variable("a", "z"), variable("b", "y"), variable("c", "y")});
  const Result refused = generateLocked(changed, "--locked");
  EXPECT_EQ(1, refused.code);
  const std::string text = "The lock has another name or none: ";
  EXPECT_EQ("a: error   421    " + text + "renamed to z\n" +
                "c: error   421    " + text + "new, y_a\n",
            refused.err);
  EXPECT_EQ(lock, read(m_Lock));
  EXPECT_EQ(files, filesIn(m_Out));
  EXPECT_EQ(0, generateLocked(modelOf({variable("b", "y")}), "--locked").code);
  EXPECT_EQ(lock, read(m_Lock));
}

TEST_F(HostSafeNamesTest, NamesOfItemsThatWentAreFreeAfterRunsOrPruning) {
  const Json first = modelOf({variable("a", "x"), variable("b", "y")});
  const Json second = modelOf({variable("b", "y"), variable("c", "x")});
  ASSERT_EQ(0, generateLocked(first).code);
  ASSERT_EQ(0, generateLocked(second).code);
  EXPECT_EQ("x_a", names()["c"]);
  ASSERT_EQ(0, codegen("lock prune " + m_Lock.string()).code);
  EXPECT_EQ("hx_names_lock 1\nb\ty\ty\tfile\te\t-\nc\tx_a\tx\tfile\te\t-\n",
            read(m_Lock));
  ASSERT_EQ(0,
            generateLocked(modelOf({variable("d", "x")}), "--retire 1").code);
  EXPECT_EQ("x", names()["d"]);
  ASSERT_EQ(0,
            generateLocked(modelOf({variable("d", "x")}), "--retire 1").code);
  EXPECT_EQ("hx_names_lock 1\nd\tx\tx\tfile\te\t-\n", read(m_Lock));
}

TEST_F(HostSafeNamesTest, RefusesADamagedLockWithItsLines) {
  const Json model = modelOf({variable("a", "x")});
  ASSERT_EQ(0, generateLocked(model).code);
  const Files files = filesIn(m_Out);
  write(m_Lock, read(m_Lock) + "<<<<<<< HEAD\na\tx\tx\tfile\te\t-\n");
  const Result refused = generateLocked(model);
  EXPECT_EQ(2, refused.code);
  const std::string place = m_Lock.string() + ":";
  EXPECT_EQ(place + "3: conflict marker of a merge: '<<<<<<< HEAD'\n" + place +
                "4: the item 'a' stands in line 2 already\n" + place +
                "4: the name 'x' of scope 'file' stands in line 2 already\n",
            refused.err);
  EXPECT_EQ(files, filesIn(m_Out));
  fs::remove(m_Lock);
  EXPECT_EQ(2, generateLocked(model, "--locked").code);
  fs::create_directory(m_Lock);
  EXPECT_EQ(2, generateLocked(model).code);
}

TEST_F(HostSafeNamesTest, DiffTellsReasonsAndGivesAScriptForSed) {
  // x is free for b once a is gone; c and d exchange their templates.
  const Json before = modelOf({variable("a", "x"), variable("b", "x"),
                               variable("c", "v"), variable("d", "w")});
  const Json after = modelOf({variable("b", "x"), variable("c", "w"),
                              variable("d", "v"), variable("e", "fresh")});
  ASSERT_EQ(0, generateLocked(before).code);
  const fs::path oldMap = m_Folder / "old_map.json";
  const fs::path oldLock = m_Folder / "old.lock";
  const fs::path oldModel = m_Folder / "old.json";
  fs::copy(m_Out / "name_map.json", oldMap);
  fs::copy(m_Lock, oldLock);
  write(oldModel, before.dump());
  fs::remove(m_Lock);
  ASSERT_EQ(0, generateLocked(after).code);
  const std::string newModel = save(after);
  const std::string newMap = (m_Out / "name_map.json").string();
  const std::string documents =
      "removed  a  x\n"
      "renamed  b  x_a -> x  (no longer taken by 'a')\n"
      "renamed  c  v -> w  (template v -> w)\n"
      "renamed  d  w -> v  (template w -> v)\n"
      "added  e  fresh\n"
      "0 kept, 1 added, 1 removed, 3 renamed\n";
  EXPECT_EQ(documents,
            codegen("diff " + oldModel.string() + " " + newModel).out);
  EXPECT_EQ(documents, codegen("diff " + oldMap.string() + " " + newMap).out);
  EXPECT_EQ(
      "removed  a  x\n"
      "renamed  b  x_a -> x\n"
      "renamed  c  v -> w  (wanted v -> w)\n"
      "renamed  d  w -> v  (wanted w -> v)\n"
      "added  e  fresh\n"
      "0 kept, 1 added, 1 removed, 3 renamed\n",
      codegen("diff " + oldLock.string() + " " + m_Lock.string()).out);

  const Json json = Json::parse(
      codegen("diff --format json " + oldMap.string() + " " + newMap).out);
  EXPECT_EQ(5u, json["names"].size());
  EXPECT_EQ("renamed", json["names"][1]["change"]);
  EXPECT_EQ("x_a", json["names"][1]["old"]);
  EXPECT_EQ("x", json["names"][1]["new"]);

  write(m_Folder / "names.sed",
        codegen("diff --format sed " + oldMap.string() + " " + newMap).out);
  write(m_Folder / "code.c", "v = w + x_a * xx_a; /* v */\n");
  EXPECT_EQ("w = v + x * xx_a; /* w */\n",
            shell("sed -f " + (m_Folder / "names.sed").string() + " " +
                  (m_Folder / "code.c").string())
                .out);
  EXPECT_EQ(2, codegen("diff " + oldMap.string() + " missing").code);
}

TEST_F(HostSafeNamesTest, LintTellsMacrosLengthAndProblems) {
  Result result = codegen("lint '$S_$B'");
  EXPECT_EQ(0, result.code);
  EXPECT_EQ(
      "$S_$B\n"
      "  $S  S with subsystem id and number  [template]\n"
      "  $B  block name  [template]\n"
      "  longest name: no bound, 1 characters without values\n",
      result.out);
  result = codegen("lint --pattern str 'strx_$Q:$(Task)x' 'stra$R'");
  EXPECT_EQ(1, result.code);
  EXPECT_THAT(result.out,
              HasSubstr("  $Q  unknown\n"
                        "  $(Task)  name of the task, else of the interrupt "
                        "service routine  [task]\n"));
  EXPECT_THAT(result.out, HasSubstr("  error: 1203: The name macro '$Q' is"));
  EXPECT_THAT(result.out, HasSubstr("  warning: 1202: The name macro "
                                    "'$(Task)' is not supported unless"));
  EXPECT_THAT(result.out, HasSubstr("  warning: The actual name has no $R"));
  EXPECT_THAT(result.out,
              HasSubstr("  error: Every name matches the reserved pattern "
                        "'str'.\n"));
  const fs::path rules = m_Folder / "rules.json";
  write(rules, R"({"rules": [{"name": "a", "template": "$B"},
                             {"name": "b"}, {"template": "$Q"}]})");
  result = codegen("lint --json --rules " + rules.string());
  EXPECT_EQ(1, result.code);
  const Json json = Json::parse(result.out);
  ASSERT_EQ(2u, json["templates"].size());
  EXPECT_EQ(rules.string() + ": /rules/2/template",
            json["templates"][1]["place"]);
  EXPECT_EQ(1203, json["templates"][1]["problems"][0]["message"]);
  EXPECT_EQ(nullptr, json["templates"][0]["longest"]);
  EXPECT_EQ(2, codegen("lint --pattern st x").code);
  EXPECT_EQ(2, codegen("lint --rules missing.json").code);
}

TEST_F(HostSafeNamesTest, WordsPatternsAndSignificanceOfADocumentCount) {
  const fs::path own = m_Folder / "own";
  fs::create_directory(own);
  write(own / "main.txt", "\xEF\xBB\xBF# ours\r\n  mine # too\r\n\r\n");
  const Json model =
      modelOf({variable("a", "printf"), variable("b", "main"),
               variable("c", "mine"), variable("d", "strong"),
               variable("e", "engine_speed"), variable("f", "ENGINE_load")},
              {{"keywords", {"std_c11", "main"}},
               {"patterns", {"str"}},
               {"significant", {{"external", 6}, {"ignoreCase", true}}}});
  const std::string command = "generate " + save(model) + " --out " +
                              m_Out.string() + " --keywords " + own.string();
  ASSERT_EQ(0, codegen(command).code);
  const std::map<std::string, std::string> expected{
      {"a", "prin_a"},   {"b", "main_a"},       {"c", "mine_a"},
      {"d", "n_strong"}, {"e", "engine_speed"}, {"f", "ENGI_a"}};
  EXPECT_EQ(expected, names());

  // Further lists and patterns by options, and the place of the taken name.
  const Json again =
      modelOf({variable("a", "READY"),
               variable("b", "E9"),
               {{"id", "c"}, {"template", "engine:engine"}},
               {{"id", "d"}, {"template", "ENGINE_load:ENGINE_load"}}},
              {{"significant", {{"external", 6}, {"ignoreCase", true}}}});
  const std::string names = "names " + save(again);
  const Result more = codegen(names + " --reserved osek --pattern E");
  EXPECT_THAT(more.out, HasSubstr("READ_a"));
  EXPECT_THAT(more.out, HasSubstr("n_E9"));
  EXPECT_THAT(
      more.out,
      HasSubstr("The name 'ENGINE_load' is reserved by the pattern 'E'"));
  EXPECT_THAT(codegen(names).out,
              HasSubstr("is not distinct from 'engine' of 'c', and"));
  EXPECT_EQ(2, codegen(names + " --reserved osec").code);

  save(model);
  write(own / "main.txt", "mine\ntwo words\n");
  const Result refused = codegen(command);
  EXPECT_EQ(2, refused.code);
  EXPECT_EQ((own / "main.txt").string() +
                ":2:1: found \"two words\", expected a C name or a comment "
                "behind '#'\n",
            refused.err);
  fs::remove(own / "main.txt");
  fs::create_directory(own / "main.txt");
  EXPECT_THAT(codegen(command).err, HasSubstr("found \"main\", expected"));
}

}  // namespace
