// The scopes that names are defined in, reserved words, and free variants of
// taken names.
//
//   HX_NameSpaces spaces(model, types);
//   KyCXString text("speed");
//   spaces.define(name, text, true).text();   // "taken by m/In ('speed_in')"
//   // text == "speed_a"

#ifndef HOST_NAMES_HX_NAMESPACES_H
#define HOST_NAMES_HX_NAMESPACES_H

#include <deque>
#include <map>
#include <string>
#include <vector>

#include "NameSpace/HX_LimitedNameSpace.h"
#include "NameSpace/HxCNameSpace.h"
#include "NameSpace/HxCXStringIdServer.h"
#include "host/model/HX_Model.h"
#include "host/names/HX_FormedName.h"

/// In file, function and block scopes a name is taken if the scope, an outer
/// scope or an inner scope holds the name: no variable hides another variable.
/// In a flat scope a name is taken if the scope holds the name. Reserved words
/// are taken everywhere. The keyword dictionary of the library lives as long as
/// this object.
class HX_NameSpaces {
 public:
  /// Reserves the words of the model and the names of \p types, constants in
  /// the file scope only.
  HX_NameSpaces(const HX_Model& model,
                const std::vector<const HX_TypeItem*>& types);
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

  /// Defines \p text for \p name in the scope of \p name. A taken text gets a
  /// suffix first if \p changeable; otherwise nothing is defined, and the
  /// library reports a reserved word.
  /// RETURNS: the conflict of the given text; eNone for a free text.
  HX_Change define(const HX_WantedName& name, KyCXString& text,
                   bool changeable);

  /// Whether the library itself reports \p conflict for a fixed name.
  static bool isReported(const HX_Change& conflict);

 private:
  struct Space {
    explicit Space(HxCXStringIdServer* ids) : scoped(ids) {}
    HxCNameSpace scoped;  // without a scope in a flat space
    HX_LimitedNameSpace flat;
    std::map<std::string, const HX_WantedName*> owners;  // flat space, by text
    std::map<std::string, int> nextSuffix;  // by text without suffix
  };
  struct Symbol : HxCSymbol {
    using HxCSymbol::HxCSymbol;
    const HX_WantedName* owner = nullptr;
  };

  void reserve(const std::vector<const HX_TypeItem*>& types);
  void check(const std::string& name, HX_TokenEnd place);
  HX_Change conflictOf(Space& space, const KyCXString& text);
  HX_Change::HxEReasonTag reservedAs(const KyCXString& text);
  void deriveFreeName(Space& space, KyCXString& text);

  HxCXStringIdServer m_Ids;
  HxCNameSpace m_File{&m_Ids};  // owns the file scope with all inner scopes
  std::map<const HX_ScopeItem*, Space> m_Spaces;
  std::deque<Symbol> m_Symbols;
  std::vector<ReservedUse> m_ReservedUses;
  HxCNames m_Names;
};

#endif  // HOST_NAMES_HX_NAMESPACES_H
