// The scopes of a model, reserved words, and the names defined so far.
//
//   HX_NameSpaces spaces(model, types, nullptr);
//   HX_SafeName safe;
//   spaces.define(name, id, safe);
//   HX_NameSpaces::changeOf(safe.step(0)).text();   // "taken by m/In ('in')"

#ifndef HOST_NAMES_HX_NAMESPACES_H
#define HOST_NAMES_HX_NAMESPACES_H

#include <deque>
#include <map>
#include <set>
#include <string>
#include <vector>

#include "SafeNames/HX_NameLock.h"
#include "SafeNames/HX_ReservedNames.h"
#include "SafeNames/HX_SafeNames.h"
#include "host/model/HX_Model.h"
#include "host/names/HX_FormedName.h"

/// In file, function and block scopes a name is taken if the scope, an outer
/// scope or an inner scope holds the name: no variable hides another variable.
/// In a flat scope a name is taken if the scope holds the name. Reserved words
/// are taken everywhere, names of the C library and macros of the generated
/// code in the file scope and the scopes inside. The keyword dictionary of the
/// library lives as long as this object.
class HX_NameSpaces {
 public:
  /// Reserves the words of the model and the names of \p types, constants in
  /// the file scope only.
  /// \param lock  names to keep; null for none
  HX_NameSpaces(const HX_Model& model,
                const std::vector<const HX_TypeItem*>& types,
                HX_NameLock* lock);
  HX_NameSpaces(const HX_NameSpaces&) = delete;
  HX_NameSpaces& operator=(const HX_NameSpaces&) = delete;
  ~HX_NameSpaces();

  /// The name of a type, field or constant that is a reserved word.
  struct ReservedUse {
    std::string name;
    HX_TokenEnd place;
    HX_Change conflict;
  };
  const std::vector<ReservedUse>& reservedUses() const {
    return m_ReservedUses;
  }

  /// Defines the expanded \p id for \p name in the scope of \p name.
  /// RETURNS: whether the name was defined; \p safe has the steps.
  bool define(const HX_WantedName& name, HxCCIdentifier& id, HX_SafeName& safe);

  /// A step as a change; REQUIRES: the step is a change or a conflict.
  static HX_Change changeOf(const HX_SafeName::Step& step);
  /// Whether \p change is a conflict with a word or another name.
  static bool isConflict(const HX_Change& change);
  /// Whether the library itself reports \p conflict for a fixed name.
  static bool isReported(const HX_Change& conflict);

 private:
  struct Symbol : HxCSymbol {
    using HxCSymbol::HxCSymbol;
    const HX_WantedName* owner = nullptr;
    HX_Change::HxEReasonTag reason = HX_Change::eTakenByName;
  };

  void reserve(const std::vector<const HX_TypeItem*>& types,
               HX_SafeNames::Scope* file);
  void reserveWordsOfCode(const std::set<std::string>& libraryWords,
                          HX_SafeNames::Scope* file);
  void check(const std::string& name, HX_TokenEnd place);

  HX_ReservedNames m_Patterns;
  HX_ReservedNames m_CodePatterns;  // for names of the code
  HX_SafeNames m_Safe;
  std::map<const HX_ScopeItem*, HX_SafeNames::Scope*> m_Scopes;
  std::deque<Symbol> m_Symbols;
  // Stand for each name of the C library and for each macro of the code.
  Symbol m_Library{KyCXString(), HxCSymbol::eVariable, nullptr};
  Symbol m_Macro{KyCXString(), HxCSymbol::eVariable, nullptr};
  std::set<std::string> m_Macros;
  std::vector<ReservedUse> m_ReservedUses;
  HxCNames m_Names;
};

#endif  // HOST_NAMES_HX_NAMESPACES_H
