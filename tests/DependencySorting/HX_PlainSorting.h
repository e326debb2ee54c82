// The order of HxCDependencySorting in its plain form: quadratic, recursive and
// short enough to be read.

#ifndef DEPENDENCYSORTING_HX_PLAINSORTING_H
#define DEPENDENCYSORTING_HX_PLAINSORTING_H

#include <algorithm>
#include <deque>
#include <map>
#include <string>
#include <utility>
#include <vector>

#include "DependencySorting/HxCDepSortComp.h"
#include "DependencySorting/HxCDepSortNode.h"
#include "platform/strings/KyCXString.h"

class HX_PlainSorting {
 public:
  using Node = HxCDepSortNode*;

  void setSortingCriteriaAndInit(std::vector<HxCDepSortComp*> criteria) {
    m_Criteria = std::move(criteria);
    m_Nodes.clear();
    m_Dependencies.clear();
  }
  void add(Node node) { m_Nodes.push_back(node); }
  void addDependency(Node first, Node second) {
    m_Dependencies.push_back({first, second});
  }
  void reinit() {
    m_Nodes.clear();
    m_Dependencies.clear();
    m_Graph.clear();
  }

  bool sort() {
    std::map<Node, Vertex*> vertexOf;
    for (Node node : m_Nodes)
      vertexOf[node] = &m_Graph.emplace_back(Vertex{node, {}, 0, false});
    ignored = 0;
    for (auto [first, second] : std::exchange(m_Dependencies, {})) {
      if (vertexOf.count(first) == 0 || vertexOf.count(second) == 0) {
        ++ignored;
        continue;
      }
      vertexOf[first]->out.push_back(vertexOf[second]);
      ++vertexOf[second]->in;
    }
    return sortGraph();
  }

  std::vector<Node> result;
  int ignored = 0;     // dependencies of the last sort with unknown nodes
  std::string report;  // kind and names of the last cycle

 private:
  struct Vertex {
    Node node;
    std::vector<Vertex*> out;
    int in;
    bool hidden;
  };
  using Batch = std::vector<Vertex*>;

  static const KyCXString& nameOf(Node node) {
    static const KyCXString s_Empty;
    return node == nullptr ? s_Empty : node->getName();
  }

  Batch visible() {
    Batch found;
    for (Vertex& v : m_Graph) {
      if (!v.hidden) found.push_back(&v);
    }
    return found;
  }

  bool sortGraph() {
    const int n = static_cast<int>(visible().size());
    result.resize(visible().size());
    int f = n - 1;
    for (Vertex* v : visible()) {
      if (v->in != 0 || !v->out.empty()) continue;
      if (v->node == nullptr) return false;
      at(f--) = v->node;
      v->hidden = true;
    }
    sortByCriteria(f + 1, n - 1, 0);
    if (f >= 0 && !sortTopologically()) return false;
    for (Vertex& v : m_Graph) v.hidden = false;
    return true;
  }

  bool sortTopologically() {
    std::map<Vertex*, int> counter;
    std::deque<Vertex*> queue;
    Batch batch;
    for (Vertex* v : visible()) {
      counter[v] = v->in;
      if (v->in == 0) batch.push_back(v);
    }
    int k = 0;
    while (true) {
      sortByName(batch);
      queue.insert(queue.end(), batch.begin(), batch.end());
      if (queue.empty()) break;
      Vertex* v = queue.front();
      queue.pop_front();
      at(k++) = v->node;
      batch.clear();
      for (Vertex* target : v->out) {
        if (--counter[target] == 0) batch.push_back(target);
      }
    }
    if (k == static_cast<int>(visible().size())) return true;
    const bool isVariable =
        visible()[0]->node && visible()[0]->node->isSsNode();
    report = isVariable ? "variables : " : "data types : ";
    for (Vertex* v : visible()) {
      if (v != visible()[0]) report += ", ";
      report += nameOf(v->node).cstring();
    }
    return false;
  }

  static void sortByName(Batch& batch) {
    const auto precedes = [](const Vertex* a, const Vertex* b) {
      return nameOf(a->node).compareWith(nameOf(b->node)) < 0;
    };
    for (auto i = batch.begin(); i != batch.end(); ++i)
      std::iter_swap(i, std::min_element(i, batch.end(), precedes));
  }

  void sortByCriteria(int lo, int hi, std::size_t level) {
    if (level == m_Criteria.size() || lo >= hi) return;
    HxCDepSortComp* comp = m_Criteria[level];
    HxCDepSortNode::setComp(comp);
    quicksort(lo, hi, comp);
    int first = lo;
    for (int i = lo; i <= hi; ++i) {
      if (i < hi && comp->compare(at(i), at(i + 1)) == 0) continue;
      sortByCriteria(first, i, level + 1);
      first = i + 1;
    }
  }

  void quicksort(int lo, int hi, HxCDepSortComp* comp) {
    if (hi <= lo) return;
    int i = lo;
    int j = hi - 1;
    while (true) {
      while (i < hi && comp->compare(at(i), at(hi)) < 0) ++i;
      while (j >= lo && comp->compare(at(j), at(hi)) > 0) --j;
      if (i >= j) break;
      std::swap(at(i++), at(j--));
    }
    std::swap(at(i), at(hi));
    quicksort(lo, i - 1, comp);
    quicksort(i + 1, hi, comp);
  }

  Node& at(int place) { return result[static_cast<std::size_t>(place)]; }

  std::vector<HxCDepSortComp*> m_Criteria;
  std::vector<Node> m_Nodes;
  std::vector<std::pair<Node, Node>> m_Dependencies;
  std::deque<Vertex> m_Graph;
};

#endif  // DEPENDENCYSORTING_HX_PLAINSORTING_H
