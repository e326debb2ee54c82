// Refused documents: a line per fault, with file, place, finding and
// expectation.
#include <functional>

#include "host/HX_HostTest.h"

namespace fs = std::filesystem;
using testing::ElementsAre;
using testing::HasSubstr;

namespace {

class BadDocumentTest : public HX_HostTest {
 protected:
  using Lines = std::vector<std::string>;

  // The lines of a refusal; nothing is printed or written.
  Lines refusal(const fs::path& model, const std::string& limits = "") {
    const Result result = shell(limits + HX_CODEGEN_COMMAND " generate " +
                                model.string() + " --out " + m_Out.string());
    EXPECT_EQ(2, result.code);
    EXPECT_EQ("", result.out);
    EXPECT_FALSE(fs::exists(m_Out));
    return linesOf(result.err);
  }

  // Without the file, and without line and column of a patched document.
  static std::string shortened(std::string line, const std::string& file,
                               bool isPatched) {
    if (!line.starts_with(file + ":")) return "not in the file: " + line;
    line.erase(0, file.size() + 1);
    if (isPatched) line.erase(0, line.find(": ") + 2);
    return line;
  }
  const fs::path m_Model = m_Folder / "model.json";
};

// A row has a text or patches the demo (RFC 6902), counting on the first
// entries: block 0 is the root, type 10 "Bool" is derived, type 14 an array,
// names 0 an isr, 10 a variable. '*' ends the beginning of a message.
TEST_F(BadDocumentTest, EveryFaultIsALineWithPlaceAndExpectation) {
  const Json demo = parsed(HX_DEMO_MODEL);
  for (const Json& row : parsed("bad_documents.json")) {
    SCOPED_TRACE(row["why"]);
    const bool isPatched = row.contains("patch");
    if (isPatched)
      save(demo.patch(Json::array({row["patch"]})));
    else
      write(m_Model, row["text"]);
    Lines expected;
    if (row["message"].is_array())
      expected = row["message"];
    else
      expected = {row["message"]};
    Lines found = refusal(m_Model);
    for (std::size_t i = 0; i < found.size(); ++i) {
      found[i] = shortened(found[i], m_Model, isPatched);
      if (i >= expected.size() || !expected[i].ends_with('*')) continue;
      found[i] = found[i].substr(0, expected[i].size() - 1) + "*";
    }
    EXPECT_EQ(expected, found);
  }
}

TEST_F(BadDocumentTest, FilesThatCannotBeReadAreOneLine) {
  write(m_Model, "{\"model\": \"\xFF\"}");
  EXPECT_THAT(
      refusal(m_Model),
      ElementsAre(m_Model.string() + ":1:12: /model: found \"\", expected "
                                     "text in UTF-8"));
  for (const fs::path& path : {m_Folder / "missing.json", m_Folder})
    EXPECT_THAT(refusal(path),
                ElementsAre("hx_codegen: " + path.string() +
                            ": cannot be read: expected a file"));
}

std::string repeated(const std::string& text, int count) {
  std::string all;
  for (int i = 0; i < count; ++i) all += text;
  return all;
}

std::string nested(const std::string& before, const std::string& inside,
                   const std::string& after, int depth) {
  return repeated(before, depth) + inside + repeated(after, depth);
}

constexpr char kModel[] = R"({"model": {"name": "m"}, "names": [], )";

struct HostileCase {
  const char* why;
  std::function<std::string()> document;
  const char* message;
};

// Every row ended the program with a signal in the past.
const HostileCase kHostile[] = {
    {"text of 26400 characters for a pattern",
     [] {
       return std::string(kModel) +
              R"("types": [{"id": "a", "kind": "base", "c": "int", "cut": "",)"
              R"( "name": ")" +
              repeated("a", 26400) + "\"}]}";
     },
     "aaa...\", expected a text with a length up to 255"},
    {"blocks 5000 deep",
     [] {
       return std::string(kModel) + "\"blocks\": [" +
              nested(R"({"id": "b", "name": "b", "blocks": [)", "", "]}",
                     5000) +
              "]}";
     },
     "found lists and objects 201 deep, expected at most 200"},
    {"chart objects 5000 deep",
     [] {
       return std::string(kModel) +
              R"("blocks": [{"id": "b", "name": "b", "chart": {"number": 1,)"
              R"( "objects": [)" +
              nested(R"({"id": "o", "name": "o", "number": 1, "objects": [)",
                     "", "]}", 5000) +
              "]}}]}";
     },
     "found lists and objects 201 deep, expected at most 200"},
    {"scopes 5000 deep",
     [] {
       return std::string(kModel) + "\"scopes\": [" +
              nested(R"({"id": "s", "kind": "block", "scopes": [)", "", "]}",
                     5000) +
              "]}";
     },
     "found lists and objects 201 deep, expected at most 200"},
    {"a million open brackets", [] { return repeated("[", 1000000); },
     "/: found a list, expected an object"},
    {"60000 array types that stand on each other",
     [] {
       std::string types;
       for (int i = 0; i < 60000; ++i) {
         const std::string id = "t" + std::to_string(i);
         types += R"({"id": ")" + id + R"(", "name": ")" + id +
                  R"(", "kind": "array", "length": 1, "of": "t)" +
                  std::to_string(i + 1) + "\"},\n";
       }
       return std::string(kModel) + "\"types\": [" + types +
              R"({"id": "t60000", "name": "e", "kind": "base", "c": "int",)"
              R"( "cut": ""}]})";
     },
     "found 65 types that stand on each other, expected at most 64"},
    {"number of a megabyte",
     [] { return R"({"model": )" + repeated("1", 1000000) + "}"; },
     "expected a number in the range of double"},
    {"name of a megabyte",
     [] {
       return R"({"model": {"name": ")" + repeated("n", 1000000) +
              "\"}, \"names\": []}";
     },
     "/model/name: found \"nnn"},
};

TEST_F(BadDocumentTest, NoDocumentEndsTheProgramWithASignal) {
  for (const HostileCase& row : kHostile) {
    SCOPED_TRACE(row.why);
    write(m_Model, row.document());
    const Lines lines = refusal(m_Model, "ulimit -s 1024; ");
    EXPECT_GT(2000U, lines.at(0).size());
    EXPECT_THAT(lines.at(0), HasSubstr(row.message));
  }
}

TEST_F(BadDocumentTest, TwentyFaultsAreShownAndTheOthersCounted) {
  Json model{{"model", {{"name", "m"}}}, {"names", Json::array()}};
  for (int i = 0; i < 33; ++i) model["names"].push_back({{"id", i}});
  save(model);
  const Lines lines = refusal(m_Model);
  EXPECT_EQ(21U, lines.size());  // two faults in each name
  EXPECT_THAT(lines.at(19), HasSubstr(": /names/9/id: found 9, expected"));
  EXPECT_EQ("... and 46 more", lines.back());
}

struct WordListCase {
  const char* why;
  const char* text;     // null for a folder
  const char* message;  // null if "taken" is a word, see shortened()
};

const WordListCase kWordLists[] = {
    {"plain", "one\ntaken\n", nullptr},
    {"line ends of Windows", "one\r\ntaken\r\n", nullptr},
    {"blank lines and blanks", "\n  taken \t\n\n", nullptr},
    {"comments", "# taken words\ntaken # a word\n", nullptr},
    {"byte order mark", "\xEF\xBB\xBFtaken\n", nullptr},
    {"no line end", "taken", nullptr},
    {"two words on a line", "one\ntaken two\n",
     "2:1: found \"taken two\", expected a C name or a comment behind '#'"},
    {"no words", "# taken\n", "1:1: found no word, expected a C name"},
    {"folder", nullptr, ""},
};

TEST_F(BadDocumentTest, WordListsProtectOrAreRefused) {
  const Json model{{"model", {{"name", "m"}}},
                   {"options", {{"keywords", {"list"}}}},
                   {"names", {{{"id", "n"}, {"template", "taken"}}}}};
  const fs::path list = m_Folder / "list.txt";
  const std::string command =
      "names --json " + save(model) + " --keywords " + m_Folder.string();
  for (const WordListCase& row : kWordLists) {
    SCOPED_TRACE(row.why);
    if (row.text != nullptr) {
      write(list, row.text);
    } else {
      fs::remove(list);
      fs::create_directory(list);
    }
    const Result result = codegen(command);
    const std::string err =
        row.text != nullptr
            ? result.err
            : std::string(result.err).erase(0, result.err.find("found"));
    std::string expected;
    if (row.text == nullptr)
      expected = "found \"list\", expected the name of a word list in " +
                 m_Folder.string() + "\n";
    else if (row.message != nullptr)
      expected = list.string() + ":" + row.message + "\n";
    EXPECT_EQ(expected, err);
    EXPECT_EQ(
        row.message == nullptr ? 1 : 0,
        static_cast<int>(result.out.find("taken_a") != std::string::npos));
  }
}

}  // namespace
