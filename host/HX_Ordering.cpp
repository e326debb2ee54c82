#include "host/HX_Ordering.h"

#include <algorithm>
#include <deque>
#include <map>

#include "DependencySorting/HxCDepSortComp.h"
#include "DependencySorting/HxCDepSortNode.h"
#include "DependencySorting/HxCDependencySorting.h"
#include "host/HX_Text.h"

namespace {

int widthOf(const HX_TypeItem& type) {
  const HX_TypeItem* scalar = type.scalar();
  return scalar != nullptr && scalar->numerical
             ? scalar->numerical->getBitWidth()
             : 0;
}

// What both kinds of nodes have.
class Node : public HxCDepSortNode {
 public:
  Node(const std::string& name, const std::string& id, int width)
      : m_Name(HX_FromUtf8(name)), m_Id(id), m_Width(width) {}
  const KyCXString& getName() override { return m_Name; }
  int width() const { return m_Width; }
  /// Names repeat in scopes beside each other, ids do not.
  int compareNames(const Node& other) const {
    const int order = leda::compare(m_Name, other.m_Name);
    return order != 0 ? order : m_Id.compare(other.m_Id);
  }

 private:
  KyCXString m_Name;
  std::string m_Id;
  int m_Width;  // bits
};

class ByWidth : public HxCDepSortComp {
  int compare(HxCDepSortNode* a, HxCDepSortNode* b) override {
    return static_cast<Node*>(b)->width() - static_cast<Node*>(a)->width();
  }
};

class ByName : public HxCDepSortComp {
  int compare(HxCDepSortNode* a, HxCDepSortNode* b) override {
    return static_cast<Node*>(a)->compareNames(*static_cast<Node*>(b));
  }
};

}  // namespace

class HxCSdtNode : public Node {
 public:
  explicit HxCSdtNode(const HX_TypeItem& type)
      : Node(type.name, type.id, widthOf(type)), item(&type) {}
  HxCSdtNode* isSdtNode() override { return this; }
  const HX_TypeItem* item;
};

class HxCSsNode : public Node {
 public:
  explicit HxCSsNode(const HX_FormedName& name)
      : Node(name.actual, name.item->id, widthOf(*name.item->type)),
        item(&name) {}
  HxCSsNode* isSsNode() override { return this; }
  const HX_FormedName* item;
};

namespace {

// The nodes are added by name, so that ties fall the same way whatever the
// order of the document.
template <class NodeType, class Item, class Before>
bool order(std::deque<NodeType>& nodes, Before before,
           std::vector<const Item*>& ordered) {
  std::vector<NodeType*> byName;
  for (NodeType& node : nodes) byName.push_back(&node);
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
    before(*node->item,
           [&](NodeType* first) { sorting.addDependency(first, node); });
  }
  ordered.clear();
  if (!sorting.sort()) return false;
  const leda::array<HxCDepSortNode*> result = sorting.getNodes();
  for (int i = result.low(); i <= result.high(); ++i)
    ordered.push_back(static_cast<NodeType*>(result[i])->item);
  return true;
}

}  // namespace

bool HX_OrderTypes(const HX_Model& model,
                   std::vector<const HX_TypeItem*>& ordered) {
  std::deque<HxCSdtNode> nodes;
  std::map<const HX_TypeItem*, HxCSdtNode*> nodeOf;
  for (const auto& type : model.types()) {
    nodes.emplace_back(*type);
    nodeOf[type.get()] = &nodes.back();
  }
  return order(
      nodes,
      [&](const HX_TypeItem& type, auto add) {
        if (type.of != nullptr) add(nodeOf.at(type.of));
        for (const auto& [name, field] : type.fields) add(nodeOf.at(field));
      },
      ordered);
}

bool HX_OrderVariables(const std::vector<HX_FormedName>& names,
                       std::vector<const HX_FormedName*>& ordered) {
  std::deque<HxCSsNode> nodes;
  std::map<const HX_NameItem*, HxCSsNode*> nodeOf;
  for (const HX_FormedName& name : names) {
    if (name.item->kind != "variable" || !name.isDefined) continue;
    nodes.emplace_back(name);
    nodeOf[name.item] = &nodes.back();
  }
  return order(
      nodes,
      [&](const HX_FormedName& name, auto add) {
        for (const HX_NameItem* other : name.item->dependsOn) {
          const auto found = nodeOf.find(other);
          if (found != nodeOf.end()) add(found->second);
        }
      },
      ordered);
}
