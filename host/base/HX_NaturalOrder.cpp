#include "host/base/HX_NaturalOrder.h"

#include <algorithm>

namespace {

bool isDigit(char c) { return c >= '0' && c <= '9'; }

std::string_view digitsAt(std::string_view text, std::size_t at) {
  std::size_t end = at;
  while (end < text.size() && isDigit(text[end])) ++end;
  return text.substr(at, end - at);
}

std::string_view withoutZeros(std::string_view digits) {
  return digits.substr(std::min(digits.find_first_not_of('0'), digits.size()));
}

// Negative, zero or positive, by value.
int compareNumbers(std::string_view a, std::string_view b) {
  a = withoutZeros(a);
  b = withoutZeros(b);
  if (a.size() != b.size()) return a.size() < b.size() ? -1 : 1;
  return a.compare(b);
}

}  // namespace

bool HX_NaturalLess(std::string_view a, std::string_view b) {
  std::size_t i = 0;
  std::size_t j = 0;
  while (i < a.size() && j < b.size()) {
    if (isDigit(a[i]) && isDigit(b[j])) {
      const std::string_view left = digitsAt(a, i);
      const std::string_view right = digitsAt(b, j);
      const int order = compareNumbers(left, right);
      if (order != 0) return order < 0;
      i += left.size();
      j += right.size();
      continue;
    }
    if (a[i] != b[j])
      return static_cast<unsigned char>(a[i]) <
             static_cast<unsigned char>(b[j]);
    ++i;
    ++j;
  }
  if ((i < a.size()) != (j < b.size())) return j < b.size();
  return a < b;
}
