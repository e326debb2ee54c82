// The dependency sorter with criteria that contradict themselves: every result
// holds the same nodes, with all dependencies respected.
#include <algorithm>
#include <deque>
#include <vector>

#include "DependencySorting/HxCDepSortComp.h"
#include "DependencySorting/HxCDepSortNode.h"
#include "DependencySorting/HxCDependencySorting.h"
#include "fuzz/HX_Fuzz.h"

namespace {

class Node : public HxCDepSortNode {
 public:
  Node(int number, int sortingKey)
      : key(sortingKey), m_Name(number % 5, false, true) {}
  const KyCXString& getName() override { return m_Name; }

  const int key;
  bool isDependent = false;
  int place = -1;  // in the result

 private:
  const KyCXString m_Name;
};

// Kind 0 compares keys; every other kind breaks the rules of a criterion.
class Criterion : public HxCDepSortComp {
 public:
  Criterion(int kind, HX_Bytes& answers) : m_Kind(kind), m_Answers(answers) {}

  int compare(HxCDepSortNode* a, HxCDepSortNode* b) override {
    const int order = static_cast<Node*>(a)->key - static_cast<Node*>(b)->key;
    ++m_Calls;
    switch (m_Kind) {
      case 1:
        return m_Answers.number() % 3 - 1;
      case 2:
        return m_Calls % 7 == 0 ? -order : order;
      case 3:
        return m_Calls < 20 ? order : 1;
      case 4:
        return m_Calls < 20 ? order : -1;
      case 5:
        return a == b ? 1 : order;
      case 6:
        return m_Calls % 11 == 0 ? 0 : order;
      default:
        return order;
    }
  }

 private:
  int m_Kind;
  int m_Calls = 0;
  HX_Bytes& m_Answers;
};

// Shapes of keys on which Quicksort runs out of its budget, and keys from the
// input.
int keyOf(int shape, int i, int count, HX_Bytes& bytes) {
  switch (shape) {
    case 1:
      return i < 2 ? count - 2 + i : count - 1 - i;
    case 2:
      return (i < 2 ? count - 2 + i : count - 1 - i) / 3;
    case 3:
      return i % 2 == 0 ? i : count - i;
    default:
      return bytes.below(8);
  }
}

}  // namespace

void HX_CheckSorter(HX_Bytes& bytes) {
  const int count = bytes.number();
  const int shape = bytes.below(4);
  bool areConsistent = true;
  std::deque<Criterion> criteria;
  leda::array<HxCDepSortComp*> list(1 + bytes.below(3));
  for (HxCDepSortComp*& criterion : list) {
    const int kind = bytes.below(7);
    areConsistent &= kind == 0;
    criterion = &criteria.emplace_back(kind, bytes);
  }
  HxCDependencySorting sorting;
  sorting.setSortingCriteriaAndInit(list);
  std::deque<Node> nodes;
  for (int i = 0; i < count; ++i)
    sorting.add(&nodes.emplace_back(i, keyOf(shape, i, count, bytes)));
  std::vector<std::pair<Node*, Node*>> edges;
  for (int i = count < 2 ? 0 : bytes.below(64); i > 0; --i) {
    const int second = 1 + bytes.below(count - 1);
    const int first = bytes.below(second);
    edges.emplace_back(&nodes[static_cast<std::size_t>(first)],
                       &nodes[static_cast<std::size_t>(second)]);
    sorting.addDependency(edges.back().first, edges.back().second);
    edges.back().first->isDependent = edges.back().second->isDependent = true;
  }

  HX_Require(sorting.sort(), "edges from lower to higher numbers sort");
  const leda::array<HxCDepSortNode*> result = sorting.getNodes();
  HX_Require(result.size() == count, "as many nodes come out as went in");
  const Node* before = nullptr;
  for (int place = 0; place < count; ++place) {
    const auto known =
        std::find_if(nodes.begin(), nodes.end(),
                     [&](const Node& node) { return &node == result[place]; });
    HX_Require(known != nodes.end(), "only added nodes come out");
    HX_Require(known->place < 0, "no node comes out twice");
    known->place = place;
    if (known->isDependent) {
      HX_Require(before == nullptr, "dependent nodes come first");
      continue;
    }
    HX_Require(!areConsistent || before == nullptr || before->key <= known->key,
               "isolated nodes ascend");
    before = &*known;
  }
  for (const auto& [first, second] : edges)
    HX_Require(first->place < second->place, "every dependency is respected");
}
