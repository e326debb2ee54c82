#include "host/model/HX_SourcePaths.h"

#include <algorithm>
#include <string_view>
#include <vector>

#include "SourceRef/HxCBlockSrcRef.h"
#include "host/base/HX_Text.h"
#include "platform/model/HX_Block.h"

HX_SourcePaths* HX_SourcePaths::s_Current = nullptr;

std::string HX_PathOf(const HxCSrcRef* source) {
  const HX_SourcePaths* paths = HX_SourcePaths::current();
  return paths != nullptr ? paths->pathOf(source) : std::string();
}

std::string HX_SourcePaths::pathOf(const HxCSrcRef* source) const {
  if (source == nullptr) return {};
  const HxCBlockSrcRef* blockRef = source->isBlock();
  if (blockRef != nullptr && blockRef->getBlock() != nullptr)
    return pathOfBlock(*blockRef->getBlock());
  const auto found = m_Paths.find(source);
  if (found != m_Paths.end()) return found->second;
  KyCXString text;
  source->toString(text);
  return HX_ToUtf8(text);
}

std::string HX_SourcePaths::pathOfBlock(const HX_Block& innermost) const {
  std::vector<std::string_view> names;
  std::size_t length = 0;
  for (const HX_Block* block = &innermost; block != nullptr;
       block = block->getParent()) {
    std::string_view name = block->getName().cstring();
    if (!m_Names.empty()) {
      const auto found = m_Names.find(block);
      if (found != m_Names.end()) name = found->second;
    }
    names.push_back(name);
    length += name.size() + 1;
  }
  std::string path;
  path.reserve(length);
  for (auto name = names.rbegin(); name != names.rend(); ++name) {
    // As the library: no '/' behind an empty path.
    if (!path.empty()) path += '/';
    path += *name;
  }
  std::replace_if(
      path.begin(), path.end(), [](char c) { return c >= '\t' && c <= '\r'; },
      ' ');
  return path;
}
