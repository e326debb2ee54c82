#include "DependencySorting/HxCDepSortNode.h"

#include "DependencySorting/HxCDepSortComp.h"

HxCDepSortComp* HxCDepSortNode::s_pComp = nullptr;

HxCDepSortNode::~HxCDepSortNode() = default;

HxCSsNode* HxCDepSortNode::isSsNode() { return nullptr; }

HxCSdtNode* HxCDepSortNode::isSdtNode() { return nullptr; }

HxCDepSortComp* HxCDepSortNode::getComp() { return s_pComp; }

void HxCDepSortNode::setComp(HxCDepSortComp* comp) { s_pComp = comp; }

template <>
int leda::compare(HxCDepSortNode* const& a, HxCDepSortNode* const& b) {
  return HxCDepSortNode::getComp()->compare(a, b);
}
