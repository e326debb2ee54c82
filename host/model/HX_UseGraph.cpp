// Depth-first walk with an explicit stack: a document may chain any number of
// items.
//
// Plain form: follow all uses of every item, again and again; quadratic. Idea:
// an item is finished after all used items. A use of an open item closes a
// circle: the stack holds the circle, from the open item on.
//
// Example: a uses b and c, b uses c: finished in the order c, b, a. If c used
// a, c would meet a on the stack a, b, c: circle a, b, c.
#include "host/model/HX_UseGraph.h"

#include <algorithm>

void HX_UseGraph::walk(const std::function<void(std::size_t)>& finished,
                       const std::function<void(const Circle&)>& circle) const {
  enum State : unsigned char { eNew, eOpen, eFinished };
  std::vector<State> states(m_Uses.size(), eNew);
  std::vector<std::size_t> path;      // open items, outermost first
  std::vector<std::size_t> nextUses;  // of the open items
  const auto open = [&](std::size_t item) {
    states[item] = eOpen;
    path.push_back(item);
    nextUses.push_back(0);
  };
  for (std::size_t start = 0; start < m_Uses.size(); ++start) {
    if (states[start] == eNew) open(start);
    while (!path.empty()) {
      const std::size_t item = path.back();
      if (nextUses.back() < m_Uses[item].size()) {
        const std::size_t used = m_Uses[item][nextUses.back()++];
        if (states[used] == eNew)
          open(used);
        else if (states[used] == eOpen)
          circle(Circle(std::find(path.begin(), path.end(), used), path.end()));
        continue;
      }
      states[item] = eFinished;
      if (finished) finished(item);
      path.pop_back();
      nextUses.pop_back();
    }
  }
}
