#include "platform/datadictionary/HX_DdTree.h"

#include "platform/HX_NeverDestroyed.h"

namespace {

constexpr char kRoot[] = "//DD0";

std::string absolute(const std::string& path) {
  const bool fromRoot = path.size() > 1 && path[0] == '/' && path[1] != '/';
  return fromRoot ? kRoot + path : path;
}

}  // namespace

HX_DdTree& HX_DdTree::instance() {
  static HX_NeverDestroyed<HX_DdTree> s_tree;
  return s_tree.value;
}

void HX_DdTree::clear() {
  m_Objects.clear();
  m_Handles.clear();
}

unsigned long HX_DdTree::add(const std::string& path, unsigned short kind) {
  const std::string full = absolute(path);
  const unsigned long known = find(full);
  if (known != kInvalidHandle) {
    if (kind != 0) m_Objects[known - 1].kind = kind;
    return known;
  }
  const std::size_t slash = full.rfind('/');
  const bool hasParent = slash != std::string::npos && slash > 1;
  const unsigned long parent = hasParent ? add(full.substr(0, slash)) : 0;
  m_Objects.push_back({full, kind, {}, {}});
  const auto handle = static_cast<unsigned long>(m_Objects.size());
  m_Handles.emplace(full, handle);
  if (parent != 0) m_Objects[parent - 1].children.push_back(handle);
  return handle;
}

void HX_DdTree::addReference(unsigned long handle, const std::string& property,
                             const std::string& path) {
  m_Objects[handle - 1].references.push_back({property, path});
}

unsigned long HX_DdTree::find(const std::string& path) const {
  const auto found = m_Handles.find(absolute(path));
  return found == m_Handles.end() ? kInvalidHandle : found->second;
}

bool HX_DdTree::isValid(unsigned long handle) const {
  return handle >= 1 && handle <= m_Objects.size();
}

const std::string& HX_DdTree::path(unsigned long handle) const {
  return object(handle).path;
}

std::string HX_DdTree::name(unsigned long handle) const {
  const std::string& full = path(handle);
  return full.substr(full.rfind('/') + 1);
}

const std::vector<HX_DdTree::Reference>& HX_DdTree::references(
    unsigned long handle) const {
  return object(handle).references;
}

std::vector<unsigned long> HX_DdTree::children(unsigned long handle,
                                               unsigned short kind) const {
  std::vector<unsigned long> result;
  for (const unsigned long child : object(handle).children)
    if (object(child).kind == kind) result.push_back(child);
  return result;
}
