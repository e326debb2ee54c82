#include "DependencySorting/HxCDependencySorting.h"

#include "DependencySorting/implDependencySorting/HxCDepSortingGraph.h"

HxCDependencySorting::HxCDependencySorting()
    : m_Graph(new HxCDepSortingGraph) {}

HxCDependencySorting::~HxCDependencySorting() = default;

void HxCDependencySorting::setSortingCriteriaAndInit(
    const leda::array<HxCDepSortComp*>& criteria) {
  m_Criteria = criteria;
  forgetPending();
}

void HxCDependencySorting::add(HxCDepSortNode* node) {
  m_Nodes.push_back(node);
}

void HxCDependencySorting::addDependency(HxCDepSortNode* first,
                                         HxCDepSortNode* second) {
  m_Dependencies.emplace_back(first, second);
}

bool HxCDependencySorting::sort() {
  if (m_Graph == nullptr) return false;
  m_Graph->setCriteria(m_Criteria);
  m_Graph->append(m_Nodes, m_Dependencies);
  m_Dependencies.clear();
  return m_Graph->sort(m_Result);
}

leda::array<HxCDepSortNode*> HxCDependencySorting::getNodes() {
  return m_Result;
}

void HxCDependencySorting::reinit() {
  forgetPending();
  if (m_Graph != nullptr) m_Graph->clear();
}

void HxCDependencySorting::forgetPending() {
  m_Nodes.clear();
  m_Dependencies.clear();
}
