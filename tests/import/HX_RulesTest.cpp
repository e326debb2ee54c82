// Naming rules: the file, the choice, and the names of a model by rules.
#include "host/import/HX_Rules.h"

#include "import/HX_ImportTest.h"

using testing::HasSubstr;

namespace {

class RulesTest : public HX_ImportTest {
 protected:
  std::string refusal(const std::string& text) {
    const auto file = m_Folder / "r.json";
    write(file, text);
    m_Request.rules = file;
    return importParts(modelWith("")).document;
  }
};

TEST_F(RulesTest, PathPatterns) {
  const struct {
    const char* pattern;
    const char* path;
    bool matches;
  } rows[] = {
      {"a/b", "a/b", true},
      {"a/b", "a/bc", false},
      {"a/b", "a", false},
      {"*", "abc", true},
      {"*", "a/b", false},
      {"a*c", "abbc", true},
      {"a*c", "ac", true},
      {"a*c", "a/c", false},
      {"**", "a/b/c", true},
      {"**", "", true},
      {"**/c", "a/b/c", true},
      {"**/c", "c", false},
      {"a/**/d", "a/b/c/d", true},
      {"a**d*", "a/d/b/dx", true},
      {"*/x*y", "a/xby", true},
      {"**x*y", "x/xaby", true},
      {"**x*z", "xa/yz", false},
      {"*a", "bababa", true},
      {"", "", true},
      {"", "a", false},
  };
  for (const auto& row : rows)
    EXPECT_EQ(row.matches, HX_MatchesPath(row.pattern, row.path))
        << row.pattern << " on " << row.path;
}

TEST_F(RulesTest, FaultsAreToldWithTheirPlace) {
  const std::string rule = R"("name": "r", "for": "signal")";
  const std::pair<std::string, std::string> rows[] = {
      {"{\n  x", "r.json:2:3: expected well-formed JSON: "},
      {"{}", R"(r.json: /: expected required ["rules"])"},
      {R"({"rules": [{"name": "r", "for": "line"}]})",
       R"(r.json: /rules/0/for: expected enum ["input","output",)"},
      {R"({"rules": [{"name": "r"}]})", "r.json: /rules/0: expected required "},
      {"{\"rules\": [{" + rule + R"(, "from_": "$B"}]})",
       "r.json: /rules/0/from_: expected one of the fields name, for, "
       "blockTypes, "},
      {"{\"rules\": [{" + rule + R"(, "labelled": 1}]})",
       R"(r.json: /rules/0/labelled: expected type "boolean")"},
      {R"({"rules": [], "keywords": ["none"]})",
       "the word list 'none' of the naming rules is in no folder"},
  };
  for (const auto& [text, expected] : rows)
    EXPECT_THAT(refusal(text), HasSubstr(expected)) << text;
  m_Request.rules = m_Folder / "absent.json";
  EXPECT_EQ("absent.json: expected a file that can be read",
            importParts(modelWith("")).document);
}

// The first rule that fits counts, by each property of an item.
TEST_F(RulesTest, RulesChooseByEachProperty) {
  write(m_Folder / "r.json",
        R"({"systemId": "q", "limitNames": false, "rules": [
    {"name": "0", "for": "signal", "path": "S/**", "template": "path"},
    {"name": "1", "for": "signal", "blockTypes": ["Sum"]},
    {"name": "2", "for": "signal", "labelled": true, "template": "label"},
    {"name": "3", "for": "signal", "several": true, "template": "several"},
    {"name": "4", "for": "parameter", "variable": true, "parameters": ["P", "Q"], "template": "variable"},
    {"name": "5", "for": "parameter", "parameters": ["P"], "template": "P", "type": "int8", "scope": "function"},
    {"name": "6", "for": "chartData", "dataScopes": ["LOCAL_DATA"], "template": "local"},
    {"name": "7", "for": "function", "blockTypes": ["Model"], "template": "step"},
    {"name": "8", "for": "type", "path": "int8", "template": "my_$X_t"}
  ]})");
  m_Request.rules = m_Folder / "r.json";
  const auto block = [](const std::string& type, const std::string& sid,
                        const std::string& inner = "") {
    return "<Block BlockType='" + type + "' Name='" + type + "' SID='" + sid +
           "'>" + inner + "</Block>";
  };
  const auto line = [](const std::string& source,
                       const std::string& label = "") {
    return "<Line><P Name='Name'>" + label + "</P><P Name='Src'>" + source +
           "</P></Line>";
  };
  const std::string document =
      importParts(
          modelWith(
              block("S", "1",
                    "<System>" + block("Gain", "2") + line("2#out:1") +
                        "</System>") +
              block("Sum", "3") + block("Gain", "4") + block("Mux", "5") +
              block("F", "6",
                    "<P Name='P'>7</P><P Name='Q'>7</P><P Name='R'>K</P>") +
              block("G", "7", "<P Name='P'>K</P><P Name='Q'>K</P>") +
              line("3#out:1", "a") + line("4#out:1", "a") + line("5#out:1") +
              line("5#out:2")))
          .document;
  const std::string names = document.substr(document.find("\"names\""));
  const std::pair<const char*, const char*> found[] = {
      {"2#out:1", "path"},        {"4#out:1", "label"},
      {"5#out:1", "several"},     {"5#out:2", "several"},
      {"variable:K", "variable"}, {"6#P", "P"},
      {"root#function", "step"}};
  for (const auto& [id, form] : found)
    EXPECT_THAT(names, HasSubstr("\"id\": \"" + std::string(id) +
                                 "\",\n   \"template\": \"" + form + "\""));
  std::size_t count = 0;
  for (std::size_t at = names.find("\"template\""); at != std::string::npos;
       at = names.find("\"template\"", at + 1))
    ++count;
  EXPECT_EQ(std::size(found), count) << names;
  EXPECT_THAT(names,
              HasSubstr("\"type\": \"int8\",\n   \"scope\": \"body:root\""));
  EXPECT_THAT(document, HasSubstr("\"name\": \"my_int8_t\""));
  EXPECT_THAT(document, HasSubstr("\"systemId\": \"q\""));
  EXPECT_THAT(document, HasSubstr("\"limitNames\": false"));
}

}  // namespace
