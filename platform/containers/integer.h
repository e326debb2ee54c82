// Integers of any size, for values beyond the built-in types.
//
//   leda::integer big = (leda::integer(1) << 70) + leda::integer("-12");
//   big.to_string();       // "1180591620717411303412"
//   big.used_words();      // 3
//
// Sign and magnitude; the magnitude reads as 32-bit words. Meant to carry
// values, not to compute with them at length: up to 64 bits no memory is
// allocated, beyond every operation makes a new array.

#ifndef PLATFORM_CONTAINERS_INTEGER_H
#define PLATFORM_CONTAINERS_INTEGER_H

#include <compare>
#include <cstdint>
#include <memory>
#include <string>
#include <vector>

#include "platform/HX_PlatformExport.h"

namespace leda {

/// A value type. Zero has the sign 0.
class HX_PLATFORM_API integer {
 public:
  constexpr integer() = default;
  /// The same value.
  constexpr integer(int value)
      : m_Small(value < 0 ? 0 - static_cast<std::uint64_t>(value)
                          : static_cast<std::uint64_t>(value)),
        m_IsNegative(value < 0) {}
  constexpr integer(unsigned int value) : m_Small(value) {}

  /// Reads decimal digits with an optional sign in front. Any different text
  /// gives 0.
  explicit integer(const char* text);

  /// The same value, in separate memory.
  integer(const integer& other)
      : m_Small(other.m_Small), m_IsNegative(other.m_IsNegative) {
    if (other.m_pLarge) copyLarge(other);
  }
  integer(integer&&) noexcept = default;
  integer& operator=(const integer& other) { return *this = integer(other); }
  integer& operator=(integer&&) noexcept = default;
  ~integer() = default;

  /// -1, 0 or 1.
  int sign() const { return m_IsNegative ? -1 : used_words() != 0; }
  /// The words of the magnitude up to the highest nonzero word; none for 0.
  int used_words() const {
    if (m_pLarge) return static_cast<int>(m_pLarge->size());
    return (m_Small != 0) + (m_Small >> 32 != 0);
  }
  /// Word \p i of the magnitude, word 0 being the least significant; 0 from
  /// used_words() on. \p i must not be negative.
  std::uint32_t contents(int i) const {
    if (m_pLarge) return largeWord(i);
    return i < 2 ? static_cast<std::uint32_t>(m_Small >> (32 * i)) : 0;
  }
  /// Decimal digits, after a "-" for a negative value.
  std::string to_string() const;

  /// The value times 2^\p bits; \p bits must not be negative.
  integer operator<<(int bits) const {
    if (!m_pLarge && bits < 64 && m_Small << bits >> bits == m_Small) {
      return integer(m_Small << bits, m_IsNegative);
    }
    return shifted(bits);
  }
  /// The value with the opposite sign.
  integer operator-() const {
    integer result(*this);
    result.m_IsNegative = !m_IsNegative && used_words() != 0;
    return result;
  }
  /// Exact, without bounds.
  friend integer operator+(const integer& a, const integer& b) {
    if (a.m_pLarge || b.m_pLarge) return sum(a, b);
    if (a.m_IsNegative == b.m_IsNegative) {
      const std::uint64_t total = a.m_Small + b.m_Small;
      return total < a.m_Small ? sum(a, b) : integer(total, a.m_IsNegative);
    }
    if (a.m_Small > b.m_Small) {
      return integer(a.m_Small - b.m_Small, a.m_IsNegative);
    }
    return integer(b.m_Small - a.m_Small,
                   b.m_IsNegative && a.m_Small != b.m_Small);
  }
  /// Exact, without bounds.
  friend integer operator-(const integer& a, const integer& b) {
    return a + -b;
  }
  /// By value.
  friend std::strong_ordering operator<=>(const integer& a, const integer& b) {
    if (a.m_IsNegative != b.m_IsNegative)
      return b.m_IsNegative <=> a.m_IsNegative;
    const auto order =
        a.m_pLarge || b.m_pLarge ? compareLarge(a, b) : a.m_Small <=> b.m_Small;
    // An ordering compares with the literal 0 alone, no pointer.
    // NOLINTNEXTLINE(modernize-use-nullptr)
    return a.m_IsNegative ? 0 <=> order : order;
  }
  /// By value.
  friend bool operator==(const integer& a, const integer& b) {
    return std::is_eq(a <=> b);
  }

 private:
  using Words = std::vector<std::uint32_t>;

  constexpr integer(std::uint64_t magnitude, bool isNegative)
      : m_Small(magnitude), m_IsNegative(isNegative) {}
  integer(Words words, bool isNegative);

  Words words() const;
  void copyLarge(const integer& other);
  std::uint32_t largeWord(int i) const;
  integer shifted(int bits) const;
  static integer sum(const integer& a, const integer& b);
  static std::strong_ordering compareLarge(const integer& a, const integer& b);

  std::uint64_t m_Small = 0;        // the magnitude unless there are words
  std::unique_ptr<Words> m_pLarge;  // 3 words or more, the highest not 0
  bool m_IsNegative = false;
};

/// -1, 0 or 1.
inline int sign(const integer& x) { return x.sign(); }

}  // namespace leda

#endif  // PLATFORM_CONTAINERS_INTEGER_H
