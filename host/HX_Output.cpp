#include "host/HX_Output.h"

#include <fstream>
#include <iterator>
#include <system_error>

namespace fs = std::filesystem;

namespace {

constexpr char kTemporary[] = ".hx_tmp";

bool hasContent(const fs::path& path, const std::string& text) {
  std::ifstream file(path, std::ios::binary);
  if (!file) return false;
  return std::string(std::istreambuf_iterator<char>(file), {}) == text;
}

void writeFile(const fs::path& path, const std::string& text) {
  std::ofstream file(path, std::ios::binary | std::ios::trunc);
  file << text;
  file.close();
  if (!file) throw HX_OutputError(path.string() + ": cannot be written");
}

}  // namespace

HX_Output::~HX_Output() {
  std::error_code ignored;
  for (const fs::path& path : m_Temporary) fs::remove(path, ignored);
}

std::vector<std::string> HX_Output::commit() {
  std::error_code error;
  fs::create_directories(m_Folder, error);
  if (error) throw HX_OutputError(m_Folder.string() + ": " + error.message());

  std::vector<std::string> changed;
  for (const auto& [name, text] : m_Files) {
    const fs::path path = m_Folder / name;
    if (fs::is_directory(path))
      throw HX_OutputError(path.string() + ": is a folder");
    if (hasContent(path, text)) continue;
    m_Temporary.push_back(m_Folder / (name + kTemporary));
    writeFile(m_Temporary.back(), text);
    changed.push_back(name);
  }
  for (const std::string& name : changed) {
    fs::rename(m_Folder / (name + kTemporary), m_Folder / name, error);
    if (error)
      throw HX_OutputError((m_Folder / name).string() + ": " + error.message());
  }
  m_Temporary.clear();
  return changed;
}
