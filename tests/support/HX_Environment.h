// Environment variables and folders of a test, on every system.

#ifndef SUPPORT_HX_ENVIRONMENT_H
#define SUPPORT_HX_ENVIRONMENT_H

#include <stdlib.h>

#include <filesystem>
#include <string>

/// Sets a variable; null removes the variable. Windows removes a variable of
/// the empty text too.
inline void HX_SetVariable(const char* name, const char* value) {
#if defined(_WIN32)
  _putenv_s(name, value == nullptr ? "" : value);
#else
  if (value == nullptr)
    unsetenv(name);
  else
    setenv(name, value, 1);
#endif
}

/// Makes a new folder in the folder for temporary files.
inline std::filesystem::path HX_MakeTemporaryFolder() {
  const auto base = std::filesystem::temp_directory_path() / "hx_test_";
  for (int number = 0;; ++number) {
    const std::filesystem::path folder = base.string() + std::to_string(number);
    if (std::filesystem::create_directory(folder)) return folder;
  }
}

#endif  // SUPPORT_HX_ENVIRONMENT_H
