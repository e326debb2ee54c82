#include "platform/matlab/HX_SimulinkTree.h"

#include <cstddef>

#include "platform/matlab/HX_MxContent.h"

HX_SimulinkTree::~HX_SimulinkTree() = default;

double HX_SimulinkTree::addBlock(const KyCXString& name, double parent) {
  Block block;
  block.name = name;
  block.path = name;
  block.path.replace("/", "//");
  if (const Block* above = find(parent)) {
    block.parentPath = above->path;
    block.path = above->path + "/" + block.path;
  }
  m_Blocks.push_back(block);
  const auto handle = static_cast<double>(m_Blocks.size());
  m_Handles[block.path] = handle;
  m_NarrowHandles.emplace(block.path.cstring(), handle);
  return handle;
}

KyCXString HX_SimulinkTree::getPath(double handle) const {
  const Block* block = find(handle);
  return block == nullptr ? KyCXString() : block->path;
}

void HX_SimulinkTree::setParentPath(double handle, const KyCXString& path) {
  if (const Block* block = find(handle))
    m_Blocks[static_cast<std::size_t>(block - m_Blocks.data())].parentPath =
        path;
}

const HX_SimulinkTree::Block* HX_SimulinkTree::find(double handle) const {
  // Refuses NaN too.
  if (!(handle >= 1.0 && handle <= static_cast<double>(m_Blocks.size())))
    return nullptr;
  const auto number = static_cast<std::size_t>(handle);
  return static_cast<double>(number) == handle ? &m_Blocks[number - 1]
                                               : nullptr;
}

double HX_SimulinkTree::findHandle(const mxArray* object) const {
  if (mxIsDouble(object)) return mxGetScalar(object);
  const KyCXString* path = mxGetText(object);
  if (path == nullptr) return HX_SimulinkInterface::s_invalidHandle;
  const auto found = m_Handles.find(*path);
  if (found != m_Handles.end()) return found->second;
  const auto narrow = m_NarrowHandles.find(*path);
  return narrow == m_NarrowHandles.end() ? HX_SimulinkInterface::s_invalidHandle
                                         : narrow->second;
}

mxArray* HX_SimulinkTree::getParameter(const mxArray* object,
                                       const KyCXString& parameter) const {
  const double handle = findHandle(object);
  const Block* block = find(handle);
  if (block == nullptr) return nullptr;
  if (parameter == "Name") return mxCreateText(block->name);
  if (parameter == "Handle") return mxCreateScalarDouble(handle);
  if (parameter == "Parent") return mxCreateText(block->parentPath);
  return nullptr;
}
