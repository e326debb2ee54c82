// Documents that are refused: one line that tells file, place and expectation.
#include <gmock/gmock.h>

#include "host/HX_HostProgram.h"

namespace fs = std::filesystem;
using testing::HasSubstr;
using testing::StartsWith;

namespace {

struct BadDocumentCase {
  const char* why;
  const char* patch;  // JSON patch (RFC 6902) of the demo model
  const char* place;
  const char* expected;
};

// Paths of the patches count on the first entries of the demo: block 0 is the
// root, type 10 "Bool" is derived, type 14 an array, names 0 an isr, 10 a
// variable.
const BadDocumentCase kBadDocuments[] = {
    {"a field is missing", R"([{"op":"remove","path":"/model/name"}])",
     "/model", R"(a field "name")"},
    {"no names at all", R"([{"op":"remove","path":"/names"}])", "/",
     R"(a field "names")"},
    {"a misspelt field",
     R"([{"op":"move","from":"/names/3/template","path":"/names/3/tempalte"}])",
     "/names/3/tempalte", "one of the fields"},
    {"text for a number",
     R"([{"op":"replace","path":"/names/0/period","value":"0.002"}])",
     "/names/0/period", "a number"},
    {"fraction for a count",
     R"([{"op":"replace","path":"/types/14/length","value":1.5}])",
     "/types/14/length", "a whole number"},
    {"no such kind",
     R"([{"op":"replace","path":"/names/0/kind","value":"interrupt"}])",
     "/names/0/kind", R"(one of "variable", "function")"},
    {"negative period",
     R"([{"op":"replace","path":"/names/0/period","value":-0.002}])",
     "/names/0/period", "a number from 0"},
    {"step of size 0", R"([{"op":"replace","path":"/names/10/lsb","value":0}])",
     "/names/10/lsb", "a number above 0"},
    {"array without elements",
     R"([{"op":"replace","path":"/types/14/length","value":0}])",
     "/types/14/length", "a number from 1"},
    {"a kind that needs more", R"([{"op":"remove","path":"/types/14/length"}])",
     "/types/14", R"(a field "length")"},
    {"variable without type", R"([{"op":"remove","path":"/names/10/type"}])",
     "/names/10", R"(a field "type")"},
    {"type name is no C name",
     R"([{"op":"replace","path":"/types/0/name","value":"Int-8"}])",
     "/types/0/name", "a text of the form"},
    {"dictionary path outside",
     R"([{"op":"replace","path":"/dataDictionary/objects/0/path","value":"x"}])",
     "/dataDictionary/objects/0/path", "a text of the form //DD0/.+"},
    {"empty id", R"([{"op":"replace","path":"/blocks/0/id","value":""}])",
     "/blocks/0/id", "a text with a length from 1"},
    {"block ids repeat",
     R"([{"op":"replace","path":"/blocks/0/blocks/1/id","value":"plant"}])",
     "/blocks/0/blocks/1/id", R"(an id that is not taken yet, found "plant")"},
    {"blocks and dictionary share ids",
     R"([{"op":"replace","path":"/dataDictionary/objects/0/id","value":"kp"}])",
     "/dataDictionary/objects/0/id", "an id that is not taken yet"},
    {"name ids repeat",
     R"([{"op":"replace","path":"/names/1/id","value":"isr_crank"}])",
     "/names/1/id", "an id that is not taken yet"},
    {"type names repeat",
     R"([{"op":"replace","path":"/types/0/name","value":"Int16"}])",
     "/types/2/name", R"(a name that is not taken yet, found "Int16")"},
    {"unknown source",
     R"([{"op":"replace","path":"/names/0/source","value":"nowhere"}])",
     "/names/0/source", R"(the id of a block, a chart object)"},
    {"a block for a dictionary object",
     R"([{"op":"replace","path":"/names/10/dd","value":"kp"}])", "/names/10/dd",
     "the id of a dictionary object"},
    {"unknown type",
     R"([{"op":"replace","path":"/names/10/type","value":"q"}])",
     "/names/10/type", R"(the id of a type, found "q")"},
    {"nameless type",
     R"([{"op":"replace","path":"/names/10/type","value":"anon"}])",
     "/names/10/type", "the id of a type with a name"},
    {"derived from what has no cut",
     R"([{"op":"replace","path":"/types/10/of","value":"mode"}])",
     "/types/10/of", "the id of a type with a cut"},
    {"unknown scope",
     R"([{"op":"add","path":"/names/10/scope","value":"body"}])",
     "/names/10/scope", "the id of a scope"},
    {"variable in a flat scope",
     R"([{"op":"add","path":"/names/10/scope","value":"os"}])",
     "/names/10/scope", "the id of a scope that is not flat"},
    {"two file scopes",
     R"([{"op":"replace","path":"/scopes/1/kind","value":"file"}])",
     "/scopes/1/kind", "one file scope"},
    {"block outside a function",
     R"([{"op":"replace","path":"/scopes/1/kind","value":"block"}])",
     "/scopes/1/kind", "a scope of this kind only in function"},
    {"body of a variable",
     R"([{"op":"replace","path":"/scopes/0/scopes/0/function","value":"error"}])",
     "/scopes/0/scopes/0/function", "the id of a function, task or isr"},
    {"an isr for a task",
     R"([{"op":"add","path":"/names/10/task","value":"isr_crank"}])",
     "/names/10/task", "the id of another name of kind task"},
    {"depends on a task",
     R"([{"op":"add","path":"/names/10/dependsOn","value":["task_10ms"]}])",
     "/names/10/dependsOn/0", "the id of a variable"},
    {"more values than elements",
     R"([{"op":"replace","path":"/names/10/initial","value":[1,2]}])",
     "/names/10/initial", "1 to 1 values"},
    {"no such word list",
     R"([{"op":"replace","path":"/options/keywords/0","value":"c89"}])",
     "/options/keywords/0", "the name of a word list in"},
};

// Nothing is printed or written.
void expectRefused(const fs::path& model, const std::string& message) {
  const fs::path out = HX_ScratchFolder() / "out";
  const HX_ProgramResult result =
      HX_RunCodegen("generate " + model.string() + " --out " + out.string());
  EXPECT_EQ(2, result.code);
  EXPECT_EQ("", result.out);
  EXPECT_THAT(result.err, StartsWith("hx_codegen: " + model.string() + ": "));
  EXPECT_THAT(result.err, HasSubstr(message));
  EXPECT_EQ(result.err.find('\n'), result.err.size() - 1) << result.err;
  EXPECT_FALSE(fs::exists(out));
}

TEST(BadDocumentTest, OneLineTellsPlaceAndExpectation) {
  const nlohmann::json demo = HX_DemoModel();
  const fs::path model = HX_ScratchFolder() / "bad.json";
  for (const BadDocumentCase& row : kBadDocuments) {
    SCOPED_TRACE(row.why);
    HX_WriteText(model, demo.patch(nlohmann::json::parse(row.patch)).dump());
    expectRefused(model,
                  std::string(": ") + row.place + ": expected " + row.expected);
  }
}

TEST(BadDocumentTest, TextThatIsNoJsonTellsLineAndColumn) {
  const fs::path model = HX_ScratchFolder() / "bad.json";
  const struct {
    const char* text;
    const char* message;
  } kRows[] = {
      {"", "line 1, column 1: expected well-formed JSON"},
      {"{\n  \"model\": {,}\n}",
       "line 2, column 13: expected well-formed JSON"},
      {"{\"model\": \"\xFF\"}", "line 1, column 12: expected well-formed JSON"},
      {"{\"model\": 1e999}", "expected numbers in the range of double"},
      {"[]", "/: expected an object"},
  };
  for (const auto& row : kRows) {
    SCOPED_TRACE(row.text);
    HX_WriteText(model, row.text);
    expectRefused(model, row.message);
  }
}

TEST(BadDocumentTest, FileThatCannotBeReadIsNamed) {
  expectRefused(HX_ScratchFolder() / "missing.json", "expected a file");
  expectRefused(HX_ScratchFolder(), "expected a file");  // a folder
}

TEST(BadDocumentTest, WrongCommandLinesAreRefused) {
  for (const char* arguments :
       {"", "names", "explain " HX_DEMO_MODEL, "generate " HX_DEMO_MODEL,
        "names " HX_DEMO_MODEL " --wrong",
        "explain " HX_DEMO_MODEL " --name nobody", "synthesize --blocks -1"}) {
    SCOPED_TRACE(arguments);
    const HX_ProgramResult result = HX_RunCodegen(arguments);
    EXPECT_EQ(2, result.code);
    EXPECT_EQ("", result.out);
    EXPECT_NE("", result.err);
  }
}

}  // namespace
