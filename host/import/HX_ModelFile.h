// Model file (.slx), parsed: systems, charts and defaults.
//
//   HX_ModelFile file("rc_update.slx", limits);
//   for (pugi::xml_node block : file.rootSystem().children("Block"))
//     for (auto inner : file.contentOf(block).children("Block")) ...
//
// Two layouts exist. Older files hold all systems nested in
// simulink/blockdiagram.xml and all charts in simulink/stateflow.xml. Newer
// files keep a system in simulink/systems/NAME.xml, a chart in
// simulink/stateflow/NAME.xml, and an attribute Ref names the part.

#ifndef HOST_IMPORT_HX_MODELFILE_H
#define HOST_IMPORT_HX_MODELFILE_H

#include <filesystem>
#include <map>
#include <memory>
#include <optional>
#include <pugixml.hpp>
#include <string>
#include <string_view>

#include "host/import/HX_Archive.h"
#include "host/import/HX_XmlPart.h"

/// Every operation throws HX_ImportError.
class HX_ModelFile {
 public:
  /// Reads all parts with blocks or charts.
  HX_ModelFile(const std::filesystem::path& file,
               const HX_ImportLimits& limits);

  /// The file name without folder and ending.
  const std::string& name() const { return m_Name; }
  const std::string& path() const { return m_Archive.file(); }
  /// True for a file whose root element is a library.
  bool isLibrary() const;

  pugi::xml_node rootSystem() const;

  /// RETURNS: the system of the block \p block, with Ref followed; null where
  /// the block has no system.
  pugi::xml_node contentOf(pugi::xml_node block) const;

  /// RETURNS: the chart of the block with the path \p path in this file, names
  /// in one line and joined by "/"; null for none.
  pugi::xml_node chartOf(const std::string& path) const;

  /// RETURNS: the default of a block parameter in the file, or null.
  const char* defaultOf(std::string_view blockType,
                        std::string_view parameter) const;

  /// The data dictionary that the model names; empty for none.
  std::string_view dictionary() const;

  [[noreturn]] void fail(const std::string& reason) const;

 private:
  pugi::xml_node load(const std::string& part, const char* rootName);
  pugi::xml_node follow(pugi::xml_node node, const char* folder) const;
  void loadReferences(pugi::xml_node parent, const char* element,
                      const char* folder);
  void loadDefaults();
  void loadCharts();

  HX_Archive m_Archive;
  std::string m_Name;
  pugi::xml_node m_Root;  // Model, Library or Subsystem
  std::map<std::string, std::unique_ptr<HX_XmlPart>, std::less<>> m_Parts;
  std::map<std::string, pugi::xml_node> m_Charts;  // by path of the block
  std::map<std::string, pugi::xml_node, std::less<>> m_Defaults;  // by type
};

#endif  // HOST_IMPORT_HX_MODELFILE_H
