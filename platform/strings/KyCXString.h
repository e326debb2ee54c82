// The generator's string class: a sequence of 16-bit units.
//
// A text of up to 39 units of ISO-8859-1, as nearly every name, lives inside
// the object and never asks for memory. A text with all units below 256 is held
// as 8-bit text, and cstring() is free; a text with a larger unit keeps the
// 16-bit units and the 8-bit form side by side.
//
// Without memory operations throw std::bad_alloc and leave the text as before
// the call.
//
//   KyCXString name("speed");
//   name += "_";
//   name += KyCXString(3, false, true);   // "speed_3"
//   name.find("_");                       // 5
//   name.sub(0, 4);                       // "speed"

#ifndef PLATFORM_STRINGS_KYCXSTRING_H
#define PLATFORM_STRINGS_KYCXSTRING_H

#include <cstddef>
#include <cstring>
#include <string_view>

#include "platform/HX_PlatformExport.h"
#include "platform/containers/array.h"

/// A value type. Positions count from 0; a range includes both ends.
/// Comparison is by unit value, never by locale. Letter case and white space
/// are the ones of ASCII: the letters A-Z and a-z; blank, tab, line feed,
/// vertical tab, form feed and carriage return.
class HX_PLATFORM_API KyCXString {
 public:
  /// Where shortenString() takes the text out.
  enum ScEPosition {
    ePositionFront = 0,
    ePositionMiddle = 1,
    ePositionBack = 2
  };

  KyCXString() noexcept { m_Inline[0] = 0; }
  /// The ISO-8859-1 text up to the terminating zero; null gives an empty text.
  KyCXString(const char* text);
  /// A single character.
  explicit KyCXString(char character);
  /// \p length units starting at \p units; none for a negative length.
  KyCXString(const unsigned short* units, int length);
  /// The digits of \p value: decimal, or hexadecimal in upper case (negative
  /// values then in two's complement). Unless \p shortest, zeros are put in
  /// front up to the width of the largest value.
  KyCXString(int value, bool hexadecimal, bool shortest);
  KyCXString(unsigned long value, bool hexadecimal, bool shortest);
  KyCXString(const KyCXString& other);
  KyCXString(KyCXString&& other) noexcept;
  ~KyCXString() {
    if (ownsMemory()) release();
  }

  /// Copies, moves, or reads as the constructors do. Without memory, that is
  /// with std::bad_alloc, the text stays as before.
  KyCXString& operator=(const KyCXString& other);
  KyCXString& operator=(KyCXString&& other) noexcept;
  KyCXString& operator=(const char* text);

  /// In units.
  int length() const { return m_Length; }
  bool isEmpty() const { return m_Length == 0; }

  /// The unit at \p position; 0 outside the text.
  unsigned short operator[](int position) const {
    if (position < 0 || position >= m_Length) return 0;
    if (m_Wide != nullptr) return m_Wide[position];
    return static_cast<unsigned char>(m_Text[position]);
  }

  /// The ISO-8859-1 form, zero-terminated; a unit above 255 shows as '?'.
  /// Never null; valid until the next change of this object.
  const char* cstring() const { return m_Text; }

  /// Makes room for \p length units below 256, because appending up to
  /// there then asks for no memory. The text stays.
  void reserve(int length) { makeRoom(length); }

  /// Appends \p text, possibly the same object.
  KyCXString& operator+=(const KyCXString& text) {
    const int room = m_Capacity - m_Length;
    if (m_Wide != nullptr || text.m_Wide != nullptr || text.m_Length > room)
      return appendText(text);
    std::memcpy(m_Text + m_Length, text.m_Text,
                static_cast<std::size_t>(text.m_Length));
    m_Length += text.m_Length;
    m_Text[m_Length] = 0;
    return *this;
  }
  /// Appends ISO-8859-1 characters; null counts as empty.
  KyCXString& operator+=(const char* text);
  KyCXString& operator+=(char character) {
    if (m_Wide != nullptr || m_Length == m_Capacity)
      return appendCharacter(character);
    m_Text[m_Length++] = character;
    m_Text[m_Length] = 0;
    return *this;
  }
  /// Appends a unit.
  KyCXString& appendUnit(unsigned short unit) {
    if (unit > 0xFF) return appendText(KyCXString(&unit, 1));
    return *this += static_cast<char>(unit);
  }
  /// Appends the result of sub() of \p text without a copy.
  KyCXString& appendSub(const KyCXString& text, int from, int to);

  /// The position of the first occurrence of \p text at or after \p from, -1
  /// without one. A negative \p from counts as 0; the empty text is found
  /// at every \p from up to the length.
  int find(const KyCXString& text, int from = 0) const;
  int find(char character, int from = 0) const;
  bool contains(const KyCXString& text) const { return find(text, 0) >= 0; }
  bool startsWith(const KyCXString& text) const { return matchesAt(0, text); }
  /// True if \p text stands at \p position, inside the text or outside.
  bool matchesAt(int position, const KyCXString& text) const {
    if (!text.isEmpty() && (*this)[position] != text[0]) return false;
    return matchesWholeAt(position, text);
  }

  /// The units in the closed range [\p from, \p to]. A range that reaches
  /// outside the text means the part inside; the part may be empty.
  KyCXString sub(int from, int to) const;
  /// The first \p count units; empty for a negative count.
  KyCXString head(int count) const {
    return sub(0, count > 0 ? count - 1 : -1);
  }

  /// The texts between the occurrences of \p separator, at least one: n
  /// separators give n + 1 parts, an empty text gives one empty part.
  void split(char separator, leda::array<KyCXString>& parts) const;

  /// Changes the case of letters.
  KyCXString& toLower();
  KyCXString& toUpper();
  /// Removes white space at the chosen ends.
  KyCXString& trim(bool leading, bool trailing);
  /// Removes a pair of angle brackets around the whole text.
  KyCXString& filterAngleBrackets();
  /// Writes \p by for every white space character or, with \p collapse, for
  /// every run of white space.
  KyCXString& replaceWhiteSpace(char by, bool collapse);
  /// Replaces every occurrence of the first text, from the left, never looking
  /// into a replacement; an empty first text changes nothing.
  KyCXString& replace(const KyCXString& what, const KyCXString& by);

  /// Writes '_' for every unit that may not stand in a C identifier (with
  /// \p collapse for every run of such units) and puts '_' before a leading
  /// digit. Every nonempty text becomes a valid identifier.
  KyCXString& makeCIdentifier(bool collapse);
  /// A letter or '_' first, then letters, digits and '_' (ISO C, 6.4.2.1,
  /// without universal character names).
  bool isValidCIdentifier() const;
  /// A letter, a digit or '_'.
  static bool isValidForCIdentifier(const unsigned short& unit);

  /// Cuts a text longer than \p maxLength to exactly \p maxLength units; a text
  /// that fits stays. The units around \p position are replaced
  /// by \p fillCount times \p fill: at the front the end of the text survives,
  /// in the middle both ends (the end at most one unit shorter), at the back
  /// the front. Where \p maxLength leaves no room beside the fill, the last
  /// \p maxLength units survive.
  KyCXString& shortenString(int maxLength, int fillCount, char fill,
                            ScEPosition position);

  /// Negative, 0 or positive as this text goes before, equals or goes after
  /// \p other: by the first different unit, else the shorter first.
  int compareWith(const KyCXString& other) const;

  /// By units, like compareWith().
  friend bool operator==(const KyCXString& a, const KyCXString& b) {
    if (a.m_Length != b.m_Length) return false;
    if (a.m_Wide == nullptr && b.m_Wide == nullptr)
      return std::memcmp(a.m_Text, b.m_Text,
                         static_cast<std::size_t>(a.m_Length)) == 0;
    return a.compareWith(b) == 0;
  }
  /// By units, like compareWith().
  friend bool operator<(const KyCXString& a, const KyCXString& b) {
    return a.compareWith(b) < 0;
  }
  /// \p a followed by \p b.
  friend KyCXString operator+(const KyCXString& a, const KyCXString& b) {
    KyCXString sum(a);
    sum += b;
    return sum;
  }
  /// The same; the sum takes the memory of \p a.
  friend KyCXString operator+(KyCXString&& a, const KyCXString& b) {
    a += b;
    return static_cast<KyCXString&&>(a);
  }

 private:
  static constexpr int kInlineCapacity = 39;

  bool ownsMemory() const { return m_Text != m_Inline || m_Wide != nullptr; }
  void release();
  bool matchesWholeAt(int position, const KyCXString& text) const;
  void makeRoom(int capacity);
  KyCXString& appendCharacter(char character);
  KyCXString& appendText(const KyCXString& text);
  void assignNarrow(const char* text, int length);
  void assignUnits(const unsigned short* units, int length);
  void appendNarrow(const char* text, int length);
  void appendUnits(const KyCXString& text, int from, int count);
  void setLength(int length);
  std::string_view narrow() const {
    return {m_Text, static_cast<std::size_t>(m_Length)};
  }
  template <class Change>
  void changeUnits(Change change);

  char* m_Text = m_Inline;           // 8-bit form, zero-terminated
  unsigned short* m_Wide = nullptr;  // units; null while all are below 256
  int m_Length = 0;
  int m_Capacity = kInlineCapacity;  // of m_Text, without the final zero
  char m_Inline[kInlineCapacity + 1];
};

namespace leda {

/// Orders texts as KyCXString::compareWith() does.
inline int compare(const KyCXString& a, const KyCXString& b) {
  return a.compareWith(b);
}

}  // namespace leda

#endif  // PLATFORM_STRINGS_KYCXSTRING_H
