#include "platform/strings/KyCXString.h"

#include <algorithm>
#include <array>
#include <cstddef>
#include <limits>
#include <string>
#include <utility>

namespace {

using Units = std::basic_string<unsigned short>;

std::size_t sizeOf(int count) { return static_cast<std::size_t>(count); }

bool isDigit(unsigned short unit) { return unit >= '0' && unit <= '9'; }

bool isWhiteSpace(unsigned short unit) {
  return unit == ' ' || (unit >= '\t' && unit <= '\r');
}

unsigned short lower(unsigned short unit) {
  return unit >= 'A' && unit <= 'Z' ? static_cast<unsigned short>(unit + 32)
                                    : unit;
}

unsigned short upper(unsigned short unit) {
  return unit >= 'a' && unit <= 'z' ? static_cast<unsigned short>(unit - 32)
                                    : unit;
}

unsigned short widened(char character) {
  return static_cast<unsigned char>(character);
}

char narrowed(unsigned short unit) {
  return static_cast<char>(unit > 0xFF ? '?' : unit);
}

// The characters of C identifiers.
constexpr auto kIdentifierCharacters = [] {
  std::array<bool, 256> table{};
  for (unsigned char c = 'a'; c <= 'z'; ++c) table[c] = table[c - 32] = true;
  for (unsigned char c = '0'; c <= '9'; ++c) table[c] = true;
  table['_'] = true;
  return table;
}();

// Digits of a magnitude; zeros in front up to the digits of \p largest.
struct Digits {
  Digits(unsigned long magnitude, unsigned long largest, int base,
         bool shortest) {
    int width = 1;
    while (!shortest && (largest /= static_cast<unsigned>(base)) != 0) ++width;
    do {
      const auto digit = magnitude % static_cast<unsigned>(base);
      *--first = "0123456789ABCDEF"[digit];
      magnitude /= static_cast<unsigned>(base);
      --width;
    } while (magnitude != 0 || width > 0);
  }
  Digits(const Digits&) = delete;
  Digits& operator=(const Digits&) = delete;

  char text[24] = {};  // 64 bits have 20 decimal digits
  char* first = text + sizeof text - 1;
};

}  // namespace

KyCXString::KyCXString(const char* text) : KyCXString() {
  if (text != nullptr) assignNarrow(text, static_cast<int>(std::strlen(text)));
}

KyCXString::KyCXString(char character) : KyCXString() {
  assignNarrow(&character, 1);
}

KyCXString::KyCXString(const unsigned short* units, int length) : KyCXString() {
  assignUnits(units, std::max(length, 0));
}

KyCXString::KyCXString(int value, bool hexadecimal, bool shortest)
    : KyCXString() {
  constexpr unsigned int kLargestWord =
      std::numeric_limits<unsigned int>::max();
  constexpr unsigned int kLargest = std::numeric_limits<int>::max();
  const unsigned int bits = static_cast<unsigned int>(value);
  if (value < 0 && !hexadecimal) {
    *this += '-';
    *this += Digits(0U - bits, kLargest, 10, shortest).first;
  } else if (hexadecimal) {
    *this += Digits(bits, kLargestWord, 16, shortest).first;
  } else {
    *this += Digits(bits, kLargest, 10, shortest).first;
  }
}

KyCXString::KyCXString(unsigned long value, bool hexadecimal, bool shortest)
    : KyCXString() {
  *this += Digits(value, std::numeric_limits<unsigned long>::max(),
                  hexadecimal ? 16 : 10, shortest)
               .first;
}

KyCXString::KyCXString(const KyCXString& other) : m_Length(other.m_Length) {
  if (!other.ownsMemory()) {
    std::memcpy(m_Inline, other.m_Inline, sizeof m_Inline);
    return;
  }
  m_Length = 0;
  m_Inline[0] = 0;
  *this = other;
}

KyCXString::KyCXString(KyCXString&& other) noexcept : KyCXString() {
  *this = std::move(other);
}

KyCXString& KyCXString::operator=(const KyCXString& other) {
  if (this == &other) return *this;
  // Copying the whole buffer beats asking for the length.
  if (!ownsMemory() && !other.ownsMemory()) {
    std::memcpy(m_Inline, other.m_Inline, sizeof m_Inline);
    m_Length = other.m_Length;
  } else if (other.m_Wide != nullptr)
    assignUnits(other.m_Wide, other.m_Length);
  else
    assignNarrow(other.m_Text, other.m_Length);
  return *this;
}

KyCXString& KyCXString::operator=(KyCXString&& other) noexcept {
  if (this == &other) return *this;
  if (ownsMemory()) release();
  m_Length = other.m_Length;
  m_Wide = std::exchange(other.m_Wide, nullptr);
  if (other.m_Text == other.m_Inline) {
    m_Text = m_Inline;
    m_Capacity = kInlineCapacity;
    std::memcpy(m_Inline, other.m_Inline, sizeof m_Inline);
  } else {
    m_Text = std::exchange(other.m_Text, other.m_Inline);
    m_Capacity = std::exchange(other.m_Capacity, int{kInlineCapacity});
  }
  other.setLength(0);
  return *this;
}

KyCXString& KyCXString::operator=(const char* text) {
  if (text == nullptr) text = "";
  assignNarrow(text, static_cast<int>(std::strlen(text)));
  return *this;
}

KyCXString& KyCXString::appendText(const KyCXString& text) {
  if (m_Wide == nullptr && text.m_Wide == nullptr)
    appendNarrow(text.m_Text, text.m_Length);
  else
    appendUnits(text, 0, text.m_Length);
  return *this;
}

KyCXString& KyCXString::operator+=(const char* text) {
  if (text == nullptr) return *this;
  if (m_Wide != nullptr) return *this += KyCXString(text);
  appendNarrow(text, static_cast<int>(std::strlen(text)));
  return *this;
}

KyCXString& KyCXString::appendCharacter(char character) {
  if (m_Wide != nullptr) return *this += KyCXString(character);
  appendNarrow(&character, 1);
  return *this;
}

KyCXString& KyCXString::appendSub(const KyCXString& text, int from, int to) {
  from = std::max(from, 0);
  to = std::min(to, text.m_Length - 1);
  if (to < from) return *this;
  const int count = to - from + 1;
  if (m_Wide == nullptr && text.m_Wide == nullptr)
    appendNarrow(text.m_Text + from, count);
  else
    appendUnits(text, from, count);
  return *this;
}

int KyCXString::find(const KyCXString& text, int from) const {
  from = std::max(from, 0);
  if (text.m_Length > m_Length - from) return -1;
  if (m_Wide == nullptr) {
    if (text.m_Wide != nullptr) return -1;
    return static_cast<int>(narrow().find(text.narrow(), sizeOf(from)));
  }
  for (int start = from; start <= m_Length - text.m_Length; ++start) {
    int matched = 0;
    while (matched < text.m_Length && m_Wide[start + matched] == text[matched])
      ++matched;
    if (matched == text.m_Length) return start;
  }
  return -1;
}

int KyCXString::find(char character, int from) const {
  from = std::max(from, 0);
  if (from >= m_Length) return -1;
  if (m_Wide == nullptr) {
    const void* found =
        std::memchr(m_Text + from, character, sizeOf(m_Length - from));
    if (found == nullptr) return -1;
    return static_cast<int>(static_cast<const char*>(found) - m_Text);
  }
  const unsigned short* begin = m_Wide;
  const unsigned short* end = begin + m_Length;
  const auto* found = std::find(begin + from, end, widened(character));
  return found == end ? -1 : static_cast<int>(found - begin);
}

bool KyCXString::matchesWholeAt(int position, const KyCXString& text) const {
  if (position < 0 || position > m_Length - text.m_Length) return false;
  if (m_Wide == nullptr)
    return text.m_Wide == nullptr && std::memcmp(m_Text + position, text.m_Text,
                                                 sizeOf(text.m_Length)) == 0;
  for (int i = 0; i < text.m_Length; ++i)
    if (m_Wide[position + i] != text[i]) return false;
  return true;
}

KyCXString KyCXString::sub(int from, int to) const {
  KyCXString part;
  part.appendSub(*this, from, to);
  return part;
}

void KyCXString::split(char separator, leda::array<KyCXString>& parts) const {
  int count = 1;
  for (int at = find(separator, 0); at >= 0; at = find(separator, at + 1))
    ++count;
  leda::array<KyCXString> result(count);
  int start = 0;
  for (KyCXString& part : result) {
    const int at = find(separator, start);
    const int end = at < 0 ? m_Length : at;
    part.appendSub(*this, start, end - 1);
    start = end + 1;
  }
  parts = std::move(result);
}

KyCXString& KyCXString::toLower() {
  changeUnits([](auto begin, auto end) {
    for (auto* unit = begin; unit != end; ++unit)
      *unit = static_cast<std::remove_reference_t<decltype(*unit)>>(
          lower(static_cast<unsigned short>(*unit)));
    return end;
  });
  return *this;
}

KyCXString& KyCXString::toUpper() {
  changeUnits([](auto begin, auto end) {
    for (auto* unit = begin; unit != end; ++unit)
      *unit = static_cast<std::remove_reference_t<decltype(*unit)>>(
          upper(static_cast<unsigned short>(*unit)));
    return end;
  });
  return *this;
}

KyCXString& KyCXString::trim(bool leading, bool trailing) {
  int from = 0;
  int to = m_Length - 1;
  while (leading && from <= to && isWhiteSpace((*this)[from])) ++from;
  while (trailing && from <= to && isWhiteSpace((*this)[to])) --to;
  if (from != 0 || to != m_Length - 1) *this = sub(from, to);
  return *this;
}

KyCXString& KyCXString::filterAngleBrackets() {
  if (m_Length >= 2 && (*this)[0] == '<' && (*this)[m_Length - 1] == '>')
    *this = sub(1, m_Length - 2);
  return *this;
}

KyCXString& KyCXString::replaceWhiteSpace(char by, bool collapse) {
  changeUnits([by, collapse](auto begin, auto end) {
    auto* out = begin;
    bool inRun = false;
    for (auto* unit = begin; unit != end; ++unit) {
      const bool white = isWhiteSpace(static_cast<unsigned short>(*unit));
      if (!white)
        *out++ = *unit;
      else if (!inRun || !collapse)
        *out++ = static_cast<std::remove_reference_t<decltype(*unit)>>(
            static_cast<unsigned char>(by));
      inRun = white;
    }
    return out;
  });
  return *this;
}

KyCXString& KyCXString::replace(const KyCXString& what, const KyCXString& by) {
  if (what.isEmpty()) return *this;
  int at = find(what, 0);
  if (at < 0) return *this;
  KyCXString result;
  int start = 0;
  for (; at >= 0; at = find(what, start)) {
    result.appendSub(*this, start, at - 1);
    result += by;
    start = at + what.m_Length;
  }
  result.appendSub(*this, start, m_Length - 1);
  *this = std::move(result);
  return *this;
}

KyCXString& KyCXString::makeCIdentifier(bool collapse) {
  if (isValidCIdentifier()) return *this;
  if (isDigit((*this)[0])) {
    KyCXString named = KyCXString('_') + *this;
    named.makeCIdentifier(collapse);
    return *this = std::move(named);
  }
  changeUnits([collapse](auto begin, auto end) {
    auto* out = begin;
    bool inRun = false;
    for (auto* unit = begin; unit != end; ++unit) {
      using Unit = std::remove_reference_t<decltype(*unit)>;
      const bool valid =
          isValidForCIdentifier(static_cast<std::make_unsigned_t<Unit>>(*unit));
      if (valid)
        *out++ = *unit;
      else if (!inRun || !collapse)
        *out++ = static_cast<Unit>('_');
      inRun = !valid;
    }
    return out;
  });
  return *this;
}

bool KyCXString::isValidCIdentifier() const {
  if (isEmpty() || m_Wide != nullptr || isDigit((*this)[0])) return false;
  return std::all_of(m_Text, m_Text + m_Length, [](char character) {
    return kIdentifierCharacters[static_cast<unsigned char>(character)];
  });
}

bool KyCXString::isValidForCIdentifier(const unsigned short& unit) {
  return unit < kIdentifierCharacters.size() && kIdentifierCharacters[unit];
}

KyCXString& KyCXString::shortenString(int maxLength, int fillCount, char fill,
                                      ScEPosition position) {
  maxLength = std::max(maxLength, 0);
  if (m_Length <= maxLength) return *this;
  fillCount = std::max(fillCount, 0);
  const int room = maxLength - fillCount;
  if (room <= 0) return *this = sub(m_Length - maxLength, m_Length - 1);
  int tail = room / 2;
  if (position == ePositionFront) tail = room;
  if (position == ePositionBack) tail = 0;
  KyCXString result = head(room - tail);
  for (int i = 0; i < fillCount; ++i) result += fill;
  result.appendSub(*this, m_Length - tail, m_Length - 1);
  return *this = std::move(result);
}

int KyCXString::compareWith(const KyCXString& other) const {
  const int common = std::min(m_Length, other.m_Length);
  if (m_Wide == nullptr && other.m_Wide == nullptr) {
    const int order = std::memcmp(m_Text, other.m_Text, sizeOf(common));
    return order != 0 ? order : m_Length - other.m_Length;
  }
  for (int i = 0; i < common; ++i) {
    const int order = int{(*this)[i]} - int{other[i]};
    if (order != 0) return order;
  }
  return m_Length - other.m_Length;
}

void KyCXString::release() {
  delete[] m_Wide;
  m_Wide = nullptr;
  if (m_Text == m_Inline) return;
  delete[] m_Text;
  m_Text = m_Inline;
  m_Capacity = kInlineCapacity;
}

// Grows by at least half, because repeated appending must stay linear.
void KyCXString::makeRoom(int capacity) {
  if (capacity <= m_Capacity) return;
  capacity = std::max(capacity, m_Capacity + m_Capacity / 2);
  char* text = new char[sizeOf(capacity) + 1];
  if (m_Text == m_Inline) {
    std::memcpy(text, m_Inline, sizeof m_Inline);
  } else {
    std::memcpy(text, m_Text, sizeOf(m_Length) + 1);
    delete[] m_Text;
  }
  m_Text = text;
  m_Capacity = capacity;
}

void KyCXString::setLength(int length) {
  m_Length = length;
  m_Text[length] = 0;
}

// \p text may lie inside this object.
void KyCXString::assignNarrow(const char* text, int length) {
  if (length > m_Capacity) {
    char* room = new char[sizeOf(length) + 1];
    std::memcpy(room, text, sizeOf(length));
    if (m_Text != m_Inline) delete[] m_Text;
    m_Text = room;
    m_Capacity = length;
  } else {
    std::memmove(m_Text, text, sizeOf(length));
  }
  delete[] std::exchange(m_Wide, nullptr);
  setLength(length);
  delete[] std::exchange(m_Wide, nullptr);
}

// \p units may lie inside this object.
void KyCXString::assignUnits(const unsigned short* units, int length) {
  const bool wide = std::any_of(
      units, units + length, [](unsigned short unit) { return unit > 0xFF; });
  makeRoom(length);
  unsigned short* kept = nullptr;
  if (wide) {
    kept = new unsigned short[sizeOf(length)];
    std::copy(units, units + length, kept);
  }
  std::transform(units, units + length, m_Text, narrowed);
  setLength(length);
  delete[] std::exchange(m_Wide, kept);
}

// \p text may lie inside this object, before its end.
void KyCXString::appendNarrow(const char* text, int length) {
  const int total = m_Length + length;
  if (total > m_Capacity) {
    const bool isOwn = text >= m_Text && text <= m_Text + m_Length;
    const std::ptrdiff_t offset = isOwn ? text - m_Text : 0;
    makeRoom(total);
    if (isOwn) text = m_Text + offset;
  }
  std::memcpy(m_Text + m_Length, text, sizeOf(length));
  setLength(total);
}

// Wide texts are rare: appending copies the whole text.
void KyCXString::appendUnits(const KyCXString& text, int from, int count) {
  Units units;
  units.reserve(sizeOf(m_Length) + sizeOf(count));
  for (int i = 0; i < m_Length; ++i) units.push_back((*this)[i]);
  for (int i = from; i < from + count; ++i) units.push_back(text[i]);
  assignUnits(units.data(), static_cast<int>(units.size()));
}

// Applies \p change to the units, in 8 or 16 bits as they are held. \p change
// rewrites [begin, end) and returns the new end.
template <class Change>
void KyCXString::changeUnits(Change change) {
  if (m_Wide == nullptr) {
    setLength(static_cast<int>(change(m_Text, m_Text + m_Length) - m_Text));
    return;
  }
  Units units(m_Wide, sizeOf(m_Length));
  unsigned short* begin = units.data();
  const auto* end = change(begin, begin + m_Length);
  assignUnits(begin, static_cast<int>(end - begin));
}
