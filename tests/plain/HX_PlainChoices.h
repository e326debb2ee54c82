// Choices that build a random case, and the search for the smallest case.
//
// A case is a text of bytes; every byte decides one choice, 0 for the simplest
// answer. Behind the end all bytes are 0. Removing and lowering bytes makes a
// case smaller, whatever the case is about.

#ifndef PLAIN_HX_PLAINCHOICES_H
#define PLAIN_HX_PLAINCHOICES_H

#include <functional>
#include <initializer_list>
#include <random>
#include <utility>

#include "plain/HX_PlainText.h"

namespace plain {

class Choices {
 public:
  /// \param log  receives the choices that are not 0, if not null
  explicit Choices(std::string bytes, std::string* log = nullptr)
      : m_Bytes(std::move(bytes)), m_pLog(log) {}

  bool isEmpty() const { return m_At >= m_Bytes.size(); }
  int byte() {
    return isEmpty() ? 0 : static_cast<unsigned char>(m_Bytes[m_At++]);
  }
  /// In [0, \p limit).
  int below(const char* what, int limit) { return told(what, byte() % limit); }
  bool flag(const char* what) { return below(what, 2) != 0; }
  /// True in one of \p n cases.
  bool rarely(const char* what, int n) { return below(what, n) == n - 1; }
  /// An index below \p count, or -1.
  int index(const char* what, std::size_t count) {
    return told(what, byte() % (static_cast<int>(count) + 1)) - 1;
  }
  template <class T>
  T of(const char* what, std::initializer_list<T> values) {
    const int i = byte() % static_cast<int>(values.size());
    return told(what, *(values.begin() + i));
  }
  /// Up to \p most pieces; not logged without a name.
  Text text(const char* what, int most,
            std::initializer_list<const char16_t*> pieces);
  /// Any units but 0; bytes from 0xF8 on stand for units from 0xFFF8 on.
  Text anyText();
  void tell(const std::string& text) {
    if (m_pLog != nullptr) *m_pLog += text;
  }

 private:
  template <class T>
  T told(const char* what, T value) {
    if constexpr (std::is_arithmetic_v<T>) {
      if (what != nullptr && m_pLog != nullptr && value != T())
        tell(std::string(" ") + what + "=" + std::to_string(value));
    }
    return value;
  }

  std::string m_Bytes;
  std::size_t m_At = 0;
  std::string* m_pLog;
};

/// All units visible: "\u0416" for a unit outside ASCII.
std::string shown(const Text& text);

/// Runs a case on both sides. RETURNS: the difference, or an empty text.
/// \param log  receives the description of the case, if not null
using Check =
    std::function<std::string(const std::string& bytes, std::string* log)>;

/// Runs \p count random cases of about \p length choices. RETURNS: the smallest
/// case with a difference, as choices, calls and answers of both sides; an
/// empty text without a difference.
std::string smallestDifference(unsigned seed, int count, std::size_t length,
                               const Check& check);

}  // namespace plain

#endif  // PLAIN_HX_PLAINCHOICES_H
