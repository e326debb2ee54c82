#include "host/program/HX_LockFile.h"

#include <fstream>
#include <iterator>
#include <ostream>
#include <utility>

#include "host/base/HX_Faults.h"
#include "host/base/HX_Text.h"

std::string HX_ReadWholeFile(const std::string& file,
                             const std::filesystem::path& path) {
  std::ifstream in(path, std::ios::binary);
  // A folder opens, but cannot be read.
  if (!in || in.peek() == std::ifstream::traits_type::eof()) {
    std::error_code error;
    if (!in || !std::filesystem::is_regular_file(path, error))
      throw HX_InputError(HX_Visible(file) + ": cannot be read");
  }
  return {std::istreambuf_iterator<char>(in), {}};
}

void HX_ReadLock(HX_NameLock& lock, const std::string& file,
                 const std::string& text) {
  HX_TextFaults faults;
  if (lock.read(text.data(), text.size(), faults)) return;
  std::vector<HX_Diagnostic> list;
  for (int i = 0; i < faults.kept(); ++i)
    list.push_back({kHxBadLock, 2, faults[i].text.cstring(), "", "", file,
                    faults[i].line});
  if (faults.count() > faults.kept())
    list.push_back(
        {kHxMoreFaults, 2,
         "... and " + std::to_string(faults.count() - faults.kept()) + " more",
         "", "", file});
  throw HX_DocumentError(list);
}

HX_LockFile::HX_LockFile(std::string file, std::filesystem::path path,
                         bool mustExist)
    : m_File(std::move(file)), m_Path(std::move(path)) {
  if (m_File.empty()) return;
  if (mustExist || std::filesystem::exists(m_Path))
    HX_ReadLock(m_Lock, m_File, HX_ReadWholeFile(m_File, m_Path));
}

int HX_LockFile::addChanges(HX_DiagnosticLog& log) const {
  int changes = 0;
  for (int at = 0; at < m_Lock.size(); ++at) {
    const HX_NameLock::HxEChangeTag change = m_Lock.change(at);
    if (change != HX_NameLock::eAdded && change != HX_NameLock::eRenamed)
      continue;
    const HX_NameLock::Entry& entry = m_Lock.entry(at);
    const char* what = change == HX_NameLock::eRenamed ? "renamed to" : "new,";
    log.add({kHxNotInLock, 2, HX_MessageText(kHxNotInLock, {what, entry.name}),
             std::string(entry.item), ""});
    ++changes;
  }
  return changes;
}

void HX_LockFile::write(HX_FileSink& output) const {
  std::ostream& out = output.open(m_Path.filename().string());
  const bool isWritten =
      m_Lock.write([&out](const char* text, std::size_t length) {
        out.write(text, static_cast<std::streamsize>(length));
      });
  if (!isWritten) throw HX_OutputError(m_File + ": no memory");
}
