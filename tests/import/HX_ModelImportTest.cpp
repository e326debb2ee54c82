// From a packed model to a document.
#include <algorithm>
#include <cstdlib>
#include <pugixml.hpp>
#include <sstream>

#include "import/HX_ImportTest.h"

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;

namespace {

class ModelImportTest : public HX_ImportTest {
 protected:
  void SetUp() override {
    pack("climate_types.sldd", partsOf("climate_types"));
  }
};

// HX_RENEW_GOLDEN=1 build/dev/tests/import/test_import writes the copy anew.
TEST_F(ModelImportTest, BothLayoutsGiveTheSameDocument) {
  const Parts parts = partsOf("climate");
  const HX_Import newer = import(pack("climate.slx", parts));
  const HX_Import older = import(pack("climate.slx", nested(parts)));
  EXPECT_EQ(newer.document, older.document);
  EXPECT_EQ(newer.notes, older.notes);

  std::string notes;
  for (const std::string& note : newer.notes) notes += note + "\n";
  const std::filesystem::path golden = HX_TEST_FOLDER "/golden/climate.golden";
  if (std::getenv("HX_RENEW_GOLDEN") != nullptr)
    write(golden, newer.document + notes);
  EXPECT_EQ(read(golden), newer.document + notes);
}

TEST_F(ModelImportTest, OrderInTheFileHasNoInfluence) {
  Parts parts = partsOf("climate");
  const std::string document = import(pack("climate.slx", parts)).document;
  for (auto& [name, text] : parts) {
    pugi::xml_document part;
    part.load_string(text.c_str());
    for (const auto& found : part.select_nodes("//Block|//Line|//Children/*")) {
      pugi::xml_node node = found.node();
      node.parent().prepend_move(node);
    }
    std::ostringstream out;
    part.save(out);
    text = out.str();
  }
  EXPECT_EQ(document, import(pack("climate.slx", parts)).document);
}

std::string linkTo(const char* name, const char* type, const char* parameter,
                   const std::string& target) {
  return std::string("<Block BlockType='") + type + "' Name='" + name +
         "' SID='" + std::to_string(name[0] - 'A' + 1) + "'><P Name='" +
         parameter + "'>" + target + "</P></Block>";
}

TEST_F(ModelImportTest, ReferencesAreExpanded) {
  std::filesystem::create_directory(m_Folder / "far");
  m_Request.searchPath = {m_Folder / "far"};
  const std::string leaf = "<Block BlockType='Gain' Name='leaf' SID='7'/>";
  pack("lib.slx",
       modelWith("<Block BlockType='SubSystem' Name='a/b' SID='5'><System>" +
                     leaf + "</System></Block>" +
                     linkTo("D", "Reference", "SourceBlock", "lib/D"),
                 "Library"));
  pack("far/sub.slx", modelWith(leaf, "Subsystem"));
  pack("other.slx", modelWith(leaf + linkTo("E", "ModelReference",
                                            "ModelNameDialog", "m.slx")));
  const HX_Import result = importParts(modelWith(
      linkTo("A", "Reference", "SourceBlock", "lib/a//b") +
      linkTo("B", "SubSystem", "ReferencedSubsystem", "sub") +
      linkTo("C", "ModelReference", "ModelNameDialog", "other.slx") +
      linkTo("D", "Reference", "SourceBlock", "lib/D") +
      linkTo("F", "Reference", "SourceBlock", "lib/none") +
      linkTo("G", "Reference", "SourceBlock", "gone/x") +
      linkTo("H", "Reference", "SourceBlock", "gone/y") +
      linkTo("I", "ModelReference", "ModelNameDialog", "../far/sub")));
  for (const char* id : {"1:7", "2:7", "3:7"})
    EXPECT_THAT(result.document,
                HasSubstr("\"id\": \"" + std::string(id) + "\""));
  const std::string empty = ": the block has no content ";
  EXPECT_THAT(
      result.notes,
      ElementsAre(
          "warning: 'm.slx' refers to itself" + empty + "(m/C/E)",
          "warning: 'lib' refers to itself" + empty + "(m/D)",
          "warning: 'lib' has no block 'none'" + empty + "(m/F)",
          "warning: 'gone' was found neither beside the model nor on --path" +
              empty + "(m/G and 1 more)",
          "warning: '../far/sub' was found neither beside the model nor on "
          "--path" +
              empty + "(m/I)"));
}

TEST_F(ModelImportTest, DamagedNumbersStillGiveIds) {
  const HX_Import result =
      importParts(modelWith("<Block BlockType='Gain' Name='a' SID='7'/>"
                            "<Block BlockType='Gain' Name='b' SID='7'/>"
                            "<Block BlockType='Gain' Name='c'/>"));
  for (const char* id : {"7", "7~2", "c"})
    EXPECT_THAT(result.document,
                HasSubstr("\"id\": \"" + std::string(id) + "\""));
  EXPECT_THAT(result.notes, ElementsAre(HasSubstr("occurs more than once")));
}

TEST_F(ModelImportTest, TextsStayOneLineOfUtf8) {
  const HX_Import result = importParts(modelWith(
      "<Block BlockType='Gain' Name='\xE4\xBD\xA0&#x1;&#xA;\"&#xD800;'"
      " SID='7'/>"));
  EXPECT_THAT(result.document,
              HasSubstr("\"name\": \"\xE4\xBD\xA0  \\\"\xEF\xBF\xBD"));
}

TEST_F(ModelImportTest, DictionaryThatIsAbsentIsNamedOnce) {
  std::filesystem::remove(m_Folder / "climate_types.sldd");
  const auto file = pack("climate.slx", partsOf("climate"));
  EXPECT_THAT(import(file).notes,
              testing::Contains(HasSubstr("dictionary 'climate_types.sldd'")));
  std::filesystem::create_directory(m_Folder / "far");
  m_Request.dictionaries = {
      pack("far/climate_types.sldd", partsOf("climate_types"))};
  EXPECT_THAT(import(file).notes,
              Not(testing::Contains(HasSubstr("'climate_types"))));
  const auto own = pack("climate_types.sldd", partsOf("climate_types"));
  m_Request.dictionaries = {own};  // also named by the model: read once
  EXPECT_THAT(import(file).notes,
              Not(testing::Contains(HasSubstr("is not used"))));
  m_Request.dictionaries.push_back(
      pack("far/more.sldd", partsOf("climate_types")));
  EXPECT_THAT(import(file).notes,
              testing::Contains("warning: 'Kp' of the dictionary 'more' is not "
                                "used: 'climate_types' has an entry of this "
                                "name"));
}

}  // namespace
