// Graph behind HxCDependencySorting, and the sort.

#ifndef DEPENDENCYSORTING_IMPLDEPENDENCYSORTING_HXCDEPSORTINGGRAPH_H
#define DEPENDENCYSORTING_IMPLDEPENDENCYSORTING_HXCDEPSORTINGGRAPH_H

#include <utility>

#include "Control/HX_Allocated.h"
#include "implContainers/HX_Vector.h"
#include "platform/containers/array.h"

class HxCDepSortComp;
class HxCDepSortNode;

/// Vertices and edges keep the order of their creation. Vertices are numbered
/// from 0.
class HxCDepSortingGraph : public HX_Allocated {
 public:
  using Nodes = HX_Vector<HxCDepSortNode*>;
  using Dependencies = HX_Vector<std::pair<HxCDepSortNode*, HxCDepSortNode*>>;
  using Criteria = leda::array<HxCDepSortComp*>;
  using Result = leda::array<HxCDepSortNode*>;

  /// Adds a vertex for every node, then an edge for every dependency between
  /// these vertices, and sorts; see HxCDependencySorting::sort(). A dependency
  /// with any other node raises the internal assertion and is ignored.
  ///
  /// After a failure \p result holds, at the end, the nodes without
  /// dependencies (up to the null pointer, if null was the reason) and, after a
  /// cycle, at the front the nodes that do not depend on the cycle; the places
  /// between keep their nodes from before. Throws std::bad_alloc, with the
  /// graph unchanged and \p result undefined.
  bool sort(const Nodes& nodes, const Dependencies& dependencies,
            const Criteria& criteria, Result& result);

  /// Removes vertices and edges.
  void clear();

 private:
  struct Edge {
    int source;
    int target;
  };
  // Edges by source; the edges of a source keep the order of their creation.
  struct Adjacency {
    HX_Vector<int> begin;    // by vertex, and one more: place in targets
    HX_Vector<int> targets;  // by place
    HX_Vector<int> inDegree;

    bool isIsolated(int vertex) const;
  };

  int vertexCount() const { return static_cast<int>(m_Nodes.size()); }
  void append(const Nodes& nodes, const Dependencies& dependencies);
  bool sort(const Criteria& criteria, Result& result);
  Adjacency adjacency() const;
  int countHidden(const Adjacency& edges) const;
  bool placeIsolated(const Adjacency& edges, Result& result, int& free);
  HX_Vector<int> topologicalOrder(const Adjacency& edges, int count) const;
  bool reportCycle(const Adjacency& edges) const;

  Nodes m_Nodes;  // by vertex
  HX_Vector<Edge> m_Edges;
  // Isolated vertices below this number stay hidden after a failed sort. The
  // next sort meets the same obstacle, whatever is added, up to clear().
  int m_HiddenEnd = 0;
};

#endif  // DEPENDENCYSORTING_IMPLDEPENDENCYSORTING_HXCDEPSORTINGGRAPH_H
