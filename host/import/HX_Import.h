// From a model file to a model document.
//
//   HX_ImportRequest request;
//   request.model = "rc_update.slx";
//   request.keywordFolders = {"data/keywords"};
//   const HX_Import import = HX_ImportModel(request);
//   std::cout << import.document;
//
// Stages: HX_Archive (zip), HX_XmlPart, HX_ModelFile (one file with its parts),
// HX_ModelTree (blocks and charts, references expanded), HX_NameItems (names by
// HX_Rules, types by HX_TypeTable), HX_WriteModelDocument.

#ifndef HOST_IMPORT_HX_IMPORT_H
#define HOST_IMPORT_HX_IMPORT_H

#include <filesystem>
#include <string>
#include <vector>

#include "host/import/HX_ImportError.h"

struct HX_ImportRequest {
  std::filesystem::path model;
  std::vector<std::filesystem::path> dictionaries;
  /// Where referenced files are looked for, after the folder of the model.
  std::vector<std::filesystem::path> searchPath;
  std::filesystem::path rules;  ///< empty for the built-in rules
  /// Folders of word lists (NAME.txt): types and fields avoid the words of
  /// "c90" and of the lists in the rules. Lists of equal name add up.
  std::vector<std::filesystem::path> keywordFolders;
  HX_ImportLimits limits;
};

struct HX_Import {
  std::string document;            ///< JSON, by host/model.schema.json
  std::vector<std::string> notes;  ///< warnings and notes, a line each
};

/// Throws HX_ImportError. Equal files give equal bytes.
HX_Import HX_ImportModel(const HX_ImportRequest& request);

/// True for a file that HX_ImportModel() reads, or refuses with advice: by its
/// ending, .slx or .mdl.
bool HX_IsModelFile(const std::filesystem::path& file);

#endif  // HOST_IMPORT_HX_IMPORT_H
