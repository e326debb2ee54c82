// Problem: a list of substitutions old -> new, applied one after the other as
// sed does, must not replace a word that an earlier substitution has written.
// a -> b, b -> c would turn a into c; a -> b, b -> a would turn both into a.
//
// Idea: every old name has a single new name, so the names form cycles and
// chains that end freely or in a cycle. Cycles are written first. A cycle is
// opened by a swap word: a -> swap, then the chain that ends in a, then
// swap -> new name. A chain is written from the end: b -> c, a -> b.
//
// Example: a -> b, b -> c, x -> y, y -> x gives
//   b -> c, a -> b, x -> hx_swap_1, y -> x, hx_swap_1 -> y
//
// Invariants:
// 1. When from -> to is written, no later substitution has from == to.
// 2. An old name with two new names (itself included) has no substitution.
//
// Test: NameDiffTest.SubstitutionsGiveTheNewNames.

#include "SafeNames/HX_NameDiff.h"

#include <algorithm>
#include <map>
#include <new>
#include <set>
#include <string>

#include "Control/HX_Memory.h"
#include "implContainers/HX_TextArena.h"
#include "implContainers/HX_Vector.h"

namespace {

using View = std::string_view;

template <class Key, class Value>
using Map = std::map<Key, Value, std::less<Key>,
                     HX_ControllerAllocator<std::pair<const Key, Value>>>;
using Set = std::set<View, std::less<View>, HX_ControllerAllocator<View>>;

// Two facts that are both known and differ.
bool differ(View before, View after) {
  return !before.empty() && !after.empty() && before != after;
}

HX_NameDiff::HxEReasonTag reasonOf(const HX_NameDiff::Record& before,
                                   const HX_NameDiff::Record& after) {
  if (differ(before.nameTemplate, after.nameTemplate))
    return HX_NameDiff::eTemplate;
  if (differ(before.place, after.place)) return HX_NameDiff::ePlace;
  if (differ(before.wanted, after.wanted)) return HX_NameDiff::eWanted;
  if (!after.changes.empty()) return HX_NameDiff::eChanges;
  return before.changes.empty() ? HX_NameDiff::eNoReason
                                : HX_NameDiff::eUnchanged;
}

}  // namespace

struct HX_NameDiff::Content : HX_Allocated {
  // Throws std::bad_alloc.
  View keep(View text) {
    if (text.empty()) return {};
    const char* const kept = texts.add(text.data(), text.size());
    if (kept == nullptr) throw std::bad_alloc();
    return {kept, text.size()};
  }

  void sort(HX_Vector<Record>& records);
  void pair();
  void collectTargets();
  void writeCycles(Set& done);
  void write(View from, Set& done);
  View swapWord();

  HX_Vector<Record> sides[2];
  HX_Vector<Row> rows;
  HX_Vector<Substitution> substitutions;
  HX_Vector<View> ambiguous;
  Map<View, View> targets;  // old name -> new name, of renamed items
  Set names;                // of both sides
  int swaps = 0;
  HX_TextArena texts;
};

HX_NameDiff::HX_NameDiff() : m_pContent(new Content) {}

HX_NameDiff::~HX_NameDiff() { delete m_pContent; }

bool HX_NameDiff::add(HxESideTag side, const Record& record) {
  if (m_pContent == nullptr) return false;
  return HX_WithinMemory([&] {
    const auto keep = [this](View text) { return m_pContent->keep(text); };
    m_pContent->sides[side].push_back(
        {keep(record.item), keep(record.name), keep(record.wanted),
         keep(record.nameTemplate), keep(record.place), keep(record.changes)});
  });
}

// By item; of equal items the last stays.
void HX_NameDiff::Content::sort(HX_Vector<Record>& records) {
  HX_Vector<const Record*> order;
  order.reserve(records.size());
  for (const Record& record : records) order.push_back(&record);
  std::sort(order.begin(), order.end(), [](const Record* a, const Record* b) {
    return a->item != b->item ? a->item < b->item : a < b;
  });
  HX_Vector<Record> sorted;
  sorted.reserve(records.size());
  for (const Record* record : order) {
    if (!sorted.empty() && sorted.back().item == record->item)
      sorted.back() = *record;
    else
      sorted.push_back(*record);
  }
  records.swap(sorted);
}

void HX_NameDiff::Content::pair() {
  auto before = sides[eOld].cbegin();
  auto after = sides[eNew].cbegin();
  while (before != sides[eOld].cend() || after != sides[eNew].cend()) {
    Row row;
    const bool hasBefore =
        after == sides[eNew].cend() ||
        (before != sides[eOld].cend() && before->item <= after->item);
    const bool hasAfter =
        before == sides[eOld].cend() ||
        (after != sides[eNew].cend() && after->item <= before->item);
    if (hasBefore) row.before = *before;
    if (hasAfter) row.after = *after;
    if (!hasAfter) {
      row.change = eRemoved;
    } else if (!hasBefore) {
      row.change = eAdded;
    } else if (row.before.name != row.after.name) {
      row.change = eRenamed;
      row.reason = reasonOf(row.before, row.after);
    }
    if (hasBefore) ++before;
    if (hasAfter) ++after;
    rows.push_back(row);
  }
}

void HX_NameDiff::Content::collectTargets() {
  Set doubtful;
  for (const Row& row : rows) {
    if (!row.before.name.empty()) names.insert(row.before.name);
    if (!row.after.name.empty()) names.insert(row.after.name);
    if (row.change != eKept && row.change != eRenamed) continue;
    if (row.before.name.empty() || row.after.name.empty()) continue;
    const auto entered = targets.emplace(row.before.name, row.after.name);
    if (!entered.second && entered.first->second != row.after.name)
      doubtful.insert(row.before.name);
  }
  for (const View name : doubtful) {
    ambiguous.push_back(name);
    targets.erase(name);
  }
  for (auto at = targets.begin(); at != targets.end();)
    at = at->first == at->second ? targets.erase(at) : std::next(at);
}

View HX_NameDiff::Content::swapWord() {
  for (;;) {
    const std::string word = "hx_swap_" + std::to_string(++swaps);
    if (names.count(word) == 0) return keep(word);
  }
}

// Every walk marks the names on the way; a walk that meets an own mark has
// found a cycle.
void HX_NameDiff::Content::writeCycles(Set& done) {
  Map<View, int> marks;
  int walk = 0;
  for (const auto& start : targets) {
    ++walk;
    auto at = targets.find(start.first);
    while (at != targets.end() && marks.emplace(at->first, walk).second)
      at = targets.find(at->second);
    if (at != targets.end() && marks[at->first] == walk) write(at->first, done);
  }
}

// Writes the chain or cycle that begins at \p from, up to a name in \p done.
void HX_NameDiff::Content::write(View from, Set& done) {
  HX_Vector<Substitution> chain;
  View at = from;
  for (auto next = targets.find(at);
       next != targets.end() && done.insert(at).second;
       next = targets.find(at)) {
    chain.push_back({at, next->second});
    at = next->second;
  }
  View swap;
  if (at == from && !chain.empty()) {
    swap = swapWord();
    substitutions.push_back({from, swap});
    chain.front().from = swap;
  }
  substitutions.insert(substitutions.end(), chain.rbegin(), chain.rend());
}

bool HX_NameDiff::compare() {
  if (m_pContent == nullptr) return false;
  Content& content = *m_pContent;
  const auto empty = [&content] {
    content.rows.clear();
    content.substitutions.clear();
    content.ambiguous.clear();
    content.targets.clear();
    content.names.clear();
  };
  empty();
  const bool isDone = HX_WithinMemory([&] {
    for (HX_Vector<Record>& side : content.sides) content.sort(side);
    content.pair();
    content.collectTargets();
    Set done;
    content.writeCycles(done);
    for (const auto& [from, to] : content.targets)
      if (done.count(from) == 0) content.write(from, done);
  });
  if (!isDone) empty();
  return isDone;
}

int HX_NameDiff::rowCount() const {
  return m_pContent == nullptr ? 0 : static_cast<int>(m_pContent->rows.size());
}

const HX_NameDiff::Row& HX_NameDiff::row(int index) const {
  return m_pContent->rows[HX_ToSize(index)];
}

int HX_NameDiff::count(HxEChangeTag change) const {
  int found = 0;
  for (int i = 0; i < rowCount(); ++i)
    if (row(i).change == change) ++found;
  return found;
}

int HX_NameDiff::substitutionCount() const {
  return m_pContent == nullptr
             ? 0
             : static_cast<int>(m_pContent->substitutions.size());
}

const HX_NameDiff::Substitution& HX_NameDiff::substitution(int index) const {
  return m_pContent->substitutions[HX_ToSize(index)];
}

int HX_NameDiff::ambiguousCount() const {
  return m_pContent == nullptr ? 0
                               : static_cast<int>(m_pContent->ambiguous.size());
}

std::string_view HX_NameDiff::ambiguous(int index) const {
  return m_pContent->ambiguous[HX_ToSize(index)];
}
