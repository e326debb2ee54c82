#include "platform/matlab/HX_SimulinkTree.h"

HX_SimulinkTree::~HX_SimulinkTree() = default;

double HX_SimulinkTree::addBlock(const KyCXString& name, double parent) {
  const KyCXString parentPath = getPath(parent);
  KyCXString path(name);
  path.replace("/", "//");
  if (!parentPath.isEmpty()) path = parentPath + "/" + path;
  const double handle = static_cast<double>(m_Blocks.size() + 1);
  m_Blocks[handle] = {name, path, parentPath};
  m_Handles[path] = handle;
  return handle;
}

KyCXString HX_SimulinkTree::getPath(double handle) const {
  const auto block = m_Blocks.find(handle);
  return block == m_Blocks.end() ? KyCXString() : block->second.path;
}

void HX_SimulinkTree::setParentPath(double handle, const KyCXString& path) {
  const auto block = m_Blocks.find(handle);
  if (block != m_Blocks.end()) block->second.parentPath = path;
}

double HX_SimulinkTree::findHandle(const mxArray* object) const {
  if (mxIsDouble(object)) return mxGetScalar(object);
  const auto found = m_Handles.find(mxGetText(object));
  return found == m_Handles.end() ? HX_SimulinkInterface::s_invalidHandle
                                  : found->second;
}

mxArray* HX_SimulinkTree::getParameter(const mxArray* object,
                                       const KyCXString& parameter) const {
  const double handle = findHandle(object);
  // A NaN would be equivalent to every key.
  const auto block = handle == handle ? m_Blocks.find(handle) : m_Blocks.end();
  if (block == m_Blocks.end()) return nullptr;
  if (parameter == "Name") return mxCreateString(block->second.name.cstring());
  if (parameter == "Handle") return mxCreateScalarDouble(handle);
  if (parameter == "Parent")
    return mxCreateString(block->second.parentPath.cstring());
  return nullptr;
}
