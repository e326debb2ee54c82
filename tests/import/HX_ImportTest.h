// Packs small models of our own and imports them.
//
//   class TreeTest : public HX_ImportTest {};
//   TEST_F(TreeTest, Blocks) { importParts({{"simulink/...", "<...>"}}); }

#ifndef IMPORT_HX_IMPORTTEST_H
#define IMPORT_HX_IMPORTTEST_H

#include <gmock/gmock.h>

#include <filesystem>
#include <functional>
#include <map>
#include <string>
#include <vector>

#include "host/import/HX_Import.h"

struct zip;

/// Each test has a folder of its own, empty at the start.
class HX_ImportTest : public testing::Test {
 protected:
  using Parts = std::map<std::string, std::string>;  // texts by name

  HX_ImportTest();

  /// Writes an archive and gives the path. \p finish may change the archive
  /// before the archive is closed.
  std::filesystem::path pack(
      const std::string& file, const Parts& parts,
      const std::function<void(zip*)>& finish = [](zip*) {}) const;

  /// The parts of a folder of models/.
  static Parts partsOf(const std::string& model);
  /// A model with these blocks and lines in the root system.
  static Parts modelWith(const std::string& elements,
                         const std::string& kind = "Model");
  /// The newer layout as the older layout: everything in two parts.
  static Parts nested(const Parts& parts);

  /// Imports a file; a refusal becomes the text of the document.
  HX_Import import(const std::filesystem::path& file) const;
  HX_Import importParts(const Parts& parts) const;

  static std::string read(const std::filesystem::path& file);
  static void write(const std::filesystem::path& file, const std::string& text);

  const std::filesystem::path m_Folder;
  mutable HX_ImportRequest m_Request;
};

#endif  // IMPORT_HX_IMPORTTEST_H
