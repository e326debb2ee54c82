// An empty working directory for each test, and a recording listener.

#ifndef DIAGNOSTICS_HX_FILEFIXTURE_H
#define DIAGNOSTICS_HX_FILEFIXTURE_H

#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>

#include "Diagnostics/HX_TimingListener.h"
#include "support/HX_Environment.h"
#include "support/HX_HeapCount.h"
#include "support/HX_TestFixture.h"

class HX_FileFixture : public HX_TestFixture {
 protected:
  HX_FileFixture() { std::filesystem::current_path(HX_MakeTemporaryFolder()); }
  ~HX_FileFixture() override {
    const auto directory = std::filesystem::current_path();
    std::filesystem::current_path(m_Previous);
    std::filesystem::remove_all(directory);
  }

  /// The text of a file of the directory, with line ends of one character on
  /// every system; "(none)" for a missing file.
  static std::string content(const char* name) {
    std::ifstream file(name);
    if (!file) return "(none)";
    return std::string(std::istreambuf_iterator<char>(file), {});
  }

 private:
  std::filesystem::path m_Previous = std::filesystem::current_path();
};

/// Listener, installed while alive; notes each run as "name start+duration ".
class HX_RunRecorder : public HX_TimingListener {
 public:
  HX_RunRecorder() { install(this); }
  ~HX_RunRecorder() override { install(nullptr); }
  void runEnded(const char* name, std::int64_t start,
                std::int64_t duration) override {
    runs += name + (" " + std::to_string(start)) + "+" +
            std::to_string(duration) + " ";
  }

  std::string runs;
};

#endif  // DIAGNOSTICS_HX_FILEFIXTURE_H
