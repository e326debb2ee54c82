// Writes a set of files into a folder, all of them or none.
//
//   HX_Output output("out");
//   output.open("model.h") << declarations;
//   output.open("model.c") << definitions;
//   output.finish();   // both are safe under temporary names
//   output.commit();   // and now have their own

#ifndef HOST_BASE_HX_OUTPUT_H
#define HOST_BASE_HX_OUTPUT_H

#include <csignal>
#include <filesystem>
#include <fstream>
#include <map>
#include <stdexcept>
#include <string>
#include <system_error>
#include <vector>

/// Something that cannot be written; tells what and why in one line.
class HX_OutputError : public std::runtime_error {
 public:
  using std::runtime_error::runtime_error;
};

/// Every operation throws HX_OutputError. Destruction without commit(), or
/// after one that failed, leaves everything as it was: files that had been
/// replaced are back, and a folder that was made is gone. Old files that could
/// not be put back stay where the error tells.
///
/// SIGHUP, SIGINT and SIGTERM end the program after that, or after commit().
class HX_Output {
 public:
  explicit HX_Output(const std::filesystem::path& folder);
  HX_Output(const HX_Output&) = delete;
  HX_Output& operator=(const HX_Output&) = delete;
  ~HX_Output();

  /// A new file, open until finish(). The first makes the folder.
  std::ostream& open(const std::string& name);

  /// Ends writing. Files that are already in the folder as they would be
  /// written are not going to be touched.
  /// \return the number of the others
  std::size_t finish();

  /// Puts the files in their places.
  void commit();

 private:
  /// Holds back the signals that end a program: while it lives they interrupt
  /// what waits and are noted, afterwards they act.
  class HeldSignals {
   public:
    HeldSignals();
    HeldSignals(const HeldSignals&) = delete;
    HeldSignals& operator=(const HeldSignals&) = delete;
    ~HeldSignals();

   private:
    std::map<int, struct sigaction> m_Before;
  };

  void makeFolders();
  std::error_code replace(const std::string& name);
  void putBack(const std::string& name, bool isPlaced);

  const HeldSignals m_Signals;  // act when everything else is gone
  const std::filesystem::path m_Folder;
  // In m_Folder, so that moving a file is renaming it.
  const std::filesystem::path m_Temporary;
  const std::filesystem::path m_New;
  const std::filesystem::path m_Old;
  std::vector<std::filesystem::path> m_MadeFolders;  // inner before outer
  std::map<std::string, std::ofstream> m_Files;
  std::vector<std::string> m_Changed;
  bool m_KeepsOld = false;  // m_Old has the only copy of something
};

#endif  // HOST_BASE_HX_OUTPUT_H
