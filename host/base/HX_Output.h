// Writes a set of files into a folder: all files or none.
//
//   HX_Output output("out");
//   output.open("model.h") << declarations;
//   output.open("model.c") << definitions;
//   output.finish();   // both files are complete under temporary names
//   output.commit();   // both files have their own names

#ifndef HOST_BASE_HX_OUTPUT_H
#define HOST_BASE_HX_OUTPUT_H

#include <filesystem>
#include <fstream>
#include <map>
#include <stdexcept>
#include <string>
#include <system_error>
#include <vector>

#include "host/base/HX_FileSink.h"
#include "host/base/HX_System.h"

/// A failed write: one line with the file and the reason.
class HX_OutputError : public std::runtime_error {
 public:
  using std::runtime_error::runtime_error;
};

/// Every operation throws HX_OutputError. Destruction without commit(), or
/// after a failed commit(), leaves everything as before: replaced files are
/// back, and new folders are gone. Old files that cannot be put back stay in
/// the folder that the error names.
///
/// One process at a time writes into a folder; the error of a second process
/// names the first.
///
/// SIGHUP, SIGINT and SIGTERM end the program after the destruction.
class HX_Output : public HX_FileSink {
 public:
  explicit HX_Output(const std::filesystem::path& folder);
  HX_Output(const HX_Output&) = delete;
  HX_Output& operator=(const HX_Output&) = delete;
  ~HX_Output() override;

  /// A new file, open until finish(). The first file makes the folder.
  std::ostream& open(const std::string& name) override;

  /// Ends writing. A file that the folder already has with the same content
  /// stays untouched.
  /// \return the number of files that commit() replaces or adds
  std::size_t finish();

  /// Puts the files in their places.
  void commit();
  /// Takes a commit back.
  void undo();

  /// The folder of the new files until finish(), for writers that open files on
  /// their own.
  std::filesystem::path place();

 private:
  void makeFolders();
  void takeLock();
  std::error_code replace(const std::string& name);
  void putBack(const std::string& name, bool isPlaced);

  const HX_DelayedSignals m_Signals;  // first member, so destroyed last
  const std::filesystem::path m_Folder;
  // Inside m_Folder: moving a file is renaming the file.
  const std::filesystem::path m_Temporary;
  const std::filesystem::path m_New;
  const std::filesystem::path m_Old;
  std::vector<std::filesystem::path> m_MadeFolders;  // inner before outer
  HX_FolderLock m_Lock;
  bool m_HasFolders = false;
  std::map<std::string, std::ofstream> m_Files;
  std::vector<std::string> m_Changed;
  bool m_KeepsOld = false;  // m_Old has the only copy of a file
};

#endif  // HOST_BASE_HX_OUTPUT_H
