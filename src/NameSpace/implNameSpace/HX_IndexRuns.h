// A set of indices of 0 or more that lie in few runs of neighbours.
//
//   HX_IndexRuns taken;
//   taken.add(0); taken.add(1); taken.add(5);   // two runs: 0-1 and 5
//   taken.firstMissing(0);                      // 2

#ifndef NAMESPACE_IMPLNAMESPACE_HX_INDEXRUNS_H
#define NAMESPACE_IMPLNAMESPACE_HX_INDEXRUNS_H

#include <vector>

/// A lookup costs the logarithm of the number of runs, a change at worst that
/// number.
class HX_IndexRuns {
 public:
  bool empty() const { return m_Runs.empty(); }
  /// Nothing happens if \p index is there already.
  void add(int index);
  /// Nothing happens if \p index is not there.
  void remove(int index);
  /// The smallest index that is \p from or more and not in the set.
  int firstMissing(int from) const;

 private:
  struct Run {
    int first;
    int end;  // one after the last
  };

  std::size_t runAfter(int index) const;

  std::vector<Run> m_Runs;  // ascending, never touching
};

#endif  // NAMESPACE_IMPLNAMESPACE_HX_INDEXRUNS_H
