// Modules and version information as one operating system has them. Private to
// platform/os: linux/ and windows/ define these functions, HX_OsVersion.cpp
// adds the modules of the host. The names differ from the calls of the system,
// because the header of the system declares those.

#ifndef PLATFORM_OS_HX_SYSTEMMODULES_H
#define PLATFORM_OS_HX_SYSTEMMODULES_H

#include <cstdint>
#include <string>

/// The loaded module \p name; null if not loaded.
const void* HX_FindSystemModule(const char* name);

/// The path of a loaded module, of the executable for null; empty if unknown.
std::string HX_SystemModulePath(const void* module);

/// Bytes of the version information of the file \p path; 0 without any.
std::uint32_t HX_SystemVersionSize(const char* path);

/// Reads the version information of \p path into \p size bytes at \p block.
bool HX_ReadSystemVersion(const char* path, std::uint32_t size, void* block);

/// Finds a value of a block of HX_ReadSystemVersion().
bool HX_QuerySystemVersion(const void* block, const char* path, void** value,
                           unsigned int* length);

#endif  // PLATFORM_OS_HX_SYSTEMMODULES_H
