// The C run-time's files in text mode: a line feed becomes two bytes.

#include <cstdio>

#include "platform/os/HX_OsFile.h"

namespace {

bool writeOnce(const char* name, const char* mode, const char* text,
               std::size_t length) {
  std::FILE* file = std::fopen(name, mode);
  if (file == nullptr) return false;
  const bool isWritten = std::fwrite(text, 1, length, file) == length;
  return std::fclose(file) == 0 && isWritten;
}

}  // namespace

bool HX_RewriteFile(const char* name, const char* text, std::size_t length) {
  return writeOnce(name, "w+", text, length);
}

bool HX_AppendToFile(const char* name, const char* text, std::size_t length) {
  return writeOnce(name, "a+", text, length);
}
