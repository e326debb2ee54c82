#include "host/base/HX_Output.h"

#include <algorithm>
#include <cerrno>
#include <iterator>
#include <system_error>

namespace fs = std::filesystem;

namespace {

void stopAfterSignal() {
  if (HX_DelayedSignals::isEndRequested()) throw HX_OutputError("interrupted");
}

// Unique in the machine, and in the process: several outputs may share a
// folder.
std::string temporaryName() {
  static int s_Number = 0;
  return ".hx_codegen-" + HX_ProcessNumber() + "-" + std::to_string(++s_Number);
}

[[noreturn]] void fail(const fs::path& path, const std::error_code& error,
                       const std::string& more = "") {
  throw HX_OutputError(path.string() +
                       ": cannot be written: " + error.message() + more);
}

void require(bool isDone, const fs::path& path) {
  if (!isDone) fail(path, std::error_code(errno, std::generic_category()));
}

bool haveSameContent(const fs::path& a, const fs::path& b) {
  std::error_code error;
  if (fs::file_size(a, error) != fs::file_size(b, error) || error) return false;
  std::ifstream first(a, std::ios::binary);
  std::ifstream second(b, std::ios::binary);
  return std::equal(std::istreambuf_iterator<char>(first), {},
                    std::istreambuf_iterator<char>(second), {});
}

}  // namespace

HX_Output::HX_Output(const fs::path& folder)
    : m_Folder(folder),
      m_Temporary(folder / temporaryName()),
      m_New(m_Temporary / "new"),
      m_Old(m_Temporary / "old") {}

HX_Output::~HX_Output() {
  std::error_code error;
  m_Files.clear();
  fs::remove_all(m_KeepsOld ? m_New : m_Temporary, error);
  for (const fs::path& made : m_MadeFolders) fs::remove(made, error);
}

void HX_Output::makeFolders() {
  std::error_code error;
  for (fs::path path = m_Folder; !fs::exists(path, error);
       path = path.parent_path())
    m_MadeFolders.push_back(path);
  fs::create_directories(m_New, error);
  if (!error) fs::create_directory(m_Old, error);
  if (error) fail(m_Folder, error);
}

std::ostream& HX_Output::open(const std::string& name) {
  stopAfterSignal();
  if (m_Files.empty()) makeFolders();
  std::ofstream& file = m_Files[name];
  file.open(m_New / name, std::ios::binary);
  require(file.is_open(), m_Folder / name);
  return file;
}

std::size_t HX_Output::finish() {
  for (auto& [name, file] : m_Files) {
    file.close();
    require(file.good(), m_Folder / name);
  }
  for (const auto& [name, file] : m_Files) {
    if (fs::is_directory(m_Folder / name))
      fail(m_Folder / name, std::make_error_code(std::errc::is_a_directory));
    if (!haveSameContent(m_New / name, m_Folder / name))
      m_Changed.push_back(name);
  }
  return m_Changed.size();
}

// Afterwards m_Old has the file that was in the way.
std::error_code HX_Output::replace(const std::string& name) {
  const fs::path path = m_Folder / name;
  std::error_code error;
  if (fs::exists(path, error)) {
    fs::create_hard_link(path, m_Old / name, error);
    if (error) fs::rename(path, m_Old / name, error);  // no links here
    if (error) return error;
  }
  fs::rename(m_New / name, path, error);
  return error;
}

// Undoes replace(); a file that replace() did not place is not removed.
void HX_Output::putBack(const std::string& name, bool isPlaced) {
  std::error_code error;
  if (fs::exists(m_Old / name, error)) {
    fs::rename(m_Old / name, m_Folder / name, error);
    if (error) m_KeepsOld = true;
  } else if (isPlaced) {
    fs::remove(m_Folder / name, error);
  }
}

void HX_Output::commit() {
  stopAfterSignal();
  for (std::size_t i = 0; i < m_Changed.size(); ++i) {
    const std::error_code error = replace(m_Changed[i]);
    if (!error) continue;
    for (std::size_t k = 0; k <= i; ++k) putBack(m_Changed[k], k < i);
    fail(m_Folder / m_Changed[i], error,
         m_KeepsOld ? "; old files are in " + m_Old.string() : "");
  }
}
