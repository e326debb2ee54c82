// One run over a model: everything between a document and what is printed or
// written.
//
//   HX_Profile profile("");
//   HX_Generator generator(profile, "cruise_control.json", "data/keywords");
//   generator.run(progress);
//   HX_WriteTable(std::cout, generator.result);

#ifndef HOST_PROGRAM_HX_GENERATOR_H
#define HOST_PROGRAM_HX_GENERATOR_H

#include <optional>
#include <string>

#include "host/base/HX_Output.h"
#include "host/program/HX_Profile.h"
#include "host/write/HX_NameReport.h"

struct HX_Generator {
  /// Throws HX_DocumentError. Paths count from the start of \p profile.
  HX_Generator(HX_Profile& profile, const std::string& document,
               const std::string& keywordFolder);

  /// Orders types, forms names, orders variables. After a cycle among the types
  /// no names are formed.
  void run(const HX_NameRun::Progress& progress);

  /// Writes the C code and the name map, the latter by id.
  /// \return the number of files that change when \p output is committed
  std::size_t write(HX_Output& output);

  HX_Profile& profile;
  std::optional<HX_Model> model;
  HX_RunResult result;  // names are in the order of the document
  std::optional<HX_NameSpaces> spaces;
  std::optional<HX_NameRun> nameRun;
};

#endif  // HOST_PROGRAM_HX_GENERATOR_H
