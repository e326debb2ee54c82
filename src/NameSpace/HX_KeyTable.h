// The hash table behind the name spaces: 32-bit keys with a use count and a
// plain value each.
//
//   HX_KeyTable<HxCSymbol*> table;
//   if (table.find(key) == nullptr) table.add(key, symbol);
//
// Open addressing with linear probing. A key's place is the top of its product
// with the golden ratio (Knuth, The Art of Computer Programming, vol. 3, 6.4),
// which spreads arithmetic progressions, the usual shape of our keys, evenly
// and keeps the order of the slots when the table doubles. Erasing moves later
// entries back (algorithm R there), so no slot stays marked as deleted. The
// order of the slots reaches no result.

#ifndef NAMESPACE_HX_KEYTABLE_H
#define NAMESPACE_HX_KEYTABLE_H

#include <cstring>
#include <type_traits>

#include "Control/HX_Allocated.h"

/// The product with the golden ratio; its upper bits are the well-spread ones.
inline unsigned HX_SpreadKey(int key) {
  return static_cast<unsigned>(key) * 0x9E3779B1U;
}

/// Not copied: a table belongs to one owner. A key may be added repeatedly,
/// with different values; a match tells them apart.
template <class Value>
class HX_KeyTable {
  static_assert(std::is_trivially_copyable_v<Value>);

 public:
  /// Valid until the next add() or erase().
  struct Slot {
    int key;        ///< not to be changed
    unsigned uses;  ///< the owner's count; 0 marks a free slot
    [[no_unique_address]] Value value;  ///< the owner's
  };

  HX_KeyTable() = default;
  HX_KeyTable(const HX_KeyTable&) = delete;
  HX_KeyTable& operator=(const HX_KeyTable&) = delete;
  ~HX_KeyTable() { HX_Free(m_Slots); }

  /// The number of entries, equal keys counted each.
  unsigned size() const { return m_Size; }

  /// The entry of \p key whose value satisfies \p match, null if there is none.
  template <class Match>
  Slot* find(int key, Match match) const {
    if (m_Slots == nullptr) return nullptr;
    for (unsigned at = placeOf(key);; at = (at + 1) & m_Mask) {
      Slot& slot = m_Slots[at];
      if (slot.uses == 0) return nullptr;
      if (slot.key == key && match(slot.value)) return &slot;
    }
  }
  /// An entry of \p key, whichever value it has; null if there is none.
  Slot* find(int key) const {
    return find(key, [](const Value&) { return true; });
  }

  /// Enters \p key with one use, without a look at entries of the same key.
  /// \return the entry; null, with nothing changed, if there is no memory
  Slot* add(int key, const Value& value) {
    if (m_Size >= capacity() / 8 * 5 && !grow() && m_Size + 1 >= capacity())
      return nullptr;
    ++m_Size;
    Slot* slot = freeSlotFor(key);
    *slot = Slot{key, 1, value};
    return slot;
  }

  /// Removes the entry \p slot of this table.
  void erase(Slot* slot) {
    unsigned hole = static_cast<unsigned>(slot - m_Slots);
    for (unsigned at = (hole + 1) & m_Mask; m_Slots[at].uses != 0;
         at = (at + 1) & m_Mask) {
      // An entry stays where it is unless the hole lies on its probe path.
      const unsigned path = (at - placeOf(m_Slots[at].key)) & m_Mask;
      if (path < ((at - hole) & m_Mask)) continue;
      m_Slots[hole] = m_Slots[at];
      hole = at;
    }
    m_Slots[hole].uses = 0;
    --m_Size;
  }

  /// Removes all entries and gives the memory back.
  void clear() {
    HX_Free(m_Slots);
    m_Slots = nullptr;
    m_Size = 0;
    m_Mask = 0;
  }

  /// Calls \p visit for each entry, in no order that may reach a result.
  template <class Visit>
  void forEach(Visit visit) const {
    for (unsigned at = 0; at < capacity(); ++at)
      if (m_Slots[at].uses != 0) visit(m_Slots[at]);
  }

 private:
  unsigned capacity() const { return m_Slots == nullptr ? 0 : m_Mask + 1; }
  unsigned placeOf(int key) const { return HX_SpreadKey(key) >> m_Shift; }
  Slot* freeSlotFor(int key) {
    unsigned at = placeOf(key);
    while (m_Slots[at].uses != 0) at = (at + 1) & m_Mask;
    return &m_Slots[at];
  }

  bool grow() {
    const unsigned oldCapacity = capacity();
    const unsigned newCapacity = oldCapacity == 0 ? 8 : oldCapacity * 2;
    void* room = HX_Allocate(newCapacity * sizeof(Slot));
    if (room == nullptr) return false;
    std::memset(room, 0, newCapacity * sizeof(Slot));
    Slot* const oldSlots = m_Slots;
    m_Slots = static_cast<Slot*>(room);
    m_Mask = newCapacity - 1;
    m_Shift = oldCapacity == 0 ? 29 : m_Shift - 1;
    for (unsigned at = 0; at < oldCapacity; ++at)
      if (oldSlots[at].uses != 0) *freeSlotFor(oldSlots[at].key) = oldSlots[at];
    HX_Free(oldSlots);
    return true;
  }

  Slot* m_Slots = nullptr;  // a power of two of them, at most 5 in 8 in use
  unsigned m_Size = 0;
  unsigned m_Mask = 0;
  unsigned m_Shift = 29;  // 32 minus the binary logarithm of the capacity
};

#endif  // NAMESPACE_HX_KEYTABLE_H
