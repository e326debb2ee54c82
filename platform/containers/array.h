// A resizable array with indices 0 to size() - 1.

#ifndef PLATFORM_CONTAINERS_ARRAY_H
#define PLATFORM_CONTAINERS_ARRAY_H

#include <cstddef>
#include <initializer_list>
#include <vector>

namespace leda {

/// A value type: copying copies the elements. Indices are not checked.
template <class T>
class array {
 public:
  array() = default;
  /// \p size value-initialised elements; must not be negative.
  explicit array(int size) : m_Elements(static_cast<std::size_t>(size)) {}
  /// The elements listed.
  array(std::initializer_list<T> elements) : m_Elements(elements) {}

  /// The number of elements.
  int size() const { return static_cast<int>(m_Elements.size()); }
  /// The first index.
  int low() const { return 0; }
  /// The last index; -1 for an empty array.
  int high() const { return size() - 1; }

  /// The element; valid until resize().
  T& operator[](int index) {
    return m_Elements[static_cast<std::size_t>(index)];
  }
  const T& operator[](int index) const {
    return m_Elements[static_cast<std::size_t>(index)];
  }

  /// Keeps the elements below \p size; new elements are value-initialised.
  void resize(int size) { m_Elements.resize(static_cast<std::size_t>(size)); }

  /// For loops over all elements, in the order of the indices.
  auto begin() { return m_Elements.begin(); }
  auto end() { return m_Elements.end(); }
  auto begin() const { return m_Elements.begin(); }
  auto end() const { return m_Elements.end(); }

 private:
  std::vector<T> m_Elements;
};

}  // namespace leda

#endif  // PLATFORM_CONTAINERS_ARRAY_H
