// Documents that are refused: one line that tells file, place and expectation.
#include "host/HX_HostTest.h"

namespace fs = std::filesystem;
using testing::HasSubstr;
using testing::StartsWith;

namespace {

class BadDocumentTest : public HX_HostTest {
 protected:
  // Nothing is printed or written.
  void expectRefused(const fs::path& model, const std::string& message) {
    const Result result = generate(model);
    EXPECT_EQ(2, result.code);
    EXPECT_EQ("", result.out);
    EXPECT_THAT(result.err, StartsWith("hx_codegen: " + model.string() + ": "));
    EXPECT_THAT(result.err, HasSubstr(": " + message));
    EXPECT_EQ(result.err.find('\n'), result.err.size() - 1) << result.err;
    EXPECT_FALSE(fs::exists(m_Out));
  }
};

// Paths of the patches (RFC 6902) count on the first entries of the demo: block
// 0 is the root, type 10 "Bool" is derived, type 14 an array, names 0 an isr,
// 10 a variable.
TEST_F(BadDocumentTest, OneLineTellsPlaceAndExpectation) {
  const Json demo = parsed(HX_DEMO_MODEL);
  for (const Json& row : parsed("bad_documents.json")) {
    SCOPED_TRACE(row["why"]);
    expectRefused(save(demo.patch(Json::array({row["patch"]}))),
                  row["message"]);
  }
}

TEST_F(BadDocumentTest, TextThatIsNoJsonTellsLineAndColumn) {
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
    write(m_Folder / "bad.json", row.text);
    expectRefused(m_Folder / "bad.json", row.message);
  }
  expectRefused(m_Folder / "missing.json", "expected a file");
  expectRefused(m_Folder, "expected a file");  // a folder
}

}  // namespace
