#include "Naming/HX_MacroTable.h"

#include <cstdlib>
#include <fstream>
#include <iomanip>

#include "Naming/HX_NamingFixture.h"
#include "platform/model/HxCSymbol.h"

namespace {

class MacroTableTest : public HX_NamingFixture {
 protected:
  /// Compares a file of the project with \p text. With HX_RENEW_GOLDEN in the
  /// environment writes the file instead (script/macros).
  static void expectFile(const std::string& path, const std::string& text) {
    const std::string file = HX_ROOT_FOLDER "/" + path;
    if (std::getenv("HX_RENEW_GOLDEN") != nullptr) std::ofstream(file) << text;
    std::ostringstream found;
    found << std::ifstream(file).rdbuf();
    EXPECT_EQ(found.str(), text) << path << ": run script/macros";
  }

  /// The formal name of the template \p text after all stages, for the model
  /// of the examples.
  std::string afterAllStages(const std::string& text) {
    const HxCDdSrcRef variable(
        HX_DdTree::instance().add("//DD0/Pool/Variables/Kp"));
    const bool ofChart = text == "$H" || text == "$O" || text == "$C";
    Id id = identifier(text);
    if (ofChart) id.setSourceRef(event.getStateflowSrcRef());
    id.setDdSourceRef(&variable);
    id.setSignalLabel("speed");
    id.setDollarXValue("ext");
    const HX_Macro* macro = HX_FindMacro(text.c_str());
    if (macro->stage == HX_Macro::eStageCaller)
      names.substAllDollarZByValue(id, macro->text + 1, Id("x"),
                                   HxCNames::eMacroKindExact);
    names.replaceMultirateTaskISRName(id, Id("fast task:"), Id("irq-1:"),
                                      false);
    names.replaceMultirateMsgName(id, Id("msg"));
    names.replaceMultirateCtrName(id, Id("ctr"));
    names.replaceMultirateEventName(id, Id("evt"));
    names.replaceMultirateMsgVarName(id, "#7;");
    names.replaceMultirateObjName(id, Id("obj"));
    names.replaceMultirateTimeName(id, 0.01, 0.005, true);
    const bool isFunction = text == "$f" || text == "$F";
    HxCSymbol symbol(isFunction ? "step" : "speed",
                     isFunction ? HxCSymbol::eFunction : HxCSymbol::eVariable,
                     type);
    symbol.setDollarX("ext");
    if (macro->stage == HX_Macro::eStageSymbol)
      names.handleSymbolNameMacro(id, &symbol);
    names.createNameFromForm(id, type, 0, 0, false);
    return id.getCookedName(Id::eFormalName).cstring();
  }
};

std::string bitText(unsigned int bit) {
  std::ostringstream text;
  if (bit != 0) text << "0x" << std::hex << std::uppercase << bit;
  return text.str();
}

std::string code(const std::string& text) {
  return text.empty() ? text : "`" + text + "`";
}

// Text for a manual page: hyphens stay hyphens, and no backquotes.
std::string manualText(const std::string& text) {
  std::string result;
  for (const char c : text) {
    if (c == '-') result += '\\';
    if (c != '`') result += c;
  }
  return result;
}

std::string manualRow(const HX_Macro& macro) {
  std::string row = std::string(".TP\n.B ") + macro.text + "\n" +
                    manualText(macro.meaning) + ".\n";
  if (*macro.example != 0)
    row += "Example: " + manualText(macro.example) + ".\n";
  if (*macro.placeholder != 0)
    row += std::string("Without a value: ") + macro.placeholder + ".\n";
  return row;
}

TEST_F(MacroTableTest, PageAndDictionaryShowTheTable) {
  const std::pair<const char*, const char*> stages[] = {
      {"Macros of the caller",
       "The caller puts the values in with "
       "`HxCNames::substAllDollarZByValue()`, before the expansion."},
      {"Macros of tasks and times",
       "The operations `HxCNames::replaceMultirate...()` put the values in, "
       "before the expansion."},
      {"Macros of the expansion",
       "`HxCNames::createNameFromForm()` puts the values in. A macro with a "
       "bit can be retained or marked provisional. With `$S`, `$C` or `$R` the "
       "name may change."},
      {"Macros of the symbol",
       "`HxCNames::handleSymbolNameMacro()` puts the values in. `$X` and `$T` "
       "count as `$x` and `$t`."}};
  const char* const origins[] = {"",     "model", "source", "dictionary object",
                                 "type", "task",  "symbol"};
  std::string page =
      "# Macros of name templates\n\n"
      "Written by `script/macros` from the macro table "
      "([HX_MacroTable.h](../src/Naming/HX_MacroTable.h)). Examples: block "
      "`Speed Gain` in subsystem `a3`, chart object `go#` with number 7 in a "
      "chart of subsystem `c`, period 10 ms with offset 5 ms, for fixed units "
      "two units with an offset of one unit.\n\n"
      "The expansion writes the text of the column \"without a value\" where "
      "the object is missing or an earlier stage left the macro in the "
      "name.\n";
  std::string manual =
      ".TH HX_TEMPLATES 7\n.SH NAME\nhx_templates \\- macros of name "
      "templates\n.SH DESCRIPTION\n"
      "A name template is text with macros. A template of two parts, "
      "\"formal:actual\", gives the two names apart.\n"
      "Examples: block \"Speed Gain\" in subsystem a3, chart object \"go#\" "
      "with number 7 in a chart of subsystem c, period 10 ms with offset 5 ms, "
      "for fixed units two units with an offset of one unit.\n";
  std::string dictionary =
      "# Macros of name templates, written by script/macros.\n";
  for (int stage = 0; stage < 4; ++stage) {
    page += std::string("\n## ") + stages[stage].first + "\n\n" +
            stages[stage].second +
            "\n\n| macro | value | from | example | without a value | bit |\n"
            "|---|---|---|---|---|---|\n";
    manual += std::string(".SS ") + stages[stage].first + "\n" +
              manualText(stages[stage].second) + "\n";
    for (const HX_Macro& macro : HX_Macros()) {
      if (macro.stage != stage) continue;
      manual += manualRow(macro);
      page += "| " + code(macro.text) + " | " + macro.meaning + " | " +
              origins[macro.origin] + " | " + code(macro.example) + " | " +
              code(macro.placeholder) + " | " + bitText(macro.bit) + " |\n";
      dictionary += std::string("\"") + macro.text + "\"\n";
    }
  }
  for (const char* part : {"$E(", "$(", ")", "'", ":"})
    dictionary += std::string("\"") + part + "\"\n";
  manual += ".SH SEE ALSO\n.BR hx_codegen (1)\n";
  expectFile("docs/templates.md", page);
  expectFile("docs/hx_templates.7", manual);
  expectFile("fuzz/names.dict", dictionary);
}

TEST_F(MacroTableTest, RowsSayWhatTheEngineDoes) {
  HX_DataType int16("Int16");
  int16.setCut("i16").setBase();
  HX_DdTree& tree = HX_DdTree::instance();
  const std::string engine = "/Pool/Autosar/SoftwareComponents/Engine";
  tree.add(engine, HX_DdTree::kSoftwareComponent);
  tree.addReference(tree.add(engine + "/RelatedVariables"), "P",
                    "Variables/Kp");
  for (const HX_Macro& macro : HX_Macros()) {
    const std::string text = macro.text;
    SCOPED_TRACE(text);
    EXPECT_EQ(HX_FindMacro(("$" + text).c_str(), 1), &macro);
    type = nullptr;
    GLB_SetModelName("");
    GLB_SetSubsystemName("");
    EXPECT_EQ(expand(text, nullptr),
              macro.placeholder + (text == "$(Component)" ? " 1209"
                                   : macro.message == 0
                                       ? ""
                                       : " " + std::to_string(macro.message)));
    EXPECT_EQ(expand(text, nullptr, ~0U) == text && !complete, macro.bit != 0);
    type = &int16;
    GLB_SetModelName("plant v2");
    GLB_SetSubsystemName("Ctrl");
    const bool hasUnit = text.find('1') != text.npos;  // random cases do
    if (hasUnit) continue;
    EXPECT_EQ(afterAllStages(text), macro.example);
  }
  for (const char* text : {"", "x", "$", "$(", "$(Task", "$(Time1)", "$Q"})
    EXPECT_EQ(HX_FindMacro(text), nullptr) << text;
}

}  // namespace
