#include "import/HX_ImportTest.h"

#include <zip.h>

#include <fstream>
#include <pugixml.hpp>
#include <sstream>

namespace fs = std::filesystem;

HX_ImportTest::HX_ImportTest()
    : m_Folder(fs::path(HX_SCRATCH_FOLDER) /
               testing::UnitTest::GetInstance()->current_test_info()->name()) {
  fs::remove_all(m_Folder);
  fs::create_directories(m_Folder);
  m_Request.keywordFolders = {HX_KEYWORD_FOLDER};
}

fs::path HX_ImportTest::pack(const std::string& file, const Parts& parts,
                             const std::function<void(zip*)>& finish) const {
  const fs::path path = m_Folder / file;
  int error = 0;
  zip_t* archive = zip_open(path.c_str(), ZIP_CREATE | ZIP_TRUNCATE, &error);
  for (const auto& [name, text] : parts)
    zip_file_add(archive, name.c_str(),
                 zip_source_buffer(archive, text.data(), text.size(), 0), 0);
  finish(archive);
  EXPECT_EQ(0, zip_close(archive)) << path;
  return path;
}

HX_ImportTest::Parts HX_ImportTest::partsOf(const std::string& model) {
  const fs::path folder = fs::path(HX_TEST_FOLDER) / "models" / model;
  Parts parts;
  for (const auto& entry : fs::recursive_directory_iterator(folder)) {
    if (entry.is_regular_file())
      parts[fs::relative(entry.path(), folder).string()] = read(entry.path());
  }
  return parts;
}

HX_ImportTest::Parts HX_ImportTest::modelWith(const std::string& elements,
                                              const std::string& kind) {
  return {{"simulink/blockdiagram.xml",
           "<ModelInformation><" + kind + "><System>" + elements +
               "</System></" + kind + "></ModelInformation>"}};
}

namespace {

// Replaces each Ref below `node` by the children of the named part.
void inlineReferences(pugi::xml_node node, const std::string& folder,
                      const std::map<std::string, std::string>& parts) {
  for (pugi::xml_node child : node.children()) {
    if (const pugi::xml_attribute reference = child.attribute("Ref")) {
      pugi::xml_document part;
      part.load_string(parts.at(folder + reference.value() + ".xml").c_str());
      child.remove_attribute("Ref");
      for (const auto& attribute : part.document_element().attributes())
        child.append_copy(attribute);
      for (const auto& inner : part.document_element().children())
        child.append_copy(inner);
    }
    inlineReferences(child, folder, parts);
  }
}

std::string nestedPart(const std::map<std::string, std::string>& parts,
                       const char* part, const char* folder) {
  pugi::xml_document document;
  document.load_string(parts.at(part).c_str());
  inlineReferences(document, folder, parts);
  std::ostringstream text;
  document.save(text);
  return text.str();
}

}  // namespace

HX_ImportTest::Parts HX_ImportTest::nested(const Parts& parts) {
  Parts result = {
      {"simulink/blockdiagram.xml",
       nestedPart(parts, "simulink/blockdiagram.xml", "simulink/systems/")},
      {"simulink/stateflow.xml",
       nestedPart(parts, "simulink/stateflow/machine.xml",
                  "simulink/stateflow/")}};
  result.insert(
      {"simulink/bddefaults.xml", parts.at("simulink/bddefaults.xml")});
  return result;
}

HX_Import HX_ImportTest::import(const fs::path& file) const {
  m_Request.model = file;
  try {
    return HX_ImportModel(m_Request);
  } catch (const HX_ImportError& error) {
    std::string text = error.what();
    const std::string folder = m_Folder.string() + "/";
    for (std::size_t at = text.find(folder); at != std::string::npos;
         at = text.find(folder))
      text.erase(at, folder.size());
    return {text, {}};
  }
}

HX_Import HX_ImportTest::importParts(const Parts& parts) const {
  return import(pack("m.slx", parts));
}

std::string HX_ImportTest::read(const fs::path& file) {
  std::ifstream stream(file, std::ios::binary);
  EXPECT_TRUE(stream.is_open()) << file;
  std::ostringstream text;
  text << stream.rdbuf();
  return text.str();
}

void HX_ImportTest::write(const fs::path& file, const std::string& text) {
  std::ofstream(file, std::ios::binary) << text;
}
