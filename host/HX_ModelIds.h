// Looks up what the ids and words of a document stand for; private to the
// sources of HX_Model.

#ifndef HOST_HX_MODELIDS_H
#define HOST_HX_MODELIDS_H

#include <cstddef>
#include <string>

#include "host/HX_Document.h"

template <class Value>
struct Choice {
  const char* text;
  Value value;
};

// The schema admits only texts that have a row.
template <class Value, std::size_t size>
Value valueOf(const Choice<Value> (&rows)[size], const std::string& text) {
  for (const Choice<Value>& row : rows) {
    if (text == row.text) return row.value;
  }
  return rows[0].value;
}

/// Enters the item of \p node under its id, which must be new.
template <class Item, class Map>
void enter(const HX_DocumentNode& node, Map& map, Item* item) {
  const HX_DocumentNode id = node.at("id");
  if (!map.emplace(id.value().get<std::string>(), item).second)
    id.fail("an id that is not taken yet, found " + id.value().dump());
}

/// Fails with "the id of <what>" for an id that leads nowhere.
template <class Map>
typename Map::mapped_type find(const HX_DocumentNode& id, const Map& map,
                               const char* what) {
  const auto found = map.find(id.value().get_ref<const std::string&>());
  if (found == map.end())
    id.fail(std::string("the id of ") + what + ", found " + id.value().dump());
  return found->second;
}

/// Null for a field that is missing.
template <class Map>
typename Map::mapped_type findIn(const HX_DocumentNode& node, const char* field,
                                 const Map& map, const char* what) {
  return node.has(field) ? find(node.at(field), map, what) : nullptr;
}

#endif  // HOST_HX_MODELIDS_H
