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

// A row has a text or patches the demo (RFC 6902), counting on its first
// entries: block 0 is the root, type 10 "Bool" is derived, type 14 an array,
// names 0 an isr, 10 a variable.
TEST_F(BadDocumentTest, OneLineTellsPlaceAndExpectation) {
  const Json demo = parsed(HX_DEMO_MODEL);
  const fs::path model = m_Folder / "model.json";
  for (const Json& row : parsed("bad_documents.json")) {
    SCOPED_TRACE(row["why"]);
    if (row.contains("text"))
      write(model, row["text"]);
    else
      save(demo.patch(Json::array({row["patch"]})));
    expectRefused(model, row["message"]);
  }
  write(model, "{\"model\": \"\xFF\"}");
  expectRefused(model, "line 1, column 12: expected well-formed JSON in UTF-8");
  expectRefused(m_Folder / "missing.json", "expected a file");
  expectRefused(m_Folder, "expected a file");  // a folder
}

}  // namespace
