// One run over a model, from the document to the result.
//
//   HX_Profile profile("");
//   HX_Document document("cruise_control.json", profile.start);
//   HX_Generator generator(profile, std::move(document), {"data/keywords"});
//   generator.run(nullptr, "");
//   HX_WriteTable(std::cout, generator.result);

#ifndef HOST_PROGRAM_HX_GENERATOR_H
#define HOST_PROGRAM_HX_GENERATOR_H

#include <optional>
#include <string>
#include <vector>

#include "host/base/HX_FileSink.h"
#include "host/base/HX_Progress.h"
#include "host/model/HX_Document.h"
#include "host/model/HX_Model.h"
#include "host/names/HX_Components.h"
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
  /// \param path  the component to form the names of; empty for all names.
  ///              Throws HX_InputError for an unknown path.
  /// \param watched  id of the name to keep the steps of; empty for none
  void run(HX_NameLock* lock, const std::string& path,
           const std::string& watched = "");

  /// Finds the components.
  void splitIntoComponents();

  /// Writes the C code, and the name map by id.
  /// \param index  of the component; -1 for the whole model
  void write(int index, HX_FileSink& output);
  /// Writes the C code of the whole model.
  void writeCode(HX_FileSink& output);

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
  std::optional<HX_Components> components;
  bool asLines = false;  // the JSON of the name map has a document per line
  int component = -1;    // the chosen component; -1 for all

 private:
  std::vector<bool> choose(const std::string& path);
  HX_RunResult resultOf(int index);
  void writeNameMap(HX_FileSink& output, const HX_RunResult& part);

  std::vector<int> m_ComponentOf;  // by index of the name
};

#endif  // HOST_PROGRAM_HX_GENERATOR_H
