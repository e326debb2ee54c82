// Whole writes to small text files.
//
//   const std::string line = "START model\n";
//   HX_AppendToFile("log.txt", line.data(), line.size());
//
// Every call opens the file by name, writes and closes: between two calls a
// reader sees a complete file and may move or remove the file.

#ifndef PLATFORM_OS_HX_OSFILE_H
#define PLATFORM_OS_HX_OSFILE_H

#include <cstddef>

#include "platform/HX_PlatformExport.h"

/// Replaces the content of file \p name, created unless present,
/// by \p length bytes, as fopen() with mode "w+" does.
/// RETURNS: false if the file could not be opened or written.
HX_PLATFORM_API bool HX_RewriteFile(const char* name, const char* text,
                                    std::size_t length);

/// Appends \p length bytes to file \p name, created unless present, as fopen()
/// with mode "a+" does. Processes do not overwrite bytes of other processes.
/// RETURNS: false if the file could not be opened or written.
HX_PLATFORM_API bool HX_AppendToFile(const char* name, const char* text,
                                     std::size_t length);

#endif  // PLATFORM_OS_HX_OSFILE_H
