#include <windows.h>

#include <winver.h>

#include "platform/os/HX_SystemModules.h"

const void* HX_FindSystemModule(const char* name) {
  return GetModuleHandleA(name);
}

std::string HX_SystemModulePath(const void* module) {
  std::string path(MAX_PATH, '\0');
  const auto handle = static_cast<HMODULE>(const_cast<void*>(module));
  for (;;) {
    const DWORD length = GetModuleFileNameA(handle, path.data(),
                                            static_cast<DWORD>(path.size()));
    if (length < path.size()) {
      path.resize(length);
      return path;
    }
    path.resize(2 * path.size());
  }
}

std::uint32_t HX_SystemVersionSize(const char* path) {
  DWORD unused = 0;
  return GetFileVersionInfoSizeA(path, &unused);
}

bool HX_ReadSystemVersion(const char* path, std::uint32_t size, void* block) {
  return GetFileVersionInfoA(path, 0, size, block) != 0;
}

bool HX_QuerySystemVersion(const void* block, const char* path, void** value,
                           unsigned int* length) {
  return VerQueryValueA(block, path, value, length) != 0;
}
