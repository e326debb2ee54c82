#include "host/names/HX_FormingOrder.h"

#include <algorithm>
#include <string>
#include <string_view>

#include "host/base/HX_NaturalOrder.h"
#include "host/names/HX_FormedName.h"

namespace {

/// What names are sorted by; the path is a piece of a common text.
struct Key {
  const HX_WantedName* name;
  std::size_t index;
  std::size_t pathBegin;
  std::size_t pathSize;
};

int groupOf(const HX_WantedName& name) {
  if (name.kind == HX_NameKind::eIsr) return 0;
  return name.kind == HX_NameKind::eTask ? 1 : 2;
}

// In the text of paths a block comes before the blocks inside: the character
// between the names is below all characters of names.
std::vector<Key> keysOf(const std::deque<HX_WantedName>& names,
                        const std::vector<bool>& chosen, std::string& paths) {
  std::vector<Key> keys;
  keys.reserve(names.size());
  for (std::size_t index = 0; index < names.size(); ++index) {
    if (!chosen.empty() && !chosen[index]) continue;
    const HX_WantedName& name = names[index];
    const std::size_t begin = paths.size();
    paths += HX_PathOf(HX_BestSource(name));
    keys.push_back({&name, index, begin, paths.size() - begin});
  }
  std::replace(paths.begin(), paths.end(), '/', '\1');
  return keys;
}

}  // namespace

std::vector<std::size_t> HX_FormingOrder(const std::deque<HX_WantedName>& names,
                                         const std::vector<bool>& chosen) {
  std::string paths;
  std::vector<Key> keys = keysOf(names, chosen, paths);
  const auto pathOf = [&](const Key& key) {
    return std::string_view(paths).substr(key.pathBegin, key.pathSize);
  };
  std::sort(keys.begin(), keys.end(), [&](const Key& a, const Key& b) {
    const int group = groupOf(*a.name);
    if (group != groupOf(*b.name)) return group < groupOf(*b.name);
    if (pathOf(a) != pathOf(b)) return HX_NaturalLess(pathOf(a), pathOf(b));
    return HX_NaturalLess(a.name->id, b.name->id);
  });
  std::vector<std::size_t> order;
  order.reserve(keys.size());
  for (const Key& key : keys) order.push_back(key.index);
  return order;
}
