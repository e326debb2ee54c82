#include "NameSpace/implNameSpace/HX_IndexRuns.h"

#include <algorithm>
#include <cstddef>

namespace {

auto at(std::size_t position) { return static_cast<std::ptrdiff_t>(position); }

}  // namespace

void HX_IndexRuns::add(int index) {
  const std::size_t next = runAfter(index);
  Run* const before = next == 0 ? nullptr : &m_Runs[next - 1];
  if (before != nullptr && index < before->end) return;
  const bool touchesBefore = before != nullptr && before->end == index;
  const bool touchesNext =
      next < m_Runs.size() && m_Runs[next].first == index + 1;
  if (touchesBefore && touchesNext) {
    before->end = m_Runs[next].end;
    m_Runs.erase(m_Runs.begin() + at(next));
  } else if (touchesBefore) {
    ++before->end;
  } else if (touchesNext) {
    --m_Runs[next].first;
  } else {
    m_Runs.insert(m_Runs.begin() + at(next), Run{index, index + 1});
  }
}

void HX_IndexRuns::remove(int index) {
  const std::size_t next = runAfter(index);
  if (next == 0 || index >= m_Runs[next - 1].end) return;
  Run& run = m_Runs[next - 1];
  const Run rest{index + 1, run.end};
  run.end = index;
  const bool isRestEmpty = rest.first == rest.end;
  if (run.first == run.end && isRestEmpty)
    m_Runs.erase(m_Runs.begin() + at(next - 1));
  else if (run.first == run.end)
    run = rest;
  else if (!isRestEmpty)
    m_Runs.insert(m_Runs.begin() + at(next), rest);
}

int HX_IndexRuns::firstMissing(int from) const {
  const std::size_t next = runAfter(from);
  return next == 0 ? from : std::max(from, m_Runs[next - 1].end);
}

// The position of the first run that starts after \p index.
std::size_t HX_IndexRuns::runAfter(int index) const {
  const auto next = std::upper_bound(
      m_Runs.begin(), m_Runs.end(), index,
      [](int wanted, const Run& run) { return wanted < run.first; });
  return static_cast<std::size_t>(next - m_Runs.begin());
}
