// One run over a model, from the document to the result.
//
//   HX_Profile profile("");
//   HX_Document document("cruise_control.json", profile.start);
//   HX_Generator generator(profile, std::move(document), {"data/keywords"});
//   generator.run(progress, nullptr);
//   HX_WriteTable(std::cout, generator.result);

#ifndef HOST_PROGRAM_HX_GENERATOR_H
#define HOST_PROGRAM_HX_GENERATOR_H

#include <optional>
#include <string>

#include "host/base/HX_Output.h"
#include "host/base/HX_Progress.h"
#include "host/model/HX_Document.h"
#include "host/model/HX_Model.h"
#include "host/names/HX_FormedName.h"
#include "host/names/HX_NameForming.h"
#include "host/names/HX_NameSpaces.h"
#include "host/program/HX_Profile.h"

struct HX_Generator {
  /// Throws HX_DocumentError. Folders count from the start of \p profile.
  HX_Generator(HX_Profile& profile, HX_Progress& progress, HX_Document read,
               const std::vector<std::string>& keywordFolders,
               const HX_ReservedChoice& more = {});

  /// Orders types, forms names, orders variables. A circle of types ends the
  /// run without names. Throws HX_DocumentError for reserved words among types.
  /// \param lock  names to keep, and to note; null for none
  void run(HX_NameLock* lock);

  /// Writes the C code, and the name map by id.
  /// \param asLines  the JSON of the name map has a document per line
  /// \return the number of files that the commit of \p output changes
  std::size_t write(HX_Output& output, bool asLines);

  HX_Profile& profile;
  HX_Progress& progress;
  /// Whether name spaces stay after run(), for `forming`. Name spaces hold a
  /// fifth of the memory of a run.
  bool keepsSpaces = true;
  HX_Document document;
  HX_RunResult result;
  const HX_MessageCollector collector{result.findings};
  std::optional<const HX_Model> model;
  std::string banner;  // of the code; empty if the document wants none
  std::optional<HX_NameSpaces> spaces;
  std::optional<HX_NameForming> forming;
};

#endif  // HOST_PROGRAM_HX_GENERATOR_H
