// The graph behind HxCDependencySorting, and the sort.

#ifndef DEPENDENCYSORTING_IMPLDEPENDENCYSORTING_HXCDEPSORTINGGRAPH_H
#define DEPENDENCYSORTING_IMPLDEPENDENCYSORTING_HXCDEPSORTINGGRAPH_H

#include <cstddef>
#include <utility>
#include <vector>

#include "Control/HX_Allocated.h"
#include "platform/containers/array.h"

class HxCDepSortComp;
class HxCDepSortNode;

/// Vertices and edges keep the order of their creation. A vertex is known by
/// its number, from 0.
class HxCDepSortingGraph : public HX_Allocated {
 public:
  void setCriteria(const leda::array<HxCDepSortComp*>& criteria) {
    m_Criteria = criteria;
  }

  /// Adds a vertex for each node, then an edge for each dependency between
  /// these vertices. A dependency with any other node raises the internal
  /// assertion and is ignored.
  void append(
      const std::vector<HxCDepSortNode*>& nodes,
      const std::vector<std::pair<HxCDepSortNode*, HxCDepSortNode*>>& edges);

  /// See HxCDependencySorting::sort().
  ///
  /// After a failure \p result holds, at its end, the nodes without
  /// dependencies (up to the null pointer, if that was the reason) and, after
  /// a cycle, at its front the nodes that do not hang on it; what lies between
  /// is left from before.
  bool sort(leda::array<HxCDepSortNode*>& result);

  /// Removes vertices and edges.
  void clear();

 private:
  struct Edge {
    int source;
    int target;
  };
  // The edges by their source, each source's in the order of creation.
  struct Adjacency {
    std::vector<int> begin;    // by vertex, and one more: place in targets
    std::vector<int> targets;  // by place
    std::vector<int> inDegree;

    bool isIsolated(int vertex) const;
  };

  int vertexCount() const { return static_cast<int>(m_Nodes.size()); }
  Adjacency adjacency() const;
  int countHidden(const Adjacency& edges) const;
  bool placeIsolated(const Adjacency& edges,
                     leda::array<HxCDepSortNode*>& result, int& free);
  std::vector<int> topologicalOrder(const Adjacency& edges, int count) const;
  bool reportCycle(const Adjacency& edges) const;

  leda::array<HxCDepSortComp*> m_Criteria;
  std::vector<HxCDepSortNode*> m_Nodes;  // by vertex
  std::vector<Edge> m_Edges;
  // A failed sort leaves the isolated vertices below this one hidden. Whatever
  // is added, the next sort meets the same obstacle, up to clear().
  int m_HiddenEnd = 0;
};

#endif  // DEPENDENCYSORTING_IMPLDEPENDENCYSORTING_HXCDEPSORTINGGRAPH_H
