#include "Strings/STR_StringSupport.h"

#include <cmath>
#include <cstdarg>
#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <cstring>
#include <limits>

#include "implContainers/HX_Number.h"
#include "platform/memory/HxCMemController.h"

namespace {

constexpr int kDefaultPrecision = 6;  // of printf

char* allocate(std::size_t size) {
  return static_cast<char*>(
      pHXMemory->allocMemBlock(static_cast<unsigned long>(size)));
}

void release(char* s) {
  if (s != nullptr) pHXMemory->freeMemBlock(s);
}

std::size_t digitCount(std::int64_t number) {
  std::size_t count = 1;
  while (number /= 10) ++count;
  return count;
}

// RETURNS: the size of the block of STR_DoubleToString(). A value with a 32-bit
// integer part has its digits, the decimals, point, zero and a spare byte,
// which holds the digit of 9.9 rounded up to 10. Any other value is measured; 0
// for more than INT_MAX characters.
std::size_t blockSize(double value, int precision, int decimals) {
  constexpr int kLongest = std::numeric_limits<int>::max() - 20;
  if (value > -2147483649.0 && value < 2147483648.0 && precision >= 0 &&
      precision < kLongest) {
    const std::size_t sign = value < 0.0 ? 1 : 0;
    const std::size_t digits = digitCount(static_cast<std::int64_t>(value));
    return digits + static_cast<std::size_t>(precision) + 3 + sign;
  }
  // The C run-times differ in the sign of NaN, HX_WriteFixed() writes the sign.
  if (std::isnan(value)) return std::signbit(value) ? 5 : 4;
  const int length = std::snprintf(nullptr, 0, "%.*f", decimals, value);
  // Of more than INT_MAX characters the C library says -1, but 0 for a
  // precision of INT_MAX itself.
  return length <= 0 ? 0 : static_cast<std::size_t>(length) + 1;
}

char* duplicate(const char* bytes, std::size_t length) {
  char* copy = allocate(length + 1);
  if (copy == nullptr) return nullptr;
  std::memcpy(copy, bytes, length);
  copy[length] = 0;
  return copy;
}

char lower(char ch) {
  return ch >= 'A' && ch <= 'Z' ? static_cast<char>(ch - 'A' + 'a') : ch;
}

bool isWhiteSpace(char ch) { return ch == '\n' || ch == '\t' || ch == ' '; }

// Null in the loop always means a failed allocation, because no further
// argument is null.
char* appendAll(char* result, std::va_list arguments) {
  for (const char* next = va_arg(arguments, const char*); next != nullptr;
       next = va_arg(arguments, const char*)) {
    char* longer = STR_ConcatenateStrings(result, next);
    release(result);
    if (longer == nullptr) return nullptr;
    result = longer;
  }
  return result;
}

}  // namespace

char* STR_ConcatenateStrings(const char* a, const char* b) {
  if (a == nullptr) return STR_DuplicateString(b);
  if (b == nullptr) return STR_DuplicateString(a);
  const std::size_t front = std::strlen(a);
  const std::size_t back = std::strlen(b);
  char* result = allocate(front + back + 1);
  if (result == nullptr) return nullptr;
  std::memcpy(result, a, front);
  std::memcpy(result + front, b, back + 1);
  return result;
}

char* STR_Concatenate3Strings(const char* a, const char* b, const char* c) {
  return STR_ConcatenateNStrings(a, b, c, static_cast<const char*>(nullptr));
}

char* STR_ConcatenateNStrings(const char* first, ...) {
  char* result = STR_DuplicateString(first);
  if (first != nullptr && result == nullptr) return nullptr;
  std::va_list arguments;
  va_start(arguments, first);
  result = appendAll(result, arguments);
  va_end(arguments);
  return result;
}

char* STR_IntToString(int value) {
  char digits[std::numeric_limits<int>::digits10 + 3];  // one more, '-', 0
  return duplicate(digits, HX_WriteInt(digits, sizeof digits, value));
}

char* STR_DoubleToString(double value, int precision) {
  const int decimals = precision < 0 ? kDefaultPrecision : precision;
  const std::size_t size = blockSize(value, precision, decimals);
  if (size == 0) return nullptr;
  char* result = allocate(size);
  if (result != nullptr) HX_WriteFixed(result, size, value, decimals);
  return result;
}

char* STR_DuplicateString(const char* s) {
  return s == nullptr ? nullptr : duplicate(s, std::strlen(s));
}

bool STR_IsNullOrEmpty(const char* s) { return s == nullptr || *s == 0; }

bool STR_StringsAreEqual(const char* a, const char* b,
                         STR_case_sensitive_etp mode) {
  if (a == nullptr || b == nullptr) return a == b;
  if (mode == STR_CASE_SENSITIVE) return std::strcmp(a, b) == 0;
  while (*a != 0 && lower(*a) == lower(*b)) ++a, ++b;
  return *a == *b;
}

bool STR_IsValidCharForCIdentifier(char ch) {
  return ch == '_' || (ch >= '0' && ch <= '9') ||
         (lower(ch) >= 'a' && lower(ch) <= 'z');
}

void STR_ProcessString(char* dst, const char* src, STR_process_mode_tp mode) {
  const bool toBlank =
      mode != STR_WHITESPACE_TO_UNDERSCORE && mode != STR_INVALID_TO_UNDERSCORE;
  const char fill = toBlank ? ' ' : '_';
  for (; *src != 0; ++src) {
    const bool replaced = mode == STR_INVALID_TO_UNDERSCORE
                              ? !STR_IsValidCharForCIdentifier(*src)
                              : isWhiteSpace(*src);
    *dst++ = replaced ? fill : *src;
  }
  *dst = 0;
}
