// Hash table of integers or pointers, with a use count and a plain value per
// key.
//
//   HX_HashTable<int, HxCSymbol*> table;
//   if (table.find(key) == nullptr) table.add(key, symbol);
//
// Open addressing with linear probing. The home slot of a key is the top of the
// product of key and golden ratio (Knuth, The Art of Computer Programming,
// vol. 3, 6.4): arithmetic progressions, the usual shape of our keys, spread
// evenly, and doubling the table keeps the order of the slots. erase() moves
// later entries back (Algorithm R, same section), so no slot stays marked as
// deleted. The order of the slots reaches no result.
//
// Example with 8 slots: keys A, B, C with home slots 2, 2, 3 lie in the slots
// 2, 3, 4. Erasing A moves B to slot 2 and C to slot 3.

#ifndef IMPLCONTAINERS_HX_HASHTABLE_H
#define IMPLCONTAINERS_HX_HASHTABLE_H

#include <bit>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <limits>
#include <type_traits>
#include <utility>

#include "Control/HX_Allocated.h"

/// 32 bits of the product of key and golden ratio; the upper bits of the result
/// are the best spread bits.
inline unsigned HX_SpreadKey(int key) {
  return static_cast<unsigned>(key) * 0x9E3779B1U;
}
template <class Object>
unsigned HX_SpreadKey(Object* key) {
  const std::uint64_t address = reinterpret_cast<std::uintptr_t>(key);
  return static_cast<unsigned>((address * 0x9E3779B97F4A7C15U) >> 32);
}

/// OWNERSHIP: not copied, a table belongs to one owner. A key may stand in the
/// table several times, with different values; a match selects one entry.
template <class Key, class Value>
class HX_HashTable {
  static_assert(std::is_trivially_copyable_v<Value>);

 public:
  /// Valid until the next add(), erase() or reserve().
  struct Slot {
    Key key;        ///< not to be changed
    unsigned uses;  ///< count of the owner; 0 marks a free slot
    [[no_unique_address]] Value value;  ///< value of the owner
  };

  HX_HashTable() = default;
  HX_HashTable(const HX_HashTable&) = delete;
  HX_HashTable& operator=(const HX_HashTable&) = delete;
  ~HX_HashTable() { HX_Free(m_Slots); }

  /// Number of entries; equal keys count separately.
  unsigned size() const { return m_Size; }

  /// RETURNS: the entry of \p key whose value satisfies \p match; null if the
  /// table has no such entry.
  template <class Match>
  Slot* find(Key key, Match match) const {
    if (m_Slots == nullptr) return nullptr;
    for (unsigned at = homeOf(key);; at = (at + 1) & m_Mask) {
      Slot& slot = m_Slots[at];
      if (slot.uses == 0) return nullptr;
      if (slot.key == key && match(slot.value)) return &slot;
    }
  }
  /// RETURNS: any entry of \p key; null if the table does not hold \p key.
  Slot* find(Key key) const {
    return find(key, [](const Value&) { return true; });
  }

  /// Enters \p key with one use, whether or not the table holds \p key.
  /// RETURNS: the new entry; null, with nothing changed, without memory.
  Slot* add(Key key, const Value& value) {
    if (m_Size >= capacity() / 8 * 5 && !growTo(capacity() * 2) &&
        m_Size + 1 >= capacity())
      return nullptr;
    ++m_Size;
    Slot* slot = freeSlotFor(key);
    *slot = Slot{key, 1, value};
    return slot;
  }

  /// Makes room for \p count entries.
  /// RETURNS: false, with nothing changed, without memory.
  bool reserve(unsigned count) {
    unsigned wanted = kSmallest;
    while (wanted != 0 && wanted / 8 * 5 < count) wanted *= 2;
    return wanted <= capacity() ? wanted != 0 : growTo(wanted);
  }

  /// Removes the entry \p slot of this table.
  void erase(Slot* slot) {
    unsigned hole = static_cast<unsigned>(slot - m_Slots);
    for (unsigned at = (hole + 1) & m_Mask; m_Slots[at].uses != 0;
         at = (at + 1) & m_Mask) {
      // An entry moves only if the hole lies between home slot and entry.
      const unsigned path = (at - homeOf(m_Slots[at].key)) & m_Mask;
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

  /// Exchanges all entries with \p other; needs no memory.
  void swap(HX_HashTable& other) noexcept {
    std::swap(m_Slots, other.m_Slots);
    std::swap(m_Size, other.m_Size);
    std::swap(m_Mask, other.m_Mask);
    std::swap(m_Shift, other.m_Shift);
  }

  /// Calls \p visit for every entry. The order must not reach any result.
  template <class Visit>
  void forEach(Visit visit) const {
    for (unsigned at = 0; at < capacity(); ++at)
      if (m_Slots[at].uses != 0) visit(m_Slots[at]);
  }

 private:
  static constexpr unsigned kSmallest = 8;  // slots of the first allocation

  unsigned capacity() const { return m_Slots == nullptr ? 0 : m_Mask + 1; }
  unsigned homeOf(Key key) const { return HX_SpreadKey(key) >> m_Shift; }
  Slot* freeSlotFor(Key key) {
    unsigned at = homeOf(key);
    while (m_Slots[at].uses != 0) at = (at + 1) & m_Mask;
    return &m_Slots[at];
  }

  // \p wanted is a power of two above capacity(), or 0: capacity() overflowed,
  // or the table is new.
  bool growTo(unsigned wanted) {
    const unsigned oldCapacity = capacity();
    if (wanted == 0 && oldCapacity == 0) wanted = kSmallest;
    if (wanted == 0 ||
        wanted > std::numeric_limits<std::size_t>::max() / sizeof(Slot))
      return false;
    void* room = HX_Allocate(wanted * sizeof(Slot));
    if (room == nullptr) return false;
    std::memset(room, 0, wanted * sizeof(Slot));
    Slot* const oldSlots = m_Slots;
    m_Slots = static_cast<Slot*>(room);
    m_Mask = wanted - 1;
    m_Shift = 1 + static_cast<unsigned>(std::countl_zero(wanted));
    for (unsigned at = 0; at < oldCapacity; ++at)
      if (oldSlots[at].uses != 0) *freeSlotFor(oldSlots[at].key) = oldSlots[at];
    HX_Free(oldSlots);
    return true;
  }

  Slot* m_Slots = nullptr;  // a power of two, at most 5 of 8 slots in use
  unsigned m_Size = 0;
  unsigned m_Mask = 0;
  unsigned m_Shift = 29;  // 32 minus the binary logarithm of the capacity
};

#endif  // IMPLCONTAINERS_HX_HASHTABLE_H
