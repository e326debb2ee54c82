#include "Strings/STR_StringSupport.h"

#include <cstdarg>
#include <cstddef>
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

// A null result of this loop is always a failed allocation, since no further
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
  const int digits = precision < 0 ? kDefaultPrecision : precision;
  const int length = std::snprintf(nullptr, 0, "%.*f", digits, value);
  // Of more than INT_MAX characters the C library says -1, but 0 for a
  // precision of INT_MAX itself.
  if (length <= 0) return nullptr;
  char* result = allocate(static_cast<std::size_t>(length) + 1);
  if (result == nullptr) return nullptr;
  HX_WriteFixed(result, static_cast<std::size_t>(length) + 1, value, digits);
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
