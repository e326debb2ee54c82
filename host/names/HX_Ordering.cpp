#include "host/names/HX_Ordering.h"

#include <algorithm>
#include <deque>
#include <unordered_map>

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

template <class NodeType, class Item, class DependenciesOf>
std::vector<const Item*> order(const std::vector<const Item*>& items,
                               DependenciesOf dependenciesOf) {
  std::deque<NodeType> nodes;
  std::unordered_map<const Item*, NodeType*> nodeOf;  // looked up, never walked
  std::vector<NodeType*> byName;
  byName.reserve(items.size());
  for (const Item* item : items)
    byName.push_back(nodeOf[item] = &nodes.emplace_back(*item));
  // The order of the document does not decide between equal nodes.
  std::sort(byName.begin(), byName.end(),
            [](NodeType* a, NodeType* b) { return a->compareNames(*b) < 0; });

  ByWidth byWidth;
  ByName byNames;
  leda::array<HxCDepSortComp*> criteria(2);
  criteria[0] = &byWidth;
  criteria[1] = &byNames;
  HxCDependencySorting sorting;
  sorting.setSortingCriteriaAndInit(criteria);
  for (NodeType* node : byName) sorting.add(node);
  for (NodeType* node : byName) {
    for (const Item* first : dependenciesOf(node->item)) {
      const auto found = nodeOf.find(first);
      if (found != nodeOf.end()) sorting.addDependency(found->second, node);
    }
  }
  std::vector<const Item*> ordered;
  ordered.reserve(items.size());
  if (!sorting.sort()) return ordered;
  for (HxCDepSortNode* node : sorting.getNodes())
    ordered.push_back(&static_cast<NodeType*>(node)->item);
  return ordered;
}

}  // namespace

std::vector<const HX_TypeItem*> HX_OrderTypes(const HX_Model& model) {
  std::vector<const HX_TypeItem*> types;
  types.reserve(model.types.size());
  if (model.typeCircle.items.empty())
    for (const HX_TypeItem& type : model.types) types.push_back(&type);
  for (const std::size_t index : model.typeCircle.items)
    types.push_back(&model.types[index]);
  return order<HxCSdtNode>(types, [](const HX_TypeItem& type) {
    std::vector<const HX_TypeItem*> before{type.of};
    for (const HX_TypeItem::Field& field : type.fields)
      before.push_back(field.type);
    return before;
  });
}

std::vector<const HX_FormedName*> HX_OrderVariables(
    const HX_Model& model, const std::deque<HX_FormedName>& names) {
  std::vector<const HX_FormedName*> variables;
  std::unordered_map<const HX_WantedName*, const HX_FormedName*> formedOf;
  const auto add = [&](const HX_FormedName& name) {
    if (name.wanted->kind != HX_NameKind::eVariable || !name.isDefined) return;
    variables.push_back(&name);
    formedOf.emplace(name.wanted, &name);
  };
  const std::vector<std::size_t>& circle = model.variableCircle.items;
  const bool isWhole =
      std::all_of(circle.begin(), circle.end(),
                  [&](std::size_t index) { return names[index].isDefined; });
  if (circle.empty() || !isWhole)
    for (const HX_FormedName& name : names) add(name);
  else
    for (const std::size_t index : circle) add(names[index]);
  return order<HxCSsNode>(variables, [&](const HX_FormedName& name) {
    std::vector<const HX_FormedName*> before;
    for (const HX_WantedName* wanted : name.wanted->dependsOn) {
      const auto found = formedOf.find(wanted);
      if (found != formedOf.end()) before.push_back(found->second);
    }
    return before;
  });
}
