// Letter codes of name suffixes: bijective numerals of base 26, least
// significant letter first.
//
//   index   0   1  ...  25   26   27  ...  701  702
//   code    a   b  ...   z   aa   ba  ...   zz  aaa
//
//   HX_LetterCode(27).text();                 // "ba"
//   HX_LetterCode::indexOf("ba", 2);          // 27
//   HX_LetterCode::firstOfLength(3);          // 702

#ifndef IMPLCONTAINERS_HX_LETTERCODE_H
#define IMPLCONTAINERS_HX_LETTERCODE_H

#include <algorithm>
#include <cstdint>
#include <limits>

/// The code of one index, in letters 'a' to 'z'.
class HX_LetterCode {
 public:
  /// Length of the longest code of an int.
  static constexpr int kLongest = 7;

  /// REQUIRES: \p index >= 0.
  explicit HX_LetterCode(int index) {
    do {
      m_Text[m_Length++] = static_cast<char>('a' + index % kLetters);
      index = index / kLetters - 1;
    } while (index >= 0);
    m_Text[m_Length] = 0;
  }

  /// Zero-terminated; lives as long as the object.
  const char* text() const { return m_Text; }
  int length() const { return m_Length; }

  /// RETURNS: the index of the code in \p letters, -1 if no int has the code.
  /// REQUIRES: \p length in [1, kLongest], all letters in 'a' to 'z'.
  static int indexOf(const char* letters, int length) {
    std::int64_t numeral = 0;
    while (length > 0)
      numeral = numeral * kLetters + (letters[--length] - 'a' + 1);
    return numeral > std::numeric_limits<int>::max()
               ? -1
               : static_cast<int>(numeral - 1);
  }

  /// RETURNS: the smallest index whose code has at least \p length letters,
  /// INT_MAX if no int has so long a code.
  static int firstOfLength(int length) {
    std::int64_t numeral = 0;
    while (length-- > 0) numeral = numeral * kLetters + 1;
    return static_cast<int>(
        std::min<std::int64_t>(numeral - 1, std::numeric_limits<int>::max()));
  }

 private:
  static constexpr int kLetters = 26;

  char m_Text[kLongest + 1];
  int m_Length = 0;
};

#endif  // IMPLCONTAINERS_HX_LETTERCODE_H
