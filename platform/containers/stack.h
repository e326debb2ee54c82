// A last-in first-out stack.

#ifndef PLATFORM_CONTAINERS_STACK_H
#define PLATFORM_CONTAINERS_STACK_H

#include <utility>
#include <vector>

namespace leda {

/// A value type: copying copies the elements.
template <class T>
class stack {
 public:
  /// Whether the stack is empty; the number of elements.
  bool empty() const { return m_Elements.empty(); }
  int size() const { return static_cast<int>(m_Elements.size()); }
  /// Puts a copy of \p element on top.
  void push(const T& element) { m_Elements.push_back(element); }

  /// The latest element; the stack must not be empty.
  const T& top() const { return m_Elements.back(); }

  /// Removes and returns the latest element; the stack must not be empty.
  T pop() {
    T element = std::move(m_Elements.back());
    m_Elements.pop_back();
    return element;
  }

  /// Removes all elements.
  void clear() { m_Elements.clear(); }

 private:
  std::vector<T> m_Elements;
};

}  // namespace leda

#endif  // PLATFORM_CONTAINERS_STACK_H
