#include "host/base/HX_ComparingOutput.h"

#include <cstring>
#include <fstream>
#include <ostream>
#include <streambuf>

namespace fs = std::filesystem;

namespace {

/// Compares all that is written with a file.
class Comparison : public std::streambuf {
 public:
  explicit Comparison(const fs::path& path) : m_Old(path, std::ios::binary) {
    std::error_code error;
    m_IsSame = m_Old.is_open() && fs::is_regular_file(path, error);
  }

  bool isSame() {
    return m_IsSame && m_Old.peek() == std::ifstream::traits_type::eof();
  }

 protected:
  int_type overflow(int_type c) override {
    const char one = traits_type::to_char_type(c);
    xsputn(&one, 1);
    return traits_type::not_eof(c);
  }

  std::streamsize xsputn(const char* text, std::streamsize count) override {
    char old[4096];
    for (std::streamsize at = 0; m_IsSame && at < count;) {
      const std::streamsize part =
          std::min<std::streamsize>(count - at, sizeof old);
      m_Old.read(old, part);
      m_IsSame =
          m_Old.gcount() == part &&
          std::memcmp(old, text + at, static_cast<std::size_t>(part)) == 0;
      at += part;
    }
    return count;
  }

 private:
  std::ifstream m_Old;
  bool m_IsSame = false;
};

}  // namespace

struct HX_ComparingOutput::File {
  explicit File(const fs::path& path) : comparison(path), out(&comparison) {}
  Comparison comparison;
  std::ostream out;
};

HX_ComparingOutput::HX_ComparingOutput(const fs::path& folder)
    : m_Folder(folder) {}

HX_ComparingOutput::~HX_ComparingOutput() = default;

std::ostream& HX_ComparingOutput::open(const std::string& name) {
  auto& file = m_Files[name];
  file = std::make_unique<File>(m_Folder / name);
  return file->out;
}

std::vector<std::string> HX_ComparingOutput::names() const {
  std::vector<std::string> all;
  for (const auto& [name, file] : m_Files) all.push_back(name);
  return all;
}

std::vector<std::string> HX_ComparingOutput::changed() {
  std::vector<std::string> all;
  for (const auto& [name, file] : m_Files)
    if (!file->comparison.isSame()) all.push_back(name);
  return all;
}
