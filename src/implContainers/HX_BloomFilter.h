// Bloom filter with one hash (Bloom 1970). Answers most lookups of absent keys
// without touching the large hash table behind the filter.
//
//   table.add(key, value);
//   filter.noteAdded(key, table);
//   if (filter.mayHold(key) && table.find(key) != nullptr) ...
//
// Problem: a lookup of an absent key in a table larger than the cache costs one
// cache miss. Idea: one bit per possible home slot, set when a key arrives. A
// clear bit proves absence. With at least 16 bits per key, 15 of 16 lookups of
// absent keys end at the filter, in a fraction of the memory of the table.
// Test: PassesEveryKeyOfTheTableAndFewOthers.

#ifndef IMPLCONTAINERS_HX_BLOOMFILTER_H
#define IMPLCONTAINERS_HX_BLOOMFILTER_H

#include <cstddef>
#include <cstdint>
#include <cstring>

#include "Control/HX_Allocated.h"
#include "implContainers/HX_HashTable.h"

/// Serves one table. Has no bits, and then answers true for every key, while
/// the table holds fewer than 1024 keys or without memory for the bits.
/// OWNERSHIP: not copied.
class HX_BloomFilter {
 public:
  HX_BloomFilter() = default;
  HX_BloomFilter(const HX_BloomFilter&) = delete;
  HX_BloomFilter& operator=(const HX_BloomFilter&) = delete;
  ~HX_BloomFilter() { HX_Free(m_Bits); }

  /// RETURNS: false only for keys that the table does not hold.
  bool mayHold(int key) const {
    if (m_Bits == nullptr) return true;
    const unsigned bit = bitOf(key);
    return (m_Bits[bit / 32] >> bit % 32 & 1) != 0;
  }

  /// To be called after each new key of \p table. Keys that leave the table
  /// keep their bits until the filter is rebuilt.
  template <class Value>
  void noteAdded(int key, const HX_HashTable<int, Value>& table) {
    if (m_Noted == m_Capacity) return rebuild(table);
    ++m_Noted;
    if (m_Bits != nullptr) set(key);
  }

 private:
  unsigned bitOf(int key) const { return HX_SpreadKey(key) >> m_Shift; }
  void set(int key) {
    const unsigned bit = bitOf(key);
    m_Bits[bit / 32] |= std::uint32_t{1} << bit % 32;
  }

  // Afterwards as many new keys fit as the table holds now, or more.
  template <class Value>
  void rebuild(const HX_HashTable<int, Value>& table) {
    for (m_Noted = table.size(); m_Capacity < 2 * m_Noted; m_Capacity *= 2)
      --m_Shift;
    HX_Free(m_Bits);
    const std::size_t size = std::size_t{m_Capacity} * 2;  // 16 bits per key
    m_Bits = static_cast<std::uint32_t*>(HX_Allocate(size));
    if (m_Bits == nullptr) return;
    std::memset(m_Bits, 0, size);
    table.forEach([this](const auto& slot) { set(slot.key); });
  }

  std::uint32_t* m_Bits = nullptr;
  unsigned m_Capacity = 1024;  // m_Noted at the next rebuild
  unsigned m_Noted = 0;        // keys found by rebuild(), and keys added since
  unsigned m_Shift = 18;       // 32 minus the binary logarithm of the bits
};

#endif  // IMPLCONTAINERS_HX_BLOOMFILTER_H
