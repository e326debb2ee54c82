// The steps of reading a model; private to the sources of HX_Model.

#ifndef HOST_MODEL_HX_MODELREADERS_H
#define HOST_MODEL_HX_MODELREADERS_H

#include <string>
#include <unordered_map>

#include "host/model/HX_Document.h"
#include "host/model/HX_Model.h"

/// The ids of one kind, and what they stand for.
template <class Item>
struct HX_Ids {
  const HX_Document& document;
  const char* what;
  std::unordered_map<std::string, Item*> items = {};

  /// Enters the item of \p node, whose id must be new.
  void enter(const HX_Json& node, Item* item) {
    const HX_Json& id = node["id"];
    if (!items.emplace(id, item).second)
      document.fail(id, "an id that is not taken yet, found " + id.dump());
  }

  Item* find(const HX_Json& id) const {
    const auto found = items.find(id.get_ref<const std::string&>());
    if (found == items.end())
      document.fail(id,
                    std::string("the id of ") + what + ", found " + id.dump());
    return found->second;
  }

  /// Null for a field that is missing.
  Item* findIn(const HX_Json& node, const char* field) const {
    const auto id = node.find(field);
    return id == node.end() ? nullptr : find(*id);
  }
};

using HX_SourceIds = HX_Ids<const HxCSrcRef>;
using HX_TypeIds = HX_Ids<HX_TypeItem>;

/// Blocks, charts and the data dictionary.
void HX_ReadSources(const HX_Json& root, HX_Model& model, HX_SourceIds& ids);

void HX_ReadTypes(const HX_Json& types, HX_Model& model, HX_TypeIds& ids);
/// The type of \p id, if the code can declare something with it.
HX_TypeItem* HX_FindDeclarableType(const HX_TypeIds& ids, const HX_Json& id);

#endif  // HOST_MODEL_HX_MODELREADERS_H
