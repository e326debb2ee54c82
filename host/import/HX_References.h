// The files behind references of a model: models, libraries, subsystems.

#ifndef HOST_IMPORT_HX_REFERENCES_H
#define HOST_IMPORT_HX_REFERENCES_H

#include <filesystem>
#include <map>
#include <memory>
#include <string>
#include <vector>

#include "host/import/HX_ModelFile.h"

class HX_References {
 public:
  /// Files are looked for in \p folders, in this order.
  HX_References(std::vector<std::filesystem::path> folders,
                const HX_ImportLimits& limits);

  /// RETURNS: the file \p name, with or without the ending .slx, read at most
  /// once; null where no folder has the file, and for a name with a folder: a
  /// model does not choose folders.
  /// Throws HX_ImportError for a file that exists and cannot be read.
  const HX_ModelFile* find(const std::string& name);

  /// RETURNS: the path of a file in the first folder with the file; empty for
  /// none.
  std::filesystem::path pathOf(const std::string& fileName) const;

 private:
  const std::vector<std::filesystem::path> m_Folders;
  const HX_ImportLimits& m_Limits;
  std::map<std::string, std::unique_ptr<HX_ModelFile>> m_Files;
};

#endif  // HOST_IMPORT_HX_REFERENCES_H
