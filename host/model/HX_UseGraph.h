// The uses between items, for finding circles.
//
//   HX_UseGraph graph(2);
//   graph.add(0, 1);
//   graph.add(1, 0);
//   graph.walk({}, report);   // report({0, 1})

#ifndef HOST_MODEL_HX_USEGRAPH_H
#define HOST_MODEL_HX_USEGRAPH_H

#include <cstddef>
#include <functional>
#include <vector>

class HX_UseGraph {
 public:
  using Circle = std::vector<std::size_t>;

  /// Items are numbered from 0 to \p count - 1.
  explicit HX_UseGraph(std::size_t count) : m_Uses(count) {}

  /// Enters a use of \p used by \p item.
  void add(std::size_t item, std::size_t used) { m_Uses[item].push_back(used); }
  const std::vector<std::size_t>& usesOf(std::size_t item) const {
    return m_Uses[item];
  }

  /// Visits every item after all used items, circles excepted.
  /// \param finished  may be empty
  /// \param circle  gets the items of every circle
  /// COST: linear in items and uses; no recursion.
  void walk(const std::function<void(std::size_t)>& finished,
            const std::function<void(const Circle&)>& circle) const;

 private:
  std::vector<std::vector<std::size_t>> m_Uses;
};

#endif  // HOST_MODEL_HX_USEGRAPH_H
