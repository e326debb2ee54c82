// The scopes that names are defined in, and free variants of taken names.
//
//   HX_NameSpaces spaces(model.scopes(), keywords);
//   auto result = spaces.define(item, name, true);
//   // name == "speed_a", result.conflict == "taken by 'speed_in'"

#ifndef HOST_HX_NAMESPACES_H
#define HOST_HX_NAMESPACES_H

#include <map>
#include <memory>
#include <string>
#include <vector>

#include "NameSpace/HX_LimitedNameSpace.h"
#include "NameSpace/HxCNameSpace.h"
#include "NameSpace/HxCXStringIdServer.h"
#include "host/HX_Keywords.h"
#include "host/HX_Model.h"

/// In file, function and block scopes a name is taken if the scope, one around
/// it or one inside it holds the name, so that no variable hides another; in a
/// flat scope, if the scope holds it. Reserved words are taken everywhere.
class HX_NameSpaces {
 public:
  HX_NameSpaces(const std::vector<std::unique_ptr<HX_ScopeItem>>& scopes,
                const HX_Keywords& keywords);
  HX_NameSpaces(const HX_NameSpaces&) = delete;
  HX_NameSpaces& operator=(const HX_NameSpaces&) = delete;
  ~HX_NameSpaces();

  struct Result {
    bool isDefined;        ///< false: in conflict, and may not be changed
    std::string conflict;  ///< "keyword", "taken by 'x'"; empty if it was free
  };

  /// Defines \p name for \p item in its scope; a taken name that may be changed
  /// gets a suffix first.
  Result define(const HX_NameItem& item, KyCXString& name, bool changeable);

  /// Takes a name in every file scope: a type, an enumeration constant.
  void takeInFiles(const std::string& name);

 private:
  struct Space {
    explicit Space(HxCXStringIdServer* ids) : scoped(ids) {}
    bool isFlat = false;
    HxCNameSpace scoped;
    HX_LimitedNameSpace flat;
    std::map<std::string, std::string> owners;  // name -> id, if flat
    std::map<std::string, int> nextSuffix;      // by base name
  };

  std::string conflictOf(Space& space, const KyCXString& name) const;
  void deriveFreeName(Space& space, KyCXString& name);

  const HX_Keywords& m_Keywords;
  HxCXStringIdServer m_Ids;
  std::vector<HxCNameSpace::Scope*> m_Roots;  // owned
  std::map<const HX_ScopeItem*, std::unique_ptr<Space>> m_Spaces;
  std::vector<std::unique_ptr<HX_HostSymbol>> m_Symbols;
  HxCNames m_Names;  // only for appendSuffix
};

#endif  // HOST_HX_NAMESPACES_H
