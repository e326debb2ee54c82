// Documents that are refused: one line that tells file, place and expectation.
#include <gmock/gmock.h>

#include "host/HX_HostProgram.h"

namespace fs = std::filesystem;
using nlohmann::json;
using testing::HasSubstr;
using testing::StartsWith;

namespace {

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

// Paths of the patches (RFC 6902) count on the first entries of the demo: block
// 0 is the root, type 10 "Bool" is derived, type 14 an array, names 0 an isr,
// 10 a variable.
TEST(BadDocumentTest, OneLineTellsPlaceAndExpectation) {
  const json demo = HX_DemoModel();
  const fs::path model = HX_ScratchFolder() / "bad.json";
  for (const json& row : HX_CaseTable("bad_documents.json")) {
    SCOPED_TRACE(row["why"]);
    HX_WriteText(model, demo.patch(json::array({row["patch"]})).dump());
    expectRefused(model, ": " + row["message"].get<std::string>());
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
