// One scope in a tree of nested scopes: its keys, and a value per key.
//
// A key is taken in the environment of a scope if the scope itself, a scope
// around or a scope inside holds the key. Scopes beside do not count.
//
//   auto* file = new HxCObjectEnvironment<HxCSmbScopeData*>(nullptr);
//   auto* body = new HxCObjectEnvironment<HxCSmbScopeData*>(file);
//   file->addChild(body);
//   body->defineKey(7, nullptr);
//   file->containsInEnv(7);   // true: inside file
//   delete file;              // deletes body too
//
// Problem: a name for a file must be absent from every function and block of
// the file. Plain form: walk over all scopes below, one lookup each, 1000
// lookups for 1000 scopes.
//
// Idea: every scope counts, by key, the definitions in all scopes below. A
// count of 0 ends a search without visiting the children; a Bloom filter
// (HX_BloomFilter) answers most lookups of the counts. So a lookup that fails
// at the root costs two hash lookups, not one per scope.
//
// Example, scopes file > f > block, file > g:
//   block->defineKey(7), g->defineKey(7), g->defineKey(8)
//   counts of file {7: 2, 8: 1}, of f {7: 1}, of g and block {}
//   f->containsInEnv(8): absent in f and file, count 0 in f: false
//
// Invariants:
// 1. While m_HasExactCounts, m_Below[k] of a scope of the 16 outermost levels
//    is the number of scopes below that hold k.
// 2. Counts travel upward along parents that list their child. Listing a scope
//    twice, or beside its parent, clears m_HasExactCounts of the listing scope
//    and of all scopes around; searches from there visit every scope below.
// 3. A scope without exact counts has no listing parent with exact counts.
//
// Test: NameSpaceTest.SearchesAgreeWithThePlainWalkAndTreesReturnAllMemory.

#ifndef NAMESPACE_HXCOBJECTENVIRONMENT_H
#define NAMESPACE_HXCOBJECTENVIRONMENT_H

#include <type_traits>

#include "Control/HX_Allocated.h"
#include "implContainers/HX_BloomFilter.h"
#include "implContainers/HX_HashTable.h"
#include "implContainers/HX_PlainArray.h"

/// \tparam T  pointer to values created with new; null is a key without value
///
/// OWNERSHIP: the destructor deletes the values of the entries and the children
/// with all below. A child belongs to the scope that added the child first, so
/// a scope listed twice is deleted once. Users delete roots only: scopes that
/// no scope added. The parent is not owned.
///
/// Memory comes from HX_Allocate(); without memory no operation throws.
///
/// COST: a definition updates up to 16 counts. A search below and the
/// destructor call themselves once per level of nesting, with about 100 bytes
/// of stack per call: ten thousand levels fit into a megabyte.
template <class T>
class HxCObjectEnvironment : public HX_Allocated {
  static_assert(std::is_pointer_v<T>);

 public:
  /// An empty scope inside \p parent, null for a root. addChild() tells the
  /// parent of the new scope.
  explicit HxCObjectEnvironment(HxCObjectEnvironment* parent)
      : m_pParent(parent) {}
  HxCObjectEnvironment(const HxCObjectEnvironment&) = delete;
  HxCObjectEnvironment& operator=(const HxCObjectEnvironment&) = delete;
  /// Deletes the values and the owned children.
  ~HxCObjectEnvironment();

  /// Appends \p scope, created with new, to the children.
  /// REQUIRES: the lists of children form no cycle.
  ///
  /// \p scope may have another parent, or no parent, or may have been added
  /// before. Searches from here and from the scopes around then visit all
  /// scopes below one by one.
  /// RETURNS: false, with nothing changed, for null or without memory.
  bool addChild(HxCObjectEnvironment* scope);

  /// Enters \p key.
  /// OWNERSHIP: \p value belongs to this scope if the result is true.
  /// RETURNS: false, with nothing changed, if this very scope holds \p key
  /// already, or without memory.
  bool defineKey(int key, T value);

  /// True if this very scope holds \p key.
  bool containsInScope(int key) const { return m_Entries.find(key) != nullptr; }
  /// RETURNS: the value of \p key in this very scope; null for an absent key.
  T lookupInScope(int key) const;

  /// True if this scope, a scope around it or a scope below it holds \p key.
  bool containsInEnv(int key) const;

  /// Searches this scope, then the scopes around from the inside out, then the
  /// scopes below, depth first in the order of addChild().
  /// RETURNS: the value of \p key in the first scope with \p key; null if no
  /// scope holds \p key. A null value ends the search in this scope, in a scope
  /// around and in a child; deeper it ends the search among its siblings only.
  T lookupInEnv(int key) const;

  /// Removes \p key from this scope; nothing happens for an absent key.
  /// OWNERSHIP: the value goes back to the caller.
  void removeKey(int key);

 private:
  struct Child {
    HxCObjectEnvironment* scope;
    bool isOwned;
  };
  struct Nothing {};

  // Deeper scopes keep no counts, which bounds the cost of a definition. C90
  // guarantees 15 levels of blocks (5.2.4.1).
  static constexpr int kCountedLevels = 16;

  enum Wanted { eAnyEntry, eValue };

  bool isCounted() const {
    return m_HasExactCounts && m_Level < kCountedLevels;
  }
  HxCObjectEnvironment* listingParent() const {
    return m_IsListedByParent ? m_pParent : nullptr;
  }
  bool searchAround(int key, T& value) const;
  bool searchBelow(int key, Wanted wanted, T& value) const;
  void countAround(int key, int change);
  bool changeCount(int key, int change);
  void giveUpCounts();
  void countAllAround();

  HxCObjectEnvironment* m_pParent;
  HX_PlainArray<Child> m_Children;  // in the order of addChild()
  HX_HashTable<int, T> m_Entries;
  // Per key the number of definitions in all scopes below (invariant 1).
  HX_HashTable<int, Nothing> m_Below;
  HX_BloomFilter m_BelowFilter;
  int m_Level = 0;  // listing parents above
  bool m_IsListedByParent = false;
  bool m_HasExactCounts = true;
  bool m_HasOwner = false;
  bool m_IsDying = false;
};

template <class T>
HxCObjectEnvironment<T>::~HxCObjectEnvironment() {
  m_IsDying = true;
  for (const Child& child : m_Children)
    if (child.isOwned && !child.scope->m_IsDying) delete child.scope;
  m_Entries.forEach([](const auto& slot) { delete slot.value; });
}

template <class T>
bool HxCObjectEnvironment<T>::addChild(HxCObjectEnvironment* scope) {
  if (scope == nullptr) return false;
  if (!m_Children.append(Child{scope, !scope->m_HasOwner})) return false;
  scope->m_HasOwner = true;
  if (scope->m_pParent != this || scope->m_IsListedByParent) {
    giveUpCounts();
    return true;
  }
  scope->m_IsListedByParent = true;
  scope->m_Level = m_Level + 1;
  if (scope->m_HasExactCounts)
    scope->countAllAround();
  else
    giveUpCounts();
  return true;
}

template <class T>
bool HxCObjectEnvironment<T>::defineKey(int key, T value) {
  if (containsInScope(key)) return false;
  if (m_Entries.add(key, value) == nullptr) return false;
  countAround(key, 1);
  return true;
}

template <class T>
T HxCObjectEnvironment<T>::lookupInScope(int key) const {
  const auto* slot = m_Entries.find(key);
  return slot == nullptr ? nullptr : slot->value;
}

template <class T>
bool HxCObjectEnvironment<T>::containsInEnv(int key) const {
  T value = nullptr;
  return searchAround(key, value) || searchBelow(key, eAnyEntry, value);
}

template <class T>
T HxCObjectEnvironment<T>::lookupInEnv(int key) const {
  T value = nullptr;
  if (searchAround(key, value)) return value;
  return searchBelow(key, eValue, value) ? value : nullptr;
}

template <class T>
void HxCObjectEnvironment<T>::removeKey(int key) {
  auto* slot = m_Entries.find(key);
  if (slot == nullptr) return;
  m_Entries.erase(slot);
  countAround(key, -1);
}

// From this scope outward. Writes \p value if the result is true.
template <class T>
bool HxCObjectEnvironment<T>::searchAround(int key, T& value) const {
  for (const auto* scope = this; scope != nullptr; scope = scope->m_pParent) {
    const auto* slot = scope->m_Entries.find(key);
    if (slot == nullptr) continue;
    value = slot->value;
    return true;
  }
  return false;
}

template <class T>
bool HxCObjectEnvironment<T>::searchBelow(int key, Wanted wanted,
                                          T& value) const {
  if (isCounted() &&
      (!m_BelowFilter.mayHold(key) || m_Below.find(key) == nullptr))
    return false;
  for (const Child& child : m_Children) {
    if (const auto* slot = child.scope->m_Entries.find(key)) {
      value = slot->value;
      return true;
    }
    if (child.scope->searchBelow(key, wanted, value) &&
        (wanted == eAnyEntry || value != nullptr))
      return true;
  }
  return false;
}

// Updates the counts of the scopes around after a definition in this scope.
template <class T>
void HxCObjectEnvironment<T>::countAround(int key, int change) {
  for (auto* scope = listingParent();
       scope != nullptr && scope->m_HasExactCounts;
       scope = scope->listingParent()) {
    if (scope->isCounted() && !scope->changeCount(key, change))
      scope->giveUpCounts();
  }
}

// RETURNS: false, with nothing changed, without memory.
template <class T>
bool HxCObjectEnvironment<T>::changeCount(int key, int change) {
  auto* slot = m_Below.find(key);
  if (slot == nullptr) {
    if ((slot = m_Below.add(key, Nothing{})) == nullptr) return false;
    slot->uses = static_cast<unsigned>(change);
    m_BelowFilter.noteAdded(key, m_Below);
    return true;
  }
  const unsigned uses = slot->uses + static_cast<unsigned>(change);
  if (uses == 0)
    m_Below.erase(slot);
  else
    slot->uses = uses;
  return true;
}

template <class T>
void HxCObjectEnvironment<T>::giveUpCounts() {
  for (auto* scope = this; scope != nullptr; scope = scope->listingParent())
    scope->m_HasExactCounts = false;
}

// Updates the counts of the scopes around, new parents of this scope, by all
// entries of this scope and all counts of the scopes below.
template <class T>
void HxCObjectEnvironment<T>::countAllAround() {
  m_Entries.forEach([this](const auto& slot) { countAround(slot.key, 1); });
  m_Below.forEach([this](const auto& slot) {
    countAround(slot.key, static_cast<int>(slot.uses));
  });
}

#endif  // NAMESPACE_HXCOBJECTENVIRONMENT_H
