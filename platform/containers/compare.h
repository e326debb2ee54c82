// The order of the ordered containers.
//
// A type with an order of its own overloads leda::compare, before or after the
// include of a container; all other types are ordered by operator<.

#ifndef PLATFORM_CONTAINERS_COMPARE_H
#define PLATFORM_CONTAINERS_COMPARE_H

#include <concepts>

namespace leda {

// Stands for a key in a call that looks for an overload of compare(). As a
// class of namespace leda, the argument makes the compiler look for overloads
// where a container is used, not where the container is declared: the order of
// the includes does not matter. Converts to the type of the key and to no
// different type, because an overload for a different type is not meant.
template <class Key>
class KeyToCompare {
 public:
  explicit KeyToCompare(const Key& key) : m_Key(key) {}
  template <class T>
  requires std::same_as<T, Key>
  operator const T&() const { return m_Key; }

 private:
  const Key& m_Key;
};

namespace detail {

template <class T>
inline constexpr bool kIsKeyToCompare = false;
template <class Key>
inline constexpr bool kIsKeyToCompare<KeyToCompare<Key>> = true;

}  // namespace detail

/// Negative if \p a goes before \p b, 0 for equal keys, else positive.
template <class T>
requires(!detail::kIsKeyToCompare<T>) int compare(const T& a, const T& b) {
  if (a < b) return -1;
  return b < a ? 1 : 0;
}

namespace detail {

// The order of two keys: by the overload for Key, if one stands in namespace
// leda or in the namespace of Key, else by operator<.
template <class Key>
int compareKeys(const Key& a, const Key& b) {
  const KeyToCompare<Key> first(a);
  const KeyToCompare<Key> second(b);
  if constexpr (requires { compare(first, second); })
    return compare(first, second);
  else
    return compare(a, b);
}

}  // namespace detail

}  // namespace leda

#endif  // PLATFORM_CONTAINERS_COMPARE_H
