// Kahn's topological sort (Kahn 1962), a queue of vertices without open
// predecessors. Vertices freed by one vertex enter the queue as a batch in
// ascending order of names (HX_NameSort). Vertices without edges leave the
// graph first, fill the result from the end and are ordered by the criteria
// (HX_CriteriaSort).
//
// Example, edges A-C, A-D, B-C, isolated X, Y, no criteria:
//   isolated     . . . . Y X
//   batch A B    A B . . Y X   A frees D, B frees C
//   queue        A B D C Y X
//
// COST: O(V + E) besides the sorting of batches and of isolated vertices.
// Test: DependencySortingTest.RandomUseSortsAsInThePlainForm.

#include "DependencySorting/implDependencySorting/HxCDepSortingGraph.h"

#include <new>
#include <span>

#include "Control/ERR_Messages.h"
#include "Control/HX_SelfCheck.h"
#include "DependencySorting/HxCDepSortNode.h"
#include "DependencySorting/implDependencySorting/HX_CriteriaSort.h"
#include "DependencySorting/implDependencySorting/HX_NameSort.h"
#include "Trace/HxCTraceFallThrough.h"
#include "implContainers/HX_HashTable.h"
#include "implContainers/HX_Vector.h"
#include "platform/strings/KyCXString.h"

namespace {

constexpr char kGraphErrorCode[] = __FILE__ "_";

// Place in the text of the trace, fixed whatever moves in this file.
constexpr char kTracedFile[] =
    "DependencySorting/implDependencySorting/HxCDepSortingGraph";
constexpr int kTracedLine = 501;

// Vertex of a node. A standard map would take most of the time of a sort. No
// walk over the table, because addresses must not reach the order.
class VertexOfNode {
 public:
  explicit VertexOfNode(std::size_t count) {
    if (!m_Table.reserve(static_cast<unsigned>(count))) throw std::bad_alloc();
  }

  // A later vertex replaces an earlier vertex of the node. Null is a node, too.
  void set(const HxCDepSortNode* node, int vertex) {
    if (auto* slot = m_Table.find(node))
      slot->value = vertex;
    else
      m_Table.add(node, vertex);
  }

  // -1 for an unknown node.
  int find(const HxCDepSortNode* node) const {
    const auto* slot = m_Table.find(node);
    return slot == nullptr ? -1 : slot->value;
  }

 private:
  HX_HashTable<const HxCDepSortNode*, int> m_Table;
};

}  // namespace

bool HxCDepSortingGraph::sort(const Nodes& nodes,
                              const Dependencies& dependencies,
                              const Criteria& criteria, Result& result) {
  const std::size_t nodeCount = m_Nodes.size();
  const std::size_t edgeCount = m_Edges.size();
  append(nodes, dependencies);
  try {
    return sort(criteria, result);
  } catch (...) {
    m_Nodes.resize(nodeCount);
    m_Edges.resize(edgeCount);
    throw;
  }
}

// Throws std::bad_alloc, with nothing changed.
void HxCDepSortingGraph::append(const Nodes& nodes,
                                const Dependencies& dependencies) {
  HX_Vector<Edge> edges;
  if (!dependencies.empty()) {
    VertexOfNode vertexOf(nodes.size());
    int vertex = vertexCount();
    for (HxCDepSortNode* node : nodes) vertexOf.set(node, vertex++);
    edges.reserve(dependencies.size());
    for (const auto& [first, second] : dependencies) {
      const Edge edge = {vertexOf.find(first), vertexOf.find(second)};
      if (HX_Assert(edge.source >= 0 && edge.target >= 0, kGraphErrorCode))
        edges.push_back(edge);
    }
  }
  m_Edges.reserve(m_Edges.size() + edges.size());
  m_Nodes.insert(m_Nodes.end(), nodes.begin(), nodes.end());
  m_Edges.insert(m_Edges.end(), edges.begin(), edges.end());
}

bool HxCDepSortingGraph::sort(const Criteria& criteria, Result& result) {
  const Adjacency edges = adjacency();
  const int isolatedEnd = vertexCount() - countHidden(edges);
  int dependent = isolatedEnd;
  result.resize(isolatedEnd);
  if (!placeIsolated(edges, result, dependent)) return false;
  if (isolatedEnd == 0) return true;

  HxCDepSortNode** const all = &result[0];
  HX_CriteriaSort().sort(all + dependent, isolatedEnd - dependent, criteria);
  const HX_Vector<int> order = topologicalOrder(edges, dependent);
  for (std::size_t place = 0; place < order.size(); ++place)
    all[place] = m_Nodes[HX_ToSize(order[place])];
  if (order.size() == HX_ToSize(dependent)) return true;

  reportCycle(edges);
  m_HiddenEnd = vertexCount();
  return false;
}

void HxCDepSortingGraph::clear() {
  m_Nodes.clear();
  m_Edges.clear();
  m_HiddenEnd = 0;
}

bool HxCDepSortingGraph::Adjacency::isIsolated(int vertex) const {
  return inDegree[HX_ToSize(vertex)] == 0 &&
         begin[HX_ToSize(vertex)] == begin[HX_ToSize(vertex) + 1];
}

HxCDepSortingGraph::Adjacency HxCDepSortingGraph::adjacency() const {
  Adjacency result;
  result.begin.resize(m_Nodes.size() + 1);
  result.targets.resize(m_Edges.size());
  result.inDegree.resize(m_Nodes.size());
  for (const Edge& edge : m_Edges) {
    ++result.begin[HX_ToSize(edge.source) + 1];
    ++result.inDegree[HX_ToSize(edge.target)];
  }
  for (std::size_t i = 1; i < result.begin.size(); ++i)
    result.begin[i] += result.begin[i - 1];
  HX_Vector<int> next(result.begin);
  for (const Edge& edge : m_Edges)
    result.targets[HX_ToSize(next[HX_ToSize(edge.source)]++)] = edge.target;
  return result;
}

int HxCDepSortingGraph::countHidden(const Adjacency& edges) const {
  int count = 0;
  for (int vertex = 0; vertex < m_HiddenEnd; ++vertex)
    count += edges.isIsolated(vertex) ? 1 : 0;
  return count;
}

// Fills the result from the end; the first \p free places remain.
// RETURNS: false if the walk meets null.
bool HxCDepSortingGraph::placeIsolated(const Adjacency& edges, Result& result,
                                       int& free) {
  for (int vertex = 0; vertex < vertexCount(); ++vertex) {
    if (!edges.isIsolated(vertex) || vertex < m_HiddenEnd) continue;
    if (m_Nodes[HX_ToSize(vertex)] == nullptr) {
      m_HiddenEnd = vertex;
      return false;
    }
    result[--free] = m_Nodes[HX_ToSize(vertex)];
  }
  return true;
}

// RETURNS: the \p count vertices with edges in the order in which the vertices
// become free, without vertices on a cycle or behind a cycle.
HX_Vector<int> HxCDepSortingGraph::topologicalOrder(const Adjacency& edges,
                                                    int count) const {
  HX_Vector<int> order;  // also the queue: its head moves, nothing leaves
  order.reserve(HX_ToSize(count));
  HX_NameSort byName(m_Nodes);
  for (int vertex = 0; vertex < vertexCount(); ++vertex) {
    if (edges.inDegree[HX_ToSize(vertex)] == 0 && !edges.isIsolated(vertex))
      order.push_back(vertex);
  }
  byName.sort(order);

  HX_Vector<int> waitsFor = edges.inDegree;
  for (std::size_t head = 0; head < order.size(); ++head) {
    const std::size_t batch = order.size();
    const std::size_t vertex = HX_ToSize(order[head]);
    for (int i = edges.begin[vertex]; i < edges.begin[vertex + 1]; ++i) {
      const int target = edges.targets[HX_ToSize(i)];
      if (--waitsFor[HX_ToSize(target)] == 0) order.push_back(target);
    }
    byName.sort(std::span(order).subspan(batch));
  }
  return order;
}

bool HxCDepSortingGraph::reportCycle(const Adjacency& edges) const {
  const char* kind = nullptr;
  KyCXString list;
  for (int vertex = 0; vertex < vertexCount(); ++vertex) {
    if (edges.isIsolated(vertex)) continue;
    HxCDepSortNode* node = m_Nodes[HX_ToSize(vertex)];
    if (kind == nullptr) {
      const bool isVariable = node != nullptr && node->isSsNode() != nullptr;
      kind = isVariable ? "variables" : "data types";
    } else {
      list += ", ";
    }
    list += HX_NameOfNode(node);
  }
  ERR_Msg403(kind, list.cstring());
  return HxCTraceFallThrough().throwNote(kTracedFile, kTracedLine);
}
