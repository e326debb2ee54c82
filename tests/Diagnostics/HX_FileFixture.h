// Runs each test in an empty working directory of its own.

#ifndef DIAGNOSTICS_HX_FILEFIXTURE_H
#define DIAGNOSTICS_HX_FILEFIXTURE_H

#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>

#include "support/HX_TestFixture.h"

class HX_FileFixture : public HX_TestFixture {
 protected:
  HX_FileFixture() {
    char name[] = "/tmp/hx_diagnostics_XXXXXX";
    std::filesystem::current_path(mkdtemp(name));
  }
  ~HX_FileFixture() override {
    const auto directory = std::filesystem::current_path();
    std::filesystem::current_path(m_Previous);
    std::filesystem::remove_all(directory);
  }

  /// The bytes of a file of the directory, "(none)" if it is not there.
  static std::string content(const char* name) {
    std::ifstream file(name, std::ios::binary);
    if (!file) return "(none)";
    return std::string(std::istreambuf_iterator<char>(file), {});
  }

  /// Makes it impossible to open \p name, even for a privileged user.
  static void obstruct(const char* name) {
    std::filesystem::create_directory(name);
  }

 private:
  std::filesystem::path m_Previous = std::filesystem::current_path();
};

#endif  // DIAGNOSTICS_HX_FILEFIXTURE_H
