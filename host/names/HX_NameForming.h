// Takes the names of a model the whole road from template to C name.
//
//   HX_NameForming forming(spaces);
//   std::deque<HX_FormedName> names = forming.formAll(model.names, progress);
//   print(names.front().actual);

#ifndef HOST_NAMES_HX_NAMEFORMING_H
#define HOST_NAMES_HX_NAMEFORMING_H

#include <deque>
#include <map>
#include <optional>
#include <string>
#include <vector>

#include "Naming/HxCCIdentifier.h"
#include "host/base/HX_Progress.h"
#include "host/names/HX_FormedName.h"
#include "host/names/HX_NameSpaces.h"

/// One step of an expansion, for the user to read.
struct HX_ExplainedMacro {
  std::string macro;  ///< or literal text
  std::string value;
  std::string origin;
};

/// One step from the expanded template to the name, or a conflict on the way.
struct HX_ExplainedStep {
  std::string what;
  std::string text;  ///< the name after the step, or the name in conflict
  bool isConflict = false;
};

class HX_NameForming {
 public:
  explicit HX_NameForming(HX_NameSpaces& spaces) : m_Spaces(spaces) {}

  /// Forms names in the order of HX_FormingOrder().
  /// \param chosen  by index, the names to form; all if empty
  /// RETURNS: one formed name per wanted name, in the order of \p names.
  std::deque<HX_FormedName> formAll(const std::deque<HX_WantedName>& names,
                                    const std::vector<bool>& chosen,
                                    HX_Progress& progress);

  /// Keeps the steps of the name with this id; before formAll().
  void watch(const std::string& id) { m_Watched = id; }
  /// The steps of the watched name; the first is the name before all cuts.
  const std::vector<HX_ExplainedStep>& steps() const { return m_Steps; }

  /// The value of each macro of the template. Reports nothing.
  std::vector<HX_ExplainedMacro> explain(const HX_WantedName& name);

 private:
  void form(HX_FormedName& name);
  /// RETURNS: whether the name is complete; no value for a name too long.
  std::optional<bool> expand(const HX_WantedName& name, HxCCIdentifier& id,
                             bool suppressMessages);
  bool substitute(const HX_WantedName& name, HxCCIdentifier& id);
  void replaceMultirate(const HX_WantedName& name, HxCCIdentifier& id);
  void define(HxCCIdentifier& id, HX_FormedName& name);
  void note(const HX_SafeName::Step& step, HX_FormedName& name);
  void keepSteps(const KyCXString& expanded);

  HX_NameSpaces& m_Spaces;
  HxCNames m_Names;
  std::string m_Watched;
  std::vector<HX_ExplainedStep> m_Steps;
  HX_SafeName m_Safe;  // of the name being formed
  std::map<const HX_WantedName*, HxCCIdentifier> m_TaskNames;  // null: empty
};

#endif  // HOST_NAMES_HX_NAMEFORMING_H
