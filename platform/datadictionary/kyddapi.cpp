#include "platform/datadictionary/kyddapi.h"

#include <cstdlib>
#include <cstring>
#include <set>
#include <string>
#include <vector>

#include "platform/HX_NeverDestroyed.h"
#include "platform/datadictionary/HX_DdTree.h"

namespace {

struct Heap {
  std::set<void*> blocks;
  int balance = 0;
};

Heap& heap() {
  static HX_NeverDestroyed<Heap> s_heap;
  return s_heap.value;
}

void* allocate(std::size_t size) {
  void* block = std::malloc(size);
  if (block == nullptr) return nullptr;
  heap().blocks.insert(block);
  ++heap().balance;
  return block;
}

char* handOut(const std::string& text) {
  auto* copy = static_cast<char*>(allocate(text.size() + 1));
  if (copy == nullptr) return nullptr;
  std::memcpy(copy, text.c_str(), text.size() + 1);
  return copy;
}

const HX_DdTree::Reference* referenceAt(unsigned long handle, long index) {
  const HX_DdTree& tree = HX_DdTree::instance();
  if (!tree.isValid(handle) || index < 0) return nullptr;
  const auto& references = tree.references(handle);
  const auto position = static_cast<std::size_t>(index);
  return position < references.size() ? &references[position] : nullptr;
}

}  // namespace

// An unknown block, or a block returned before, is counted and not freed.
void DDAPIHeapFree(void* block) {
  if (block == nullptr) return;
  --heap().balance;
  if (heap().blocks.erase(block) != 0) std::free(block);
}

int DDAPIHeapBalance() { return heap().balance; }

namespace kyddapi {

bool KYCDDObject::ConnectToDDObject(const char* path) {
  m_Handle = HX_DdTree::instance().find(path);
  return HX_DdTree::instance().isValid(m_Handle);
}

bool KYCDDObject::ConnectToDDObject(unsigned long handle) {
  const bool valid = HX_DdTree::instance().isValid(handle);
  m_Handle = valid ? handle : HX_DdTree::kInvalidHandle;
  return valid;
}

KYSDDHandleNode* KYCDDObject::GetChildObjects(unsigned short kind, long& count,
                                              unsigned short& error) const {
  const HX_DdTree& tree = HX_DdTree::instance();
  count = 0;
  error = tree.isValid(m_Handle) ? 0 : 1;
  if (error != 0) return nullptr;
  const std::vector<unsigned long> children = tree.children(m_Handle, kind);
  if (children.empty()) return nullptr;
  count = static_cast<long>(children.size());
  auto* nodes = static_cast<KYSDDHandleNode*>(
      allocate(children.size() * sizeof(KYSDDHandleNode)));
  if (nodes == nullptr) {
    count = 0;
    return nullptr;
  }
  for (std::size_t i = 0; i < children.size(); ++i) {
    nodes[i].next = i + 1 < children.size() ? &nodes[i + 1] : nullptr;
    nodes[i].handle = children[i];
  }
  return nodes;
}

long KYCDDObject::GetNumOfProps() const {
  const HX_DdTree& tree = HX_DdTree::instance();
  if (!tree.isValid(m_Handle)) return 0;
  return static_cast<long>(tree.references(m_Handle).size());
}

bool KYCDDObject::ReadRefPathFromDDK(long index, char*& path,
                                     unsigned long& length,
                                     unsigned short) const {
  const HX_DdTree::Reference* reference = referenceAt(m_Handle, index);
  if (reference == nullptr) return false;
  path = handOut(reference->path);
  length = static_cast<unsigned long>(reference->path.size());
  return path != nullptr;
}

bool KYCDDObject::GetPropertyName(char*& name, unsigned short& length,
                                  long index) const {
  const HX_DdTree::Reference* reference = referenceAt(m_Handle, index);
  if (reference == nullptr) return false;
  name = handOut(reference->property);
  length = static_cast<unsigned short>(reference->property.size());
  return name != nullptr;
}

bool KYCDDObject::GetName(char*& name, unsigned short& length) const {
  if (!HX_DdTree::instance().isValid(m_Handle)) return false;
  const std::string own = HX_DdTree::instance().name(m_Handle);
  name = handOut(own);
  length = static_cast<unsigned short>(own.size());
  return name != nullptr;
}

KYCDDObject KYCDDSoftwareComponent::GetRelatedVariables(
    unsigned short& error) const {
  const HX_DdTree& tree = HX_DdTree::instance();
  KYCDDObject list(HX_DdTree::kInvalidHandle);
  error = 1;
  if (!tree.isValid(GetHandle())) return list;
  const std::string path = tree.path(GetHandle()) + "/RelatedVariables";
  if (list.ConnectToDDObject(path.c_str())) error = 0;
  return list;
}

}  // namespace kyddapi
