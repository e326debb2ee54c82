// Checks that must hold for every input, and the bytes that drive a check.
//
// A check builds a case from the bytes, does the work and compares the result
// with a plain form. Fuzzers choose the bytes by coverage; tests take the bytes
// from the corpus and from random changes of the corpus.
//
//   void HX_CheckSplit(HX_Bytes& bytes) {
//     const KyCXString text = bytes.text();
//     ...
//     HX_Require(joined == text, "split texts joined give the text");
//   }

#ifndef FUZZ_HX_FUZZ_H
#define FUZZ_HX_FUZZ_H

#include <algorithm>
#include <stdexcept>
#include <string>
#include <utility>

#include "platform/strings/KyCXString.h"

/// Bytes of one input, read from the front. After the end come zeros and empty
/// texts.
class HX_Bytes {
 public:
  explicit HX_Bytes(std::string bytes) : m_Bytes(std::move(bytes)) {}

  bool isEmpty() const { return m_At >= m_Bytes.size(); }
  /// One byte.
  int number() {
    return isEmpty() ? 0 : static_cast<unsigned char>(m_Bytes[m_At++]);
  }
  int below(int limit) { return number() % limit; }
  bool flag() { return number() % 2 != 0; }
  std::string line() {
    const std::size_t length = m_Bytes.find('\n', m_At) - m_At;
    const std::string line = m_Bytes.substr(m_At, length);
    m_At = std::min(m_At + line.size() + 1, m_Bytes.size());
    return line;
  }
  /// A line as units; bytes from 0xF8 on stand for the units from 0xFFF8 on.
  KyCXString text() {
    KyCXString text;
    for (const char c : line()) text.appendUnit(unitOf(c));
    return text;
  }
  static unsigned short unitOf(char c) {
    const auto unit = static_cast<unsigned char>(c);
    return static_cast<unsigned short>(unit < 0xF8 ? unit : unit | 0xFF00);
  }
  std::string rest() {
    return m_Bytes.substr(std::exchange(m_At, m_Bytes.size()));
  }

 private:
  std::string m_Bytes;
  std::size_t m_At = 0;
};

/// Ends the check if \p holds is false.
inline void HX_Require(bool holds, const std::string& claim) {
  if (!holds) throw std::logic_error("does not hold: " + claim);
}

// One source per check.
void HX_CheckDocument(HX_Bytes& bytes);
void HX_CheckEnvironment(HX_Bytes& bytes);
void HX_CheckMessages(HX_Bytes& bytes);
void HX_CheckNames(HX_Bytes& bytes);
void HX_CheckParser(HX_Bytes& bytes);
void HX_CheckSorter(HX_Bytes& bytes);
void HX_CheckString(HX_Bytes& bytes);

#endif  // FUZZ_HX_FUZZ_H
