// Containers from elsewhere: items are pointers, null for none.

#ifndef FOREIGN_CONTAINERS_H
#define FOREIGN_CONTAINERS_H

#include <cstdint>
#include <list>
#include <vector>

class KyCXString;

enum HXCG_compare { HXCG_DIFFERENT = 0, HXCG_EQUAL = 1 };

namespace leda {

class ab_tree;

// Declared before the containers that order texts.
int compare(const KyCXString& a, const KyCXString& b);

template <class T>
int compare(const T& a, const T& b) {
  return a < b ? -1 : b < a ? 1 : 0;
}

template <class T>
class array {
 public:
  array() = default;
  explicit array(int size) : m_Elements(static_cast<std::size_t>(size)) {}

  int size() const { return static_cast<int>(m_Elements.size()); }
  int low() const { return 0; }
  int high() const { return size() - 1; }
  void resize(int size) { m_Elements.resize(static_cast<std::size_t>(size)); }
  T& operator[](int at) { return m_Elements[static_cast<std::size_t>(at)]; }
  const T& operator[](int at) const {
    return m_Elements[static_cast<std::size_t>(at)];
  }

 private:
  std::vector<T> m_Elements;
};

template <class T>
class stack {
 public:
  bool empty() const { return m_Elements.empty(); }
  void push(const T& element) { m_Elements.push_back(element); }
  const T& top() const { return m_Elements.back(); }
  T pop() {
    T element = m_Elements.back();
    m_Elements.pop_back();
    return element;
  }

 private:
  std::vector<T> m_Elements;
};

template <class T>
struct list_node {
  T element;
  list_node* next;
};

template <class T>
class list {
 public:
  using item = list_node<T>*;

  list() = default;
  list(const list&) = delete;
  list& operator=(const list&) = delete;
  ~list() {
    while (!empty()) pop();
  }

  bool empty() const { return m_First == nullptr; }
  item first() const { return m_First; }
  item succ(item it) const { return it->next; }
  T& operator[](item it) { return it->element; }
  const T& contents(item it) const { return it->element; }
  item append(const T& element) {
    item* end = &m_First;
    while (*end != nullptr) end = &(*end)->next;
    return *end = new list_node<T>{element, nullptr};
  }
  void del_item(item it) {
    item* link = &m_First;
    while (*link != it) link = &(*link)->next;
    *link = it->next;
    delete it;
  }
  T pop() {
    T element = m_First->element;
    del_item(m_First);
    return element;
  }

 private:
  item m_First = nullptr;
};

// A list in the order of the keys.
template <class Key, class Inf, class Impl = ab_tree>
class dictionary {
  struct Entry {
    Key key;
    Inf inf;
  };

 public:
  using item = const Entry*;

  int size() const { return static_cast<int>(m_Entries.size()); }
  bool empty() const { return m_Entries.empty(); }
  void clear() { m_Entries.clear(); }
  item lookup(const Key& key) const {
    for (const Entry& entry : m_Entries)
      if (compare(entry.key, key) == 0) return &entry;
    return nullptr;
  }
  item insert(const Key& key, const Inf& inf) {
    auto at = m_Entries.begin();
    while (at != m_Entries.end() && compare(at->key, key) < 0) ++at;
    if (at == m_Entries.end() || compare(at->key, key) != 0)
      at = m_Entries.insert(at, Entry{key, inf});
    at->inf = inf;
    return &*at;
  }
  void del(const Key& key) {
    m_Entries.remove_if(
        [&](const Entry& entry) { return compare(entry.key, key) == 0; });
  }
  const Key& key(item it) const { return it->key; }
  const Inf& inf(item it) const { return it->inf; }
  Inf& operator[](item it) { return const_cast<Inf&>(it->inf); }
  item first_item() const {
    return m_Entries.empty() ? nullptr : &m_Entries.front();
  }
  item next_item(item it) const {
    auto at = m_Entries.begin();
    while (&*at != it) ++at;
    return ++at == m_Entries.end() ? nullptr : &*at;
  }

 private:
  std::list<Entry> m_Entries;
};

// Sign and magnitude in two words: enough for this test.
class integer {
 public:
  integer() {}
  integer(int value) : m_Value(value) {}
  integer(unsigned int value) : m_Value(value) {}

  int used_words() const {
    const auto size = magnitude();
    return (size != 0) + (size >> 32 != 0) + (size >> 64 != 0);
  }
  std::uint32_t contents(int i) const {
    return static_cast<std::uint32_t>(magnitude() >> (32 * i));
  }
  integer operator<<(int bits) const {
    return integer(m_Value * (Wide{1} << bits));
  }
  friend integer operator+(integer a, integer b) {
    return integer(a.m_Value + b.m_Value);
  }
  friend bool operator<(integer a, integer b) { return a.m_Value < b.m_Value; }
  friend bool operator>(integer a, integer b) { return b < a; }
  friend int sign(integer x) { return (x.m_Value > 0) - (x.m_Value < 0); }

 private:
  __extension__ using Wide = __int128;
  __extension__ using Magnitude = unsigned __int128;

  explicit integer(Wide value) : m_Value(value) {}
  Magnitude magnitude() const {
    return static_cast<Magnitude>(m_Value < 0 ? -m_Value : m_Value);
  }

  Wide m_Value = 0;
};

}  // namespace leda

#endif  // FOREIGN_CONTAINERS_H
