// Growing array of plain values. Unlike std::vector, append() returns false
// without memory instead of throwing; blocks come from HX_Allocate().
//
//   HX_PlainArray<Entry*> entries;
//   if (!entries.append(entry)) return nullptr;   // unchanged

#ifndef IMPLCONTAINERS_HX_PLAINARRAY_H
#define IMPLCONTAINERS_HX_PLAINARRAY_H

#include <cstring>
#include <type_traits>

#include "Control/HX_Allocated.h"

/// OWNERSHIP: not copied, an array belongs to one owner. Indices are not
/// checked.
template <class Value>
class HX_PlainArray {
  static_assert(std::is_trivially_copyable_v<Value>);

 public:
  HX_PlainArray() = default;
  HX_PlainArray(const HX_PlainArray&) = delete;
  HX_PlainArray& operator=(const HX_PlainArray&) = delete;
  ~HX_PlainArray() { HX_Free(m_Values); }

  /// Number of values.
  unsigned size() const { return m_Size; }
  /// Valid until the next append().
  const Value& operator[](unsigned index) const { return m_Values[index]; }
  Value& operator[](unsigned index) { return m_Values[index]; }
  /// For loops over all values; valid until the next append().
  const Value* begin() const { return m_Values; }
  const Value* end() const { return m_Values + m_Size; }

  /// RETURNS: false, with nothing changed, without memory.
  bool append(const Value& value) {
    if (m_Size == m_Capacity && !grow()) return false;
    m_Values[m_Size++] = value;
    return true;
  }
  /// Removes the last value. REQUIRES: size() > 0.
  void dropLast() { --m_Size; }

 private:
  // sizeof a pointer is meant where Value is a pointer.
  // NOLINTBEGIN(bugprone-sizeof-expression)
  bool grow() {
    const unsigned capacity = m_Capacity == 0 ? 4 : m_Capacity * 2;
    void* room = HX_Allocate(capacity * sizeof(Value));
    if (room == nullptr) return false;
    if (m_Size != 0) std::memcpy(room, m_Values, m_Size * sizeof(Value));
    HX_Free(m_Values);
    m_Values = static_cast<Value*>(room);
    m_Capacity = capacity;
    return true;
  }
  // NOLINTEND(bugprone-sizeof-expression)

  Value* m_Values = nullptr;
  unsigned m_Size = 0;
  unsigned m_Capacity = 0;
};

#endif  // IMPLCONTAINERS_HX_PLAINARRAY_H
