// Version information of the modules of the process.
//
//   std::uint32_t handle = 0;
//   const std::uint32_t size = GetFileVersionInfoSizeA(path, &handle);
//   std::vector<char> block(size);
//   void* value = nullptr;
//   unsigned int length = 0;
//   if (size != 0 && GetFileVersionInfoA(path, 0, size, block.data()) &&
//       VerQueryValueA(block.data(), "\\", &value, &length)) ...
//
// Where the system keeps no version information in its modules, a host says
// what is loaded: see HX_VersionResource.h. File names are compared as they
// are written.

#ifndef PLATFORM_OS_HX_OSVERSION_H
#define PLATFORM_OS_HX_OSVERSION_H

#include <cstdint>

#include "platform/HX_PlatformExport.h"

/// Names a loaded module.
using HX_ModuleHandle = const void*;

/// The value of the root of a block. The four parts of a version are the high
/// and low halves of its MS and LS words, in this order.
struct VS_FIXEDFILEINFO {
  std::uint32_t dwSignature;         ///< 0xFEEF04BD
  std::uint32_t dwStrucVersion;      ///< of this structure; 0x10000
  std::uint32_t dwFileVersionMS;     ///< first two parts
  std::uint32_t dwFileVersionLS;     ///< last two parts
  std::uint32_t dwProductVersionMS;  ///< first two parts
  std::uint32_t dwProductVersionLS;  ///< last two parts
  std::uint32_t dwFileFlagsMask;     ///< which flags count
  std::uint32_t dwFileFlags;         ///< debug, prerelease, ...
  std::uint32_t dwFileOS;            ///< the system it is made for
  std::uint32_t dwFileType;          ///< program, library, ...
  std::uint32_t dwFileSubtype;       ///< of drivers and fonts
  std::uint32_t dwFileDateMS;        ///< high word; mostly 0
  std::uint32_t dwFileDateLS;        ///< low word; mostly 0
};

/// The loaded module \p name, null if there is none. Letter case does not
/// matter. Not to be released.
HX_PLATFORM_API HX_ModuleHandle GetModuleHandleA(const char* name);

/// The full path of the file of \p module, for null of the process's
/// executable; cut to \p size - 1 bytes and zero-terminated.
/// \return the bytes written without the zero; 0 if the path is not known
HX_PLATFORM_API std::uint32_t GetModuleFileNameA(HX_ModuleHandle module,
                                                 char* path,
                                                 std::uint32_t size);

/// The bytes that the version information of \p path needs; 0 if it has none.
/// \param[out] handle  set to 0; may be null
HX_PLATFORM_API std::uint32_t GetFileVersionInfoSizeA(const char* path,
                                                      std::uint32_t* handle);

/// Reads the version information of \p path into \p block, which must be
/// aligned to four bytes. \p handle is ignored.
/// \return 0 if there is none, it is damaged, or \p size is too small
HX_PLATFORM_API int GetFileVersionInfoA(const char* path, std::uint32_t handle,
                                        std::uint32_t size, void* block);

/// Finds a value of a block of GetFileVersionInfoA() by its path: "\\" is the
/// root (a VS_FIXEDFILEINFO), "\\VarFileInfo\\Translation" the languages (low
/// 16 bits) and code pages (high 16 bits) as 32-bit words,
/// "\\StringFileInfo\\040904B0\\CompanyName" a zero-terminated text of that
/// language and code page in hexadecimal. Letter case and the first backslash
/// do not matter.
/// \param[out] value  inside \p block; written when the result is not 0
/// \param[out] length  in bytes, of a text with its final zero; likewise
/// \return 0 if there is no such value
HX_PLATFORM_API int VerQueryValueA(const void* block, const char* path,
                                   void** value, unsigned int* length);

#endif  // PLATFORM_OS_HX_OSVERSION_H
