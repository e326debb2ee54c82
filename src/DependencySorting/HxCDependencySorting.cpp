#include "DependencySorting/HxCDependencySorting.h"

#include "Control/HX_Memory.h"
#include "DependencySorting/implDependencySorting/HxCDepSortingGraph.h"

HxCDependencySorting::HxCDependencySorting()
    : m_Graph(new HxCDepSortingGraph) {}

HxCDependencySorting::~HxCDependencySorting() = default;

void HxCDependencySorting::setSortingCriteriaAndInit(
    const leda::array<HxCDepSortComp*>& criteria) {
  m_LacksCriteria = !HX_WithinMemory([&] { m_Criteria = criteria; });
  forgetPending();
}

void HxCDependencySorting::add(HxCDepSortNode* node) {
  if (!HX_WithinMemory([&] { m_Nodes.push_back(node); })) m_LacksInput = true;
}

void HxCDependencySorting::addDependency(HxCDepSortNode* first,
                                         HxCDepSortNode* second) {
  if (!HX_WithinMemory([&] { m_Dependencies.emplace_back(first, second); }))
    m_LacksInput = true;
}

bool HxCDependencySorting::sort() {
  if (m_Graph == nullptr || m_LacksInput || m_LacksCriteria) return false;
  return HX_WithinMemory(false, [&] {
    const bool sorted =
        m_Graph->sort(m_Nodes, m_Dependencies, m_Criteria, m_Result);
    m_Dependencies.clear();
    return sorted;
  });
}

leda::array<HxCDepSortNode*> HxCDependencySorting::getNodes() {
  using Result = leda::array<HxCDepSortNode*>;
  return HX_WithinMemory(Result(), [&] { return Result(m_Result); });
}

void HxCDependencySorting::reinit() {
  forgetPending();
  if (m_Graph != nullptr) m_Graph->clear();
}

void HxCDependencySorting::forgetPending() {
  m_Nodes.clear();
  m_Dependencies.clear();
  m_LacksInput = false;
}
