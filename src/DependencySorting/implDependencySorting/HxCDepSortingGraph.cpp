#include "DependencySorting/implDependencySorting/HxCDepSortingGraph.h"

#include <span>

#include "Control/ERR_Messages.h"
#include "Control/HX_SelfCheck.h"
#include "DependencySorting/HxCDepSortNode.h"
#include "DependencySorting/implDependencySorting/HX_CriteriaSort.h"
#include "DependencySorting/implDependencySorting/HX_NameSort.h"
#include "DependencySorting/implDependencySorting/HX_NodeIndex.h"
#include "Trace/HxCTraceFallThrough.h"
#include "platform/strings/KyCXString.h"

namespace {

constexpr char kErrorCode[] = __FILE__ "_";

// The place that the trace names; it stays when lines move.
constexpr char kTracedFile[] =
    "DependencySorting/implDependencySorting/HxCDepSortingGraph";
constexpr int kTracedLine = 501;

std::size_t at(int index) { return static_cast<std::size_t>(index); }

}  // namespace

void HxCDepSortingGraph::append(
    const std::vector<HxCDepSortNode*>& nodes,
    const std::vector<std::pair<HxCDepSortNode*, HxCDepSortNode*>>& edges) {
  int vertex = vertexCount();
  m_Nodes.insert(m_Nodes.end(), nodes.begin(), nodes.end());
  if (edges.empty()) return;

  HX_NodeIndex index(nodes.size());
  for (HxCDepSortNode* node : nodes) index.set(node, vertex++);
  m_Edges.reserve(m_Edges.size() + edges.size());
  for (const auto& [first, second] : edges) {
    const Edge edge = {index.find(first), index.find(second)};
    if (HX_Assert(edge.source >= 0 && edge.target >= 0, kErrorCode))
      m_Edges.push_back(edge);
  }
}

bool HxCDepSortingGraph::sort(leda::array<HxCDepSortNode*>& result) {
  const Adjacency edges = adjacency();
  int dependent = vertexCount() - countHidden(edges);
  result.resize(dependent);
  if (!placeIsolated(edges, result, dependent)) return false;

  const std::span<HxCDepSortNode*> all(result.begin(), result.end());
  HX_CriteriaSort().sort(all.subspan(at(dependent)), m_Criteria);
  const std::vector<int> order = topologicalOrder(edges, dependent);
  for (std::size_t place = 0; place < order.size(); ++place)
    all[place] = m_Nodes[at(order[place])];
  if (order.size() == at(dependent)) return true;

  m_HiddenEnd = vertexCount();
  return reportCycle(edges);
}

void HxCDepSortingGraph::clear() {
  m_Nodes.clear();
  m_Edges.clear();
  m_HiddenEnd = 0;
}

bool HxCDepSortingGraph::Adjacency::isIsolated(int vertex) const {
  return inDegree[at(vertex)] == 0 &&
         begin[at(vertex)] == begin[at(vertex) + 1];
}

HxCDepSortingGraph::Adjacency HxCDepSortingGraph::adjacency() const {
  Adjacency result;
  result.begin.resize(m_Nodes.size() + 1);
  result.targets.resize(m_Edges.size());
  result.inDegree.resize(m_Nodes.size());
  for (const Edge& edge : m_Edges) {
    ++result.begin[at(edge.source) + 1];
    ++result.inDegree[at(edge.target)];
  }
  for (std::size_t i = 1; i < result.begin.size(); ++i)
    result.begin[i] += result.begin[i - 1];
  std::vector<int> next(result.begin);
  for (const Edge& edge : m_Edges)
    result.targets[at(next[at(edge.source)]++)] = edge.target;
  return result;
}

int HxCDepSortingGraph::countHidden(const Adjacency& edges) const {
  int count = 0;
  for (int vertex = 0; vertex < m_HiddenEnd; ++vertex)
    count += edges.isIsolated(vertex) ? 1 : 0;
  return count;
}

// Fills the result from its end; the first \p free places remain. False if the
// walk meets null.
bool HxCDepSortingGraph::placeIsolated(const Adjacency& edges,
                                       leda::array<HxCDepSortNode*>& result,
                                       int& free) {
  for (int vertex = 0; vertex < vertexCount(); ++vertex) {
    if (!edges.isIsolated(vertex) || vertex < m_HiddenEnd) continue;
    if (m_Nodes[at(vertex)] == nullptr) {
      m_HiddenEnd = vertex;
      return false;
    }
    result[--free] = m_Nodes[at(vertex)];
  }
  return true;
}

// The vertices with edges, of which there are \p count, in the order in which
// they become free. Those on a cycle or behind one are missing.
std::vector<int> HxCDepSortingGraph::topologicalOrder(const Adjacency& edges,
                                                      int count) const {
  std::vector<int> order;  // also the queue: a place is taken when it is left
  order.reserve(at(count));
  HX_NameSort byName(m_Nodes);
  for (int vertex = 0; vertex < vertexCount(); ++vertex) {
    if (edges.inDegree[at(vertex)] == 0 && !edges.isIsolated(vertex))
      order.push_back(vertex);
  }
  byName.sort(order);

  std::vector<int> waitsFor = edges.inDegree;
  for (std::size_t head = 0; head < order.size(); ++head) {
    const std::size_t batch = order.size();
    const std::size_t vertex = at(order[head]);
    for (int i = edges.begin[vertex]; i < edges.begin[vertex + 1]; ++i) {
      const int target = edges.targets[at(i)];
      if (--waitsFor[at(target)] == 0) order.push_back(target);
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
    HxCDepSortNode* node = m_Nodes[at(vertex)];
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
