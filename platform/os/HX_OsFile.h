// Whole writes to small text files.
//
//   const std::string line = "START model\n";
//   HX_AppendToFile("log.txt", line.data(), line.size());
//
// Each call opens the file by its name, writes and closes it again, so that
// between two calls a reader sees a complete file and may move or remove it.

#ifndef PLATFORM_OS_HX_OSFILE_H
#define PLATFORM_OS_HX_OSFILE_H

#include <cstddef>

#include "platform/HX_PlatformExport.h"

/// Replaces the content of file \p name, which is created if it is not there,
/// by \p length bytes, as fopen() with mode "w+" does.
/// \return false if the file could not be opened or written
HX_PLATFORM_API bool HX_RewriteFile(const char* name, const char* text,
                                    std::size_t length);

/// Appends \p length bytes to file \p name, which is created if it is not
/// there, as fopen() with mode "a+" does. Bytes of several processes do not
/// overwrite each other.
/// \return false if the file could not be opened or written
HX_PLATFORM_API bool HX_AppendToFile(const char* name, const char* text,
                                     std::size_t length);

#endif  // PLATFORM_OS_HX_OSFILE_H
