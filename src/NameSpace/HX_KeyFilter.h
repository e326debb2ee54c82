// A bit table in front of a large HX_KeyTable, which it tells from afar not to
// hold most of the keys that it does not hold.
//
//   table.add(key, value);
//   filter.noteAdded(key, table);
//   if (filter.mayHold(key) && table.find(key) != nullptr) ...
//
// It is a Bloom filter (Bloom 1970) with one bit per key, at the place where
// the multiplication of HX_KeyTable puts the key. With at least 16 bits for a
// key, 15 of 16 misses end here, in a fraction of the memory of the table.

#ifndef NAMESPACE_HX_KEYFILTER_H
#define NAMESPACE_HX_KEYFILTER_H

#include <cstddef>
#include <cstdint>
#include <cstring>

#include "Control/HX_Allocated.h"
#include "NameSpace/HX_KeyTable.h"

/// Not copied, and serves one table. Has no bits, and says yes to everything,
/// as long as the table is small or there is no memory for them.
class HX_KeyFilter {
 public:
  HX_KeyFilter() = default;
  HX_KeyFilter(const HX_KeyFilter&) = delete;
  HX_KeyFilter& operator=(const HX_KeyFilter&) = delete;
  ~HX_KeyFilter() { HX_Free(m_Bits); }

  /// False only for keys that the table does not hold.
  bool mayHold(int key) const {
    if (m_Bits == nullptr) return true;
    const unsigned bit = bitOf(key);
    return (m_Bits[bit / 32] >> bit % 32 & 1) != 0;
  }

  /// To be called after each new key of \p table. Keys that leave the table
  /// keep their bits until the bits are made anew.
  template <class Value>
  void noteAdded(int key, const HX_KeyTable<Value>& table) {
    if (m_Noted == m_Room) return remake(table);
    ++m_Noted;
    if (m_Bits != nullptr) set(key);
  }

 private:
  unsigned bitOf(int key) const { return HX_SpreadKey(key) >> m_Shift; }
  void set(int key) {
    const unsigned bit = bitOf(key);
    m_Bits[bit / 32] |= std::uint32_t{1} << bit % 32;
  }

  // Makes room for at least as many new keys as the table holds now.
  template <class Value>
  void remake(const HX_KeyTable<Value>& table) {
    for (m_Noted = table.size(); m_Room < 2 * m_Noted; m_Room *= 2) --m_Shift;
    HX_Free(m_Bits);
    const std::size_t size = std::size_t{m_Room} * 2;  // 16 bits for a key
    m_Bits = static_cast<std::uint32_t*>(HX_Allocate(size));
    if (m_Bits == nullptr) return;
    std::memset(m_Bits, 0, size);
    table.forEach([this](const auto& slot) { set(slot.key); });
  }

  std::uint32_t* m_Bits = nullptr;
  unsigned m_Room = 1024;  // keys that may be noted before the next remake
  unsigned m_Noted = 0;    // the keys since the last one and those it found
  unsigned m_Shift = 18;   // 32 minus the binary logarithm of the bits
};

#endif  // NAMESPACE_HX_KEYFILTER_H
