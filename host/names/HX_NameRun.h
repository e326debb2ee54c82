// Takes the names of a model the whole road from template to C name.
//
//   HX_NameRun run(spaces);
//   run.formAll(model.names, progress);
//   print(model.names.front().actual);

#ifndef HOST_NAMES_HX_NAMERUN_H
#define HOST_NAMES_HX_NAMERUN_H

#include <deque>
#include <functional>
#include <map>
#include <string>
#include <vector>

#include "Naming/HxCCIdentifier.h"
#include "host/model/HX_Model.h"
#include "host/names/HX_NameSpaces.h"

/// One step of an expansion, for the user to read.
struct HX_ExplainedMacro {
  std::string macro;  ///< or literal text
  std::string value;
  std::string origin;
};

class HX_NameRun {
 public:
  using Progress = std::function<void(std::size_t done, std::size_t all)>;

  explicit HX_NameRun(HX_NameSpaces& spaces) : m_Spaces(spaces) {}

  /// Forms all names in the order of their ids, tasks first, so that the result
  /// does not depend on the order of the document.
  void formAll(std::deque<HX_Name>& names, const Progress& progress);

  /// What each macro of a template gives; reports nothing.
  std::vector<HX_ExplainedMacro> explain(const HX_Name& name);

 private:
  void form(HX_Name& name);
  bool expand(const HX_Name& name, HxCCIdentifier& id, bool suppressMessages);
  void replaceMultirate(const HX_Name& name, HxCCIdentifier& id);
  void makeCName(HxCCIdentifier& id, HX_Name& name);
  void define(HxCCIdentifier& id, HX_Name& name);

  HX_NameSpaces& m_Spaces;
  HxCNames m_Names;
  std::map<const HX_Name*, HxCCIdentifier> m_TaskNames;  // empty for none
};

/// The text of a source reference in UTF-8; empty for null.
std::string HX_PathOf(const HxCSrcRef* srcRef);

/// Moves the messages of the library to \p findings.
void HX_TakeMessages(std::vector<HX_Finding>& findings);

#endif  // HOST_NAMES_HX_NAMERUN_H
