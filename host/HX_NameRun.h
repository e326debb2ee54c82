// Takes the names of a model the whole road from template to C name.
//
//   HX_NameRun run(model, keywords, spaces);
//   for (const HX_FormedName& name : run.formAll()) print(name);

#ifndef HOST_HX_NAMERUN_H
#define HOST_HX_NAMERUN_H

#include <functional>
#include <map>
#include <string>
#include <vector>

#include "Naming/HxCCIdentifier.h"
#include "SourceRef/HxCSrcRefSet.h"
#include "host/HX_Model.h"
#include "host/HX_NameSpaces.h"

/// A message of the library, or a remark of the host itself.
struct HX_Finding {
  int id;  ///< what a user sees; 0 for a remark of the host
  int severity;
  std::string text;    // UTF-8, as below
  std::string source;  // may be empty
};

struct HX_FormedName {
  const HX_NameItem* item = nullptr;
  std::string formal;
  std::string actual;
  bool isComplete = false;
  bool isDefined = false;  ///< stands in its scope and may be written into code
  std::vector<std::string> changes;  ///< why the expanded text was changed
  HxCSrcRefSet sources;              ///< everything the item stems from
  std::string sourcePath;  ///< of the reference chosen from the sources
  std::vector<HX_Finding> findings;
};

/// One step of an expansion, for the user to read.
struct HX_ExplainedMacro {
  std::string macro;  ///< or literal text
  std::string value;
  std::string origin;
};

class HX_NameRun {
 public:
  using Progress = std::function<void(std::size_t done, std::size_t all)>;

  HX_NameRun(const HX_Model& model, HX_NameSpaces& spaces);

  /// Forms all names in the order of their ids, tasks first, so that the result
  /// does not depend on the order of the document; returns them in that of the
  /// document.
  std::vector<HX_FormedName> formAll(const Progress& progress);

  /// What each macro of a template gives; reports nothing.
  std::vector<HX_ExplainedMacro> explain(const HX_NameItem& item);

 private:
  HX_FormedName form(const HX_NameItem& item);
  HxCCIdentifier begin(const HX_NameItem& item,
                       const std::string& nameTemplate);
  void substitute(const HX_NameItem& item, HxCCIdentifier& id);
  void replaceMultirate(const HX_NameItem& item, HxCCIdentifier& id);
  bool expand(const HX_NameItem& item, HxCCIdentifier& id,
              bool suppressMessages);
  void makeCName(HxCCIdentifier& id, HX_FormedName& formed);
  void define(HxCCIdentifier& id, HX_FormedName& formed);
  const HxCCIdentifier& taskName(const HX_NameItem* item) const;

  const HX_Model& m_Model;
  HX_NameSpaces& m_Spaces;
  HxCNames m_Names;
  std::map<const HX_NameItem*, HxCCIdentifier> m_TaskNames;
};

/// The reference that a message about the item is best attached to: the last
/// block, else the last dictionary object, else the last other one; null for
/// an empty set.
const HxCSrcRef* HX_ChooseSrcRef(const HxCSrcRefSet& sources);

#endif  // HOST_HX_NAMERUN_H
