// The scopes that names are defined in, reserved words, and free variants of
// taken names.
//
//   HX_NameSpaces spaces(model, types);
//   KyCXString text("speed");
//   spaces.define(name, text, true);   // "taken by 'speed_in'"
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

/// In file, function and block scopes a name is taken if the scope, one around
/// it or one inside it holds the name, so that no variable hides another; in a
/// flat scope, if the scope holds it. Reserved words are taken everywhere: the
/// keyword dictionary of the library lives as long as this object.
class HX_NameSpaces {
 public:
  /// Reserves the words of the model and the names of \p types, the constants
  /// in the file scope only. A type, field or constant whose name is a reserved
  /// word is reported to the message handler.
  HX_NameSpaces(const HX_Model& model,
                const std::vector<const HX_TypeItem*>& types);
  HX_NameSpaces(const HX_NameSpaces&) = delete;
  HX_NameSpaces& operator=(const HX_NameSpaces&) = delete;
  ~HX_NameSpaces();

  /// Defines \p text for \p name in its scope. One that is taken gets a suffix
  /// first if it is changeable; otherwise it is not defined, and a reserved
  /// word is reported to the message handler; nothing else stays there.
  /// \return what it is or was: "keyword", "taken by 'x'"; empty if it was free
  std::string define(HX_Name& name, KyCXString& text, bool changeable);

 private:
  struct Space {
    explicit Space(HxCXStringIdServer* ids) : scoped(ids) {}
    HxCNameSpace scoped;  // without a scope in a flat one
    HX_LimitedNameSpace flat;
    std::map<std::string, const HX_Name*> owners;  // by text, if flat
    std::map<std::string, int> nextSuffix;         // by text without it
  };
  struct Symbol : HxCSymbol {
    using HxCSymbol::HxCSymbol;
    const HX_Name* owner = nullptr;
  };

  void reserve(const std::vector<const HX_TypeItem*>& types);
  std::string conflictOf(Space& space, const KyCXString& text);
  void deriveFreeName(Space& space, KyCXString& text);

  HxCXStringIdServer m_Ids;
  HxCNameSpace m_File{&m_Ids};  // its scope, with all in it, is owned
  std::map<const HX_ScopeItem*, Space> m_Spaces;
  std::deque<Symbol> m_Symbols;
  HxCNames m_Names;
};

#endif  // HOST_NAMES_HX_NAMESPACES_H
