// One scope in a tree of nested scopes: which keys it holds, and with what
// value.
//
// A key is taken in the environment of a scope if the scope itself, a scope
// around it or a scope inside it holds the key; scopes beside it do not count.
//
//   auto* file = new HxCObjectEnvironment<HxCSmbScopeData*>(nullptr);
//   auto* body = new HxCObjectEnvironment<HxCSmbScopeData*>(file);
//   file->addChild(body);
//   body->defineKey(7, nullptr);
//   file->containsInEnv(7);   // true: inside it
//   delete file;              // and body with it
//
// Each scope counts, by key, the definitions below it, so that a search skips
// the subtrees without the key: that a root misses costs two lookups, however
// many scopes it has. The counts of a definition go to the scopes around it.

#ifndef NAMESPACE_HXCOBJECTENVIRONMENT_H
#define NAMESPACE_HXCOBJECTENVIRONMENT_H

#include <type_traits>

#include "Control/HX_Allocated.h"
#include "implContainers/HX_BloomFilter.h"
#include "implContainers/HX_HashTable.h"
#include "implContainers/HX_PlainArray.h"

/// \tparam T  pointer to the values, which are created with new; null stands
///            for a key without a value.
///
/// Ownership: destruction destroys the values of its entries and the children,
/// with their entries and children. A child belongs to the scope that added it
/// first, so a scope listed twice is destroyed once. Only roots, scopes that
/// nobody added, are deleted by their users. The scope around is not owned.
///
/// A search below and the destruction call themselves once per level of nesting
/// and need about 100 bytes of stack for each: ten thousand levels fit into a
/// megabyte.
template <class T>
class HxCObjectEnvironment : public HX_Allocated {
  static_assert(std::is_pointer_v<T>);

 public:
  /// An empty scope inside \p parent, null for a root. The parent does not
  /// know it before addChild().
  explicit HxCObjectEnvironment(HxCObjectEnvironment* parent)
      : m_pParent(parent) {}
  HxCObjectEnvironment(const HxCObjectEnvironment&) = delete;
  HxCObjectEnvironment& operator=(const HxCObjectEnvironment&) = delete;
  /// Destroys the values, and the children that this scope owns.
  ~HxCObjectEnvironment();

  /// Appends \p scope, created with new, to the children. The lists of
  /// children must not form a cycle.
  ///
  /// A scope may be added that has another parent or none, or that was added
  /// before; then searches from here and from the scopes around here visit
  /// every scope below, one by one.
  /// \return false, with nothing changed, for null or if there is no memory
  bool addChild(HxCObjectEnvironment* scope);

  /// Enters \p key, whose value belongs to this scope from then on.
  /// \return false, with nothing changed and \p value left to the caller, if
  ///         this scope holds \p key already or there is no memory
  bool defineKey(int key, T value);

  /// True if this very scope holds \p key.
  bool containsInScope(int key) const { return m_Entries.find(key) != nullptr; }
  /// The value of \p key in this scope; null if it has none or is not here.
  T lookupInScope(int key) const;

  /// True if this scope, a scope around it or a scope below it holds \p key.
  bool containsInEnv(int key) const;

  /// The value of \p key in the first scope that holds it: this scope, then
  /// those around it from the inside out, then those below it, depth first in
  /// the order of addChild(). Null if no scope holds it.
  ///
  /// A null value found here or around, or in a child, is the result; one found
  /// deeper ends only the search among its siblings.
  T lookupInEnv(int key) const;

  /// Takes \p key out of this scope, if it is there; its value, if any, goes
  /// back to the caller.
  void removeKey(int key);

 private:
  struct Child {
    HxCObjectEnvironment* scope;
    bool isOwned;
  };
  struct Nothing {};

  // Scopes nested deeper keep no counts, which bounds the cost of a definition:
  // C90 guarantees 15 levels of blocks (5.2.4.1).
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
  // The definitions of a key in all scopes below, while counted. A count
  // travels up only along parents that list their child.
  HX_HashTable<int, Nothing> m_Below;
  HX_BloomFilter m_BelowFilter;
  int m_Level = 0;  // listing parents above
  bool m_IsListedByParent = false;
  bool m_HasExactCounts = true;  // false here: false in all listing parents
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

// From here outward. \p value is written when the result is true.
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

// Tells the scopes around that list this one of a definition here.
template <class T>
void HxCObjectEnvironment<T>::countAround(int key, int change) {
  for (auto* scope = listingParent();
       scope != nullptr && scope->m_HasExactCounts;
       scope = scope->listingParent()) {
    if (scope->isCounted() && !scope->changeCount(key, change))
      scope->giveUpCounts();
  }
}

// False, with nothing changed, if there is no memory.
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

// Tells the scopes around, which have just listed this one, of all it holds.
template <class T>
void HxCObjectEnvironment<T>::countAllAround() {
  m_Entries.forEach([this](const auto& slot) { countAround(slot.key, 1); });
  m_Below.forEach([this](const auto& slot) {
    countAround(slot.key, static_cast<int>(slot.uses));
  });
}

#endif  // NAMESPACE_HXCOBJECTENVIRONMENT_H
