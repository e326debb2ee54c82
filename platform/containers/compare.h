// The order that the ordered containers use.
//
// A type that needs an order of its own overloads leda::compare; every other
// type is ordered by its operator<.

#ifndef PLATFORM_CONTAINERS_COMPARE_H
#define PLATFORM_CONTAINERS_COMPARE_H

namespace leda {

/// Negative if \p a goes before \p b, 0 if they are equal, else positive.
template <class T>
int compare(const T& a, const T& b) {
  if (a < b) return -1;
  return b < a ? 1 : 0;
}

}  // namespace leda

#endif  // PLATFORM_CONTAINERS_COMPARE_H
