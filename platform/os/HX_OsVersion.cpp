// The modules that a host names, read from the blocks of the host; behind them
// the modules of the system.

#include <algorithm>
#include <cstring>

#include "platform/HX_NeverDestroyed.h"
#include "platform/os/HX_OsVersion.h"
#include "platform/os/HX_SystemModules.h"
#include "platform/os/HX_VersionResource.h"

namespace {

constexpr char kRootName[] = "VS_VERSION_INFO";

struct Module {
  std::string path;
  std::string versionBlock;
};

char lower(char c) {
  return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c;
}

// Module names differ in more than the case of ASCII letters.
struct LessWithoutCase {
  bool operator()(const std::string& a, const std::string& b) const {
    return std::lexicographical_compare(
        a.begin(), a.end(), b.begin(), b.end(),
        [](char x, char y) { return lower(x) < lower(y); });
  }
};
using Modules = std::map<std::string, Module, LessWithoutCase>;

Modules& modules() {
  static HX_NeverDestroyed<Modules> s_modules;
  return s_modules.value;
}

const std::string* findBlock(const char* path) {
  for (const auto& [name, module] : modules())
    if (module.path == path) return &module.versionBlock;
  return nullptr;
}

// A node of a block. A node larger than the bytes around the node is invalid,
// and so are all nodes below and behind.
class Node {
 public:
  Node(const char* start, std::size_t available) : m_Start(start) {
    if (available < kHeaderSize || word(0) > available) return;
    const std::size_t size = word(0);
    if (size < kHeaderSize) return;
    const std::size_t nameLength =
        strnlen(start + kHeaderSize, size - kHeaderSize);
    if (kHeaderSize + nameLength == size) return;  // not terminated
    m_ValueAt = aligned(kHeaderSize + nameLength + 1);
    m_ValueSize = word(1);
    if (m_ValueSize == 0 || m_ValueAt + m_ValueSize <= size) m_Size = size;
  }

  bool isValid() const { return m_Size != 0; }
  std::size_t size() const { return m_Size; }
  std::size_t valueSize() const { return m_ValueSize; }
  const char* value() const { return m_Start + m_ValueAt; }

  bool isNamed(const char* name, std::size_t length) const {
    const char* own = m_Start + kHeaderSize;
    return std::strlen(own) == length &&
           std::equal(own, own + length, name,
                      [](char a, char b) { return lower(a) == lower(b); });
  }

  // The child of the name, invalid if not found.
  Node child(const char* name, std::size_t length) const {
    std::size_t at = aligned(m_ValueAt + m_ValueSize);
    while (at < m_Size) {
      const Node node(m_Start + at, m_Size - at);
      if (!node.isValid() || node.isNamed(name, length)) return node;
      at += aligned(node.m_Size);
    }
    return Node(m_Start, 0);
  }

 private:
  static constexpr std::size_t kHeaderSize = 4;

  static std::size_t aligned(std::size_t offset) {
    return (offset + 3) / 4 * 4;
  }
  std::size_t word(int index) const {
    std::uint16_t value = 0;
    std::memcpy(&value, m_Start + std::ptrdiff_t{index} * 2, sizeof value);
    return value;
  }

  const char* m_Start;
  std::size_t m_Size = 0;  // 0: invalid
  std::size_t m_ValueAt = 0;
  std::size_t m_ValueSize = 0;
};

}  // namespace

void HX_LoadModule(const std::string& name, const std::string& path,
                   const std::string& versionBlock) {
  modules()[name] = {path, versionBlock};
}

void HX_UnloadModule(const std::string& name) { modules().erase(name); }

HX_ModuleHandle GetModuleHandleA(const char* name) {
  const auto found = modules().find(name);
  return found == modules().end() ? HX_FindSystemModule(name) : &found->second;
}

std::uint32_t GetModuleFileNameA(HX_ModuleHandle module, char* path,
                                 std::uint32_t size) {
  if (size == 0) return 0;
  const Module* named = nullptr;
  for (const auto& [name, candidate] : modules())
    if (&candidate == module) named = &candidate;
  const std::string full =
      named != nullptr ? named->path : HX_SystemModulePath(module);
  const std::size_t length = std::min<std::size_t>(full.size(), size - 1);
  std::memcpy(path, full.data(), length);
  path[length] = 0;
  return static_cast<std::uint32_t>(length);
}

std::uint32_t GetFileVersionInfoSizeA(const char* path, std::uint32_t* handle) {
  if (handle != nullptr) *handle = 0;
  const std::string* block = findBlock(path);
  return block == nullptr ? HX_SystemVersionSize(path)
                          : static_cast<std::uint32_t>(block->size());
}

int GetFileVersionInfoA(const char* path, std::uint32_t /*handle*/,
                        std::uint32_t size, void* block) {
  const std::string* source = findBlock(path);
  if (source == nullptr) return HX_ReadSystemVersion(path, size, block) ? 1 : 0;
  if (source->size() > size) return 0;
  if (Node(source->data(), source->size()).size() != source->size()) return 0;
  std::memcpy(block, source->data(), source->size());
  return source->empty() ? 0 : 1;
}

int VerQueryValueA(const void* block, const char* path, void** value,
                   unsigned int* length) {
  const auto* start = static_cast<const char*>(block);
  std::uint16_t size = 0;
  std::memcpy(&size, start, sizeof size);
  Node node(start, size);
  // The system's own blocks have names of 16-bit characters.
  if (!node.isNamed(kRootName, sizeof kRootName - 1))
    return HX_QuerySystemVersion(block, path, value, length) ? 1 : 0;
  while (node.isValid()) {
    while (*path == '\\') ++path;
    if (*path == 0) break;
    const std::size_t nameLength = std::strcspn(path, "\\");
    node = node.child(path, nameLength);
    path += nameLength;
  }
  if (!node.isValid() || node.valueSize() == 0) return 0;
  *value = const_cast<char*>(node.value());
  *length = static_cast<unsigned int>(node.valueSize());
  return 1;
}
