#include "platform/matlab/HX_SimulinkInterface.h"

#include "platform/matlab/HX_SimulinkTree.h"

namespace {

const HX_SimulinkTree* s_tree = nullptr;

}  // namespace

const double HX_SimulinkInterface::s_invalidHandle = -1.0;

mxArray* HX_SimulinkInterface::getMxSlData(mxArray* object,
                                           const KyCXString& parameter) {
  if (s_tree == nullptr || object == nullptr) return nullptr;
  return s_tree->getParameter(object, parameter);
}

void HX_SimulinkInterface::setTree(const HX_SimulinkTree* tree) {
  s_tree = tree;
}
