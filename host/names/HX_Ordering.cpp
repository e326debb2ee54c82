#include "host/names/HX_Ordering.h"

#include <algorithm>
#include <deque>
#include <vector>

#include "DependencySorting/HxCDepSortComp.h"
#include "DependencySorting/HxCDepSortNode.h"
#include "DependencySorting/HxCDependencySorting.h"

namespace {

/// The common part of both kinds of nodes.
class Node : public HxCDepSortNode {
 public:
  Node(const KyCXString& name, const std::string& id, const HX_TypeItem& type)
      : m_Name(name), m_Id(id) {
    const HX_TypeItem* scalar = type.scalar();
    if (scalar != nullptr && scalar->numerical)
      m_Width = scalar->numerical->getBitWidth();
  }
  const KyCXString& getName() override { return m_Name; }
  int width() const { return m_Width; }
  /// Ids decide between equal names of different scopes.
  int compareNames(const Node& other) const {
    const int order = leda::compare(m_Name, other.m_Name);
    return order != 0 ? order : m_Id.compare(other.m_Id);
  }

 private:
  const KyCXString& m_Name;
  const std::string& m_Id;
  int m_Width = 0;  // bits
};

struct ByWidth : HxCDepSortComp {
  int compare(HxCDepSortNode* a, HxCDepSortNode* b) override {
    return static_cast<Node*>(b)->width() - static_cast<Node*>(a)->width();
  }
};

struct ByName : HxCDepSortComp {
  int compare(HxCDepSortNode* a, HxCDepSortNode* b) override {
    return static_cast<Node*>(a)->compareNames(*static_cast<Node*>(b));
  }
};

}  // namespace

// The library tells types from variables in message 403.
class HxCSdtNode : public Node {
 public:
  explicit HxCSdtNode(const HX_TypeItem& type)
      : Node(type.type.getNameInCode(), type.id, type), item(type) {}
  HxCSdtNode* isSdtNode() override { return this; }
  const HX_TypeItem& item;
};

class HxCSsNode : public Node {
 public:
  explicit HxCSsNode(const HX_FormedName& name)
      : Node(name.actual, name.wanted->id, *name.wanted->type), item(name) {}
  HxCSsNode* isSsNode() override { return this; }
  const HX_FormedName& item;
};

namespace {

// Positions of items are below \p count; \p eachDependency calls its second
// argument with the positions of the items before.
template <class NodeType, class Item, class PositionOf, class EachDependency>
std::vector<const Item*> order(const std::vector<const Item*>& items,
                               std::size_t count, PositionOf positionOf,
                               EachDependency eachDependency) {
  struct Key {
    std::uint64_t prefix;
    NodeType* node;
  };
  std::deque<NodeType> nodes;
  std::vector<NodeType*> nodeAt(count, nullptr);
  std::vector<Key> byName;
  byName.reserve(items.size());
  for (const Item* item : items) {
    NodeType* node = nodeAt[positionOf(*item)] = &nodes.emplace_back(*item);
    byName.push_back({HX_PrefixOf(node->getName().cstring()), node});
  }
  // The order of the document does not decide between equal nodes.
  std::sort(byName.begin(), byName.end(), [](const Key& a, const Key& b) {
    if (a.prefix != b.prefix) return a.prefix < b.prefix;
    return a.node->compareNames(*b.node) < 0;
  });

  ByWidth byWidth;
  ByName byNames;
  leda::array<HxCDepSortComp*> criteria(2);
  criteria[0] = &byWidth;
  criteria[1] = &byNames;
  HxCDependencySorting sorting;
  sorting.setSortingCriteriaAndInit(criteria);
  for (const Key& key : byName) sorting.add(key.node);
  for (const Key& key : byName) {
    eachDependency(key.node->item, [&](std::size_t before) {
      if (nodeAt[before] != nullptr)
        sorting.addDependency(nodeAt[before], key.node);
    });
  }
  std::vector<const Item*> ordered;
  ordered.reserve(items.size());
  if (!sorting.sort()) return ordered;
  for (HxCDepSortNode* node : sorting.getNodes())
    ordered.push_back(&static_cast<NodeType*>(node)->item);
  return ordered;
}

std::vector<const HX_FormedName*> ordered(
    const std::vector<const HX_FormedName*>& variables, std::size_t count) {
  return order<HxCSsNode>(
      variables, count,
      [](const HX_FormedName& name) { return name.wanted->index; },
      [](const HX_FormedName& name, auto use) {
        for (const HX_WantedName* wanted : name.wanted->dependsOn)
          use(wanted->index);
      });
}

}  // namespace

std::vector<const HX_TypeItem*> HX_OrderTypes(const HX_Model& model) {
  std::vector<const HX_TypeItem*> types;
  types.reserve(model.types.size());
  if (model.typeCircle.items.empty())
    for (const HX_TypeItem& type : model.types) types.push_back(&type);
  for (const std::size_t index : model.typeCircle.items)
    types.push_back(&model.types[index]);
  return order<HxCSdtNode>(
      types, model.types.size(),
      [](const HX_TypeItem& type) { return type.index; },
      [](const HX_TypeItem& type, auto add) {
        if (type.of != nullptr) add(type.of->index);
        for (const HX_TypeItem::Field& field : type.fields)
          add(field.type->index);
      });
}

std::vector<const HX_FormedName*> HX_OrderVariables(
    const HX_Model& model, const std::deque<HX_FormedName>& names) {
  std::vector<const HX_FormedName*> variables;
  const auto add = [&](const HX_FormedName& name) {
    if (name.wanted->kind == HX_NameKind::eVariable && name.isDefined)
      variables.push_back(&name);
  };
  const std::vector<std::size_t>& circle = model.variableCircle.items;
  const bool isWhole =
      std::all_of(circle.begin(), circle.end(),
                  [&](std::size_t index) { return names[index].isDefined; });
  if (circle.empty() || !isWhole)
    for (const HX_FormedName& name : names) add(name);
  else
    for (const std::size_t index : circle) add(names[index]);
  return ordered(variables, names.size());
}

std::vector<const HX_FormedName*> HX_OrderVariables(
    const std::vector<const HX_FormedName*>& names, std::size_t count) {
  std::vector<const HX_FormedName*> variables;
  for (const HX_FormedName* name : names)
    if (name->wanted->kind == HX_NameKind::eVariable && name->isDefined)
      variables.push_back(name);
  return ordered(variables, count);
}
