// An ordered dictionary: a key at most once, ascending by leda::compare.
//
//   leda::dictionary<KyCXString, int, leda::ab_tree> d;
//   d.insert("a", 1);
//   if (auto it = d.lookup("a")) use(d.inf(it));

#ifndef PLATFORM_CONTAINERS_DICTIONARY_H
#define PLATFORM_CONTAINERS_DICTIONARY_H

#include <iterator>
#include <map>

#include "platform/containers/ab_tree.h"
#include "platform/containers/compare.h"

namespace leda {

/// A value type: copying copies the entries. The third parameter names the
/// implementation; every implementation behaves alike.
template <class Key, class Inf, class Impl = ab_tree>
class dictionary {
  struct Less {
    bool operator()(const Key& a, const Key& b) const {
      return detail::compareKeys(a, b) < 0;
    }
  };
  using Map = std::map<Key, Inf, Less>;

 public:
  /// An entry, or null. Valid until the entry is deleted.
  class item {
   public:
    item() = default;
    /// False for null.
    explicit operator bool() const { return m_Valid; }

   private:
    friend class dictionary;
    explicit item(typename Map::iterator place)
        : m_Place(place), m_Valid(true) {}

    typename Map::iterator m_Place{};
    bool m_Valid = false;
  };

  /// The number of entries.
  int size() const { return static_cast<int>(m_Map.size()); }
  bool empty() const { return m_Map.empty(); }
  /// Deletes all entries.
  void clear() { m_Map.clear(); }

  /// The entry of \p key, or null.
  item lookup(const Key& key) const { return at(map().find(key)); }
  bool defined(const Key& key) const { return m_Map.count(key) != 0; }

  /// Enters \p key; a present entry gets \p inf.
  item insert(const Key& key, const Inf& inf) {
    return item(m_Map.insert_or_assign(key, inf).first);
  }
  /// Nothing happens without an entry of \p key.
  void del(const Key& key) { m_Map.erase(key); }

  /// The key and the information of an entry.
  /// REQUIRES: \p it is not null.
  const Key& key(item it) const { return it.m_Place->first; }
  const Inf& inf(item it) const { return it.m_Place->second; }
  Inf& operator[](item it) { return it.m_Place->second; }
  void change_inf(item it, const Inf& inf) { it.m_Place->second = inf; }

  /// The entry with the smallest key, null for an empty dictionary.
  item first_item() const { return at(map().begin()); }
  /// The entry with the next larger key, or null.
  item next_item(item it) const { return at(std::next(it.m_Place)); }

 private:
  // Items of a constant dictionary still name changeable places.
  Map& map() const { return const_cast<Map&>(m_Map); }
  item at(typename Map::iterator place) const {
    return place == map().end() ? item() : item(place);
  }

  Map m_Map;
};

}  // namespace leda

#endif  // PLATFORM_CONTAINERS_DICTIONARY_H
