// A doubly linked list. Items stay valid while neighbours come and go.
//
//   leda::list<int> l;
//   l.append(1);
//   for (leda::list_item<int> it = l.first(); it; it = l.succ(it)) use(l[it]);

#ifndef PLATFORM_CONTAINERS_LIST_H
#define PLATFORM_CONTAINERS_LIST_H

#include <iterator>
#include <list>
#include <utility>

namespace leda {

/// A place in a list, or null. Valid until the element at the place is deleted.
template <class T>
class list_item {
 public:
  list_item() = default;
  /// False for null.
  explicit operator bool() const { return m_Valid; }
  /// True for the same place, and for two nulls.
  friend bool operator==(const list_item& a, const list_item& b) {
    return a.m_Valid == b.m_Valid && (!a.m_Valid || a.m_Place == b.m_Place);
  }

 private:
  template <class>
  friend class list;
  using Place = typename std::list<T>::iterator;
  explicit list_item(Place place) : m_Place(place), m_Valid(true) {}

  Place m_Place{};
  bool m_Valid = false;
};

/// A value type: copying copies the elements.
template <class T>
class list {
 public:
  /// A place in a list of this type.
  using item = list_item<T>;

  /// Whether the list is empty; the number of elements.
  bool empty() const { return m_Elements.empty(); }
  int size() const { return static_cast<int>(m_Elements.size()); }
  /// Deletes all elements; their items become invalid.
  void clear() { m_Elements.clear(); }

  /// The first item, null for an empty list.
  item first() const { return at(elements().begin()); }
  /// The last item, null for an empty list.
  item last() const {
    return empty() ? item() : item(std::prev(elements().end()));
  }
  /// The item after \p it, null after the last item.
  item succ(item it) const { return at(std::next(it.m_Place)); }

  /// The element at \p it.
  /// REQUIRES: \p it is not null.
  T& operator[](item it) { return *it.m_Place; }
  const T& operator[](item it) const { return *it.m_Place; }
  const T& contents(item it) const { return *it.m_Place; }
  /// The first element; the list must not be empty.
  const T& front() const { return m_Elements.front(); }

  /// Puts a copy of \p element at the end.
  /// RETURNS: the place of the copy.
  item append(const T& element) {
    return item(m_Elements.insert(m_Elements.end(), element));
  }
  /// Puts a copy of \p element before \p it.
  /// REQUIRES: \p it is not null.
  /// RETURNS: the place of the copy.
  item insert_before(const T& element, item it) {
    return item(m_Elements.insert(it.m_Place, element));
  }
  /// Deletes the element at \p it.
  /// REQUIRES: \p it is not null.
  void del_item(item it) { m_Elements.erase(it.m_Place); }

  /// Removes and returns the first element; the list must not be empty.
  T pop() {
    T element = std::move(m_Elements.front());
    m_Elements.pop_front();
    return element;
  }

  /// For loops over all elements, from the first to the last.
  auto begin() const { return m_Elements.begin(); }
  auto end() const { return m_Elements.end(); }

 private:
  // Items of a constant list still name changeable places; only a changeable
  // list hands out changeable elements.
  std::list<T>& elements() const {
    return const_cast<std::list<T>&>(m_Elements);
  }
  item at(typename std::list<T>::iterator place) const {
    return place == elements().end() ? item() : item(place);
  }

  std::list<T> m_Elements;
};

}  // namespace leda

#endif  // PLATFORM_CONTAINERS_LIST_H
