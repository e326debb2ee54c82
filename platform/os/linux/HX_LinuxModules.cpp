// Modules of this system carry no version information.

#include <filesystem>
#include <system_error>

#include "platform/os/HX_SystemModules.h"

const void* HX_FindSystemModule(const char*) { return nullptr; }

std::string HX_SystemModulePath(const void* module) {
  std::error_code error;
  if (module != nullptr) return {};
  return std::filesystem::read_symlink("/proc/self/exe", error).string();
}

std::uint32_t HX_SystemVersionSize(const char*) { return 0; }

bool HX_ReadSystemVersion(const char*, std::uint32_t, void*) { return false; }

bool HX_QuerySystemVersion(const void*, const char*, void**, unsigned int*) {
  return false;
}
