#include <cerrno>

#include <fcntl.h>
#include <unistd.h>

#include "platform/os/HX_OsFile.h"

namespace {

constexpr mode_t kReadWriteForAll = 0666;  // reduced by the process's umask

// No buffer and no stream object between the text and the file: a log line
// costs three system calls.
bool writeOnce(const char* name, int mode, const char* text,
               std::size_t length) {
  // Read and write, because the "+" modes ask for both rights.
  const int file =
      open(name, O_RDWR | O_CREAT | O_CLOEXEC | mode, kReadWriteForAll);
  if (file < 0) return false;
  while (length > 0) {
    const ssize_t written = write(file, text, length);
    if (written < 0 && errno == EINTR) continue;
    if (written <= 0) break;
    text += written;
    length -= static_cast<std::size_t>(written);
  }
  return close(file) == 0 && length == 0;
}

}  // namespace

bool HX_RewriteFile(const char* name, const char* text, std::size_t length) {
  return writeOnce(name, O_TRUNC, text, length);
}

bool HX_AppendToFile(const char* name, const char* text, std::size_t length) {
  return writeOnce(name, O_APPEND, text, length);
}
