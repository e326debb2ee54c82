// The lock file of a run: names that stay.
//
//   HX_LockFile file("names.lock", false);
//   generator.run(progress, file.lock());
//   file.endRun(0);
//   HX_Output output(file.folder());
//   file.write(output);

#ifndef HOST_PROGRAM_HX_LOCKFILE_H
#define HOST_PROGRAM_HX_LOCKFILE_H

#include <filesystem>
#include <string>

#include "SafeNames/HX_NameLock.h"
#include "host/base/HX_Output.h"
#include "host/write/HX_DiagnosticLog.h"

class HX_LockFile {
 public:
  /// No file for an empty \p file: lock() is null, all else does nothing.
  /// Throws HX_DocumentError for a damaged file, and for a missing file if
  /// \p mustExist.
  /// \param file  path that errors show
  /// \param path  path to open
  HX_LockFile(std::string file, std::filesystem::path path, bool mustExist);

  HX_NameLock* lock() { return m_File.empty() ? nullptr : &m_Lock; }

  /// Where the file lies.
  std::filesystem::path folder() const { return m_Path.parent_path(); }

  /// Adds a message for each new and each changed name.
  /// RETURNS: the number of such names.
  int addChanges(HX_DiagnosticLog& log) const;

  /// Writes the file into \p output; REQUIRES: lock() is not null.
  void write(HX_FileSink& output) const;

 private:
  std::string m_File;
  std::filesystem::path m_Path;
  HX_NameLock m_Lock;
};

/// The content of \p path. Throws HX_DocumentError, with \p file as name.
std::string HX_ReadWholeFile(const std::string& file,
                             const std::filesystem::path& path);

/// Throws HX_DocumentError with a line for every fault.
void HX_ReadLock(HX_NameLock& lock, const std::string& file,
                 const std::string& text);

#endif  // HOST_PROGRAM_HX_LOCKFILE_H
