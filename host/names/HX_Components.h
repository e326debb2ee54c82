// The components of a model: its outermost subsystems, each with C files of its
// own.
//
//   const HX_Components components(model);
//   components.all()[1].path;           // "cruise_control/Controller"
//   components.all()[1].files.code;     // "cruise_control_Controller"
//   components.of(name);                // 1

#ifndef HOST_NAMES_HX_COMPONENTS_H
#define HOST_NAMES_HX_COMPONENTS_H

#include <string>
#include <unordered_map>
#include <vector>

#include "host/model/HX_Model.h"
#include "host/names/HX_CFiles.h"

/// Component 0, with the path ".", has everything outside the subsystems, and
/// the types. If a single block is around all blocks, the subsystems directly
/// inside are the components, otherwise the outermost blocks with blocks
/// inside.
///
/// COST: a pass over blocks and functions; of() makes the path of the source.
class HX_Components {
 public:
  struct Component {
    std::string path;
    HX_CFiles files;  // the types are those of component 0
  };

  /// REQUIRES: \p model lives as long as this object.
  explicit HX_Components(const HX_Model& model);

  /// "." first, then by path, numbers by value.
  const std::vector<Component>& all() const { return m_All; }
  /// RETURNS: the index of \p path; -1 for an unknown path.
  int find(const std::string& path) const;
  /// RETURNS: the component of the best source of \p name. Variables of a
  /// function belong to the component of the function.
  int of(const HX_WantedName& name) const;

 private:
  std::vector<Component> m_All;
  std::unordered_map<std::string, int> m_ByPath;
  std::unordered_map<const HX_ScopeItem*, const HX_WantedName*> m_FunctionOf;
};

#endif  // HOST_NAMES_HX_COMPONENTS_H
