#include "platform/containers/integer.h"

#include <algorithm>
#include <cstddef>

namespace leda {

namespace {

using Words = std::vector<std::uint32_t>;

// words = words * factor + addend
void multiplyAdd(Words& words, std::uint32_t factor, std::uint32_t addend) {
  std::uint64_t carry = addend;
  for (std::uint32_t& word : words) {
    carry += std::uint64_t{word} * factor;
    word = static_cast<std::uint32_t>(carry);
    carry >>= 32;
  }
  if (carry != 0) words.push_back(static_cast<std::uint32_t>(carry));
}

// Divides in place and returns the remainder.
std::uint32_t divide(Words& words, std::uint32_t divisor) {
  std::uint64_t rest = 0;
  for (std::size_t i = words.size(); i-- > 0;) {
    rest = rest << 32 | words[i];
    words[i] = static_cast<std::uint32_t>(rest / divisor);
    rest %= divisor;
  }
  return static_cast<std::uint32_t>(rest);
}

void dropLeadingZeros(Words& words) {
  while (!words.empty() && words.back() == 0) words.pop_back();
}

std::strong_ordering compareWords(const Words& a, const Words& b) {
  if (a.size() != b.size()) return a.size() <=> b.size();
  return std::lexicographical_compare_three_way(a.rbegin(), a.rend(),
                                                b.rbegin(), b.rend());
}

// a + factor * b with a factor of 1 or -1; a must not be shorter, and not
// smaller for -1.
Words combine(Words a, const Words& b, int factor) {
  std::int64_t carry = 0;
  for (std::size_t i = 0; i < a.size(); ++i) {
    carry +=
        std::int64_t{a[i]} + (i < b.size() ? factor * std::int64_t{b[i]} : 0);
    a[i] = static_cast<std::uint32_t>(carry);
    carry >>= 32;
  }
  if (carry != 0) a.push_back(static_cast<std::uint32_t>(carry));
  return a;
}

}  // namespace

integer::integer(Words words, bool isNegative) {
  dropLeadingZeros(words);
  m_IsNegative = isNegative && !words.empty();
  if (words.size() > 2) {
    m_pLarge = std::make_unique<Words>(std::move(words));
    return;
  }
  words.resize(2);
  m_Small = std::uint64_t{words[1]} << 32 | words[0];
}

integer::integer(const char* text) {
  const bool isNegative = *text == '-';
  if (*text == '-' || *text == '+') ++text;
  Words words;
  do {
    if (*text < '0' || *text > '9') return;
    multiplyAdd(words, 10, static_cast<std::uint32_t>(*text - '0'));
  } while (*++text != '\0');
  *this = integer(std::move(words), isNegative);
}

std::string integer::to_string() const {
  std::string reversed;
  Words rest = words();
  do {
    std::uint32_t nineDigits = divide(rest, 1000000000);
    dropLeadingZeros(rest);
    for (int i = 0; i < 9 && (!rest.empty() || nineDigits != 0); ++i) {
      reversed += static_cast<char>('0' + nineDigits % 10);
      nineDigits /= 10;
    }
  } while (!rest.empty());
  if (reversed.empty()) return "0";
  if (m_IsNegative) reversed += '-';
  return {reversed.rbegin(), reversed.rend()};
}

integer::Words integer::words() const {
  Words result;
  for (int i = 0; i < used_words(); ++i) result.push_back(contents(i));
  return result;
}

void integer::copyLarge(const integer& other) {
  m_pLarge = std::make_unique<Words>(*other.m_pLarge);
}

std::uint32_t integer::largeWord(int i) const {
  const auto place = static_cast<std::size_t>(i);
  return place < m_pLarge->size() ? (*m_pLarge)[place] : 0;
}

integer integer::shifted(int bits) const {
  Words result = words();
  multiplyAdd(result, std::uint32_t{1} << (bits % 32), 0);
  if (!result.empty()) {
    result.insert(result.begin(), static_cast<std::size_t>(bits / 32), 0);
  }
  return integer(std::move(result), m_IsNegative);
}

integer integer::sum(const integer& a, const integer& b) {
  Words high = a.words();
  Words low = b.words();
  bool isNegative = a.m_IsNegative;
  if (std::is_lt(compareWords(high, low))) {
    high.swap(low);
    isNegative = b.m_IsNegative;
  }
  const int factor = a.m_IsNegative == b.m_IsNegative ? 1 : -1;
  return integer(combine(std::move(high), low, factor), isNegative);
}

std::strong_ordering integer::compareLarge(const integer& a, const integer& b) {
  return compareWords(a.words(), b.words());
}

}  // namespace leda
