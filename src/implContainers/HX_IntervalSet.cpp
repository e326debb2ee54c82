#include "implContainers/HX_IntervalSet.h"

#include <algorithm>

void HX_IntervalSet::add(int index) {
  const std::size_t next = intervalAfter(index);
  Interval* const before = next == 0 ? nullptr : &m_Intervals[next - 1];
  if (before != nullptr && index < before->end) return;
  const bool touchesBefore = before != nullptr && before->end == index;
  const bool touchesNext =
      next < m_Intervals.size() && m_Intervals[next].first == index + 1;
  if (touchesBefore && touchesNext) {
    before->end = m_Intervals[next].end;
    HX_EraseAt(m_Intervals, next);
  } else if (touchesBefore) {
    ++before->end;
  } else if (touchesNext) {
    --m_Intervals[next].first;
  } else {
    HX_InsertAt(m_Intervals, next, Interval{index, index + 1});
  }
}

void HX_IntervalSet::remove(int index) {
  const std::size_t next = intervalAfter(index);
  if (next == 0 || index >= m_Intervals[next - 1].end) return;
  const Interval whole = m_Intervals[next - 1];
  const Interval left{whole.first, index};
  const Interval right{index + 1, whole.end};
  const bool hasLeft = left.first < left.end;
  const bool hasRight = right.first < right.end;
  if (!hasLeft && !hasRight) return HX_EraseAt(m_Intervals, next - 1);
  if (hasLeft && hasRight) HX_InsertAt(m_Intervals, next, right);
  m_Intervals[next - 1] = hasLeft ? left : right;
}

int HX_IntervalSet::firstMissing(int from) const {
  const std::size_t next = intervalAfter(from);
  return next == 0 ? from : std::max(from, m_Intervals[next - 1].end);
}

// Position of the first interval that starts above \p index.
std::size_t HX_IntervalSet::intervalAfter(int index) const {
  const auto next = std::upper_bound(
      m_Intervals.begin(), m_Intervals.end(), index,
      [](int wanted, const Interval& known) { return wanted < known.first; });
  return static_cast<std::size_t>(next - m_Intervals.begin());
}
