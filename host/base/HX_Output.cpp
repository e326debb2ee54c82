#include "host/base/HX_Output.h"

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <set>
#include <string_view>
#include <system_error>

namespace fs = std::filesystem;

namespace {

constexpr std::string_view kTemporary = ".hx_codegen-";

void stopAfterSignal() {
  if (HX_DelayedSignals::isEndRequested()) throw HX_OutputError("interrupted");
}

// Unique in the machine, and in the process: several outputs may share a
// folder.
std::string temporaryName() {
  static int s_Number = 0;
  return std::string(kTemporary) + HX_ProcessNumber() + "-" +
         std::to_string(++s_Number);
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
  constexpr std::streamsize kPart = 65536;
  std::error_code error;
  if (fs::file_size(a, error) != fs::file_size(b, error) || error) return false;
  std::ifstream first(a, std::ios::binary);
  std::ifstream second(b, std::ios::binary);
  std::vector<char> parts(2 * kPart);
  char* const other = parts.data() + kPart;
  while (first.read(parts.data(), kPart), first.gcount() > 0) {
    second.read(other, kPart);
    if (second.gcount() != first.gcount() ||
        std::memcmp(parts.data(), other,
                    static_cast<std::size_t>(first.gcount())) != 0)
      return false;
  }
  return true;
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
  fs::create_directories(m_Folder, error);
  if (!error) takeLock();
  if (!error) fs::create_directories(m_New, error);
  if (!error) fs::create_directory(m_Old, error);
  if (error) fail(m_Folder, error);
  m_HasFolders = true;
}

// The temporary folder of the other process tells its number.
void HX_Output::takeLock() {
  if (m_Lock.take(m_Folder)) return;
  std::string holder = "another process";
  std::error_code error;
  for (const auto& entry : fs::directory_iterator(m_Folder, error)) {
    const std::string name = entry.path().filename().string();
    if (!name.starts_with(kTemporary)) continue;
    const std::string number = name.substr(kTemporary.size());
    holder = "process " + number.substr(0, number.find('-'));
  }
  throw HX_OutputError(m_Folder.string() + ": cannot be written: " + holder +
                       " writes into the folder");
}

fs::path HX_Output::place() {
  if (!m_HasFolders) makeFolders();
  return fs::absolute(m_New);
}

std::ostream& HX_Output::open(const std::string& name) {
  stopAfterSignal();
  if (!m_HasFolders) makeFolders();
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
  if (!m_HasFolders) return 0;
  std::set<std::string> names;
  for (const auto& entry : fs::directory_iterator(m_New))
    names.insert(entry.path().filename().string());
  for (const std::string& name : names) {
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

void HX_Output::undo() {
  for (const std::string& name : m_Changed) putBack(name, true);
  m_Changed.clear();
}
