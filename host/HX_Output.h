// Writes a set of files into a folder, all of them or none.
//
//   HX_Output output("out");
//   output.add("model.c", text);
//   output.commit();

#ifndef HOST_HX_OUTPUT_H
#define HOST_HX_OUTPUT_H

#include <filesystem>
#include <map>
#include <stdexcept>
#include <string>
#include <vector>

/// A file or folder that cannot be written; tells which one.
class HX_OutputError : public std::runtime_error {
 public:
  using std::runtime_error::runtime_error;
};

/// Destruction without commit() leaves the folder as it was.
class HX_Output {
 public:
  explicit HX_Output(const std::filesystem::path& folder) : m_Folder(folder) {}
  HX_Output(const HX_Output&) = delete;
  HX_Output& operator=(const HX_Output&) = delete;
  ~HX_Output();

  void add(const std::string& name, const std::string& text) {
    m_Files[name] = text;
  }

  /// Writes the files that differ from those in the folder under temporary
  /// names and, once all are written, gives them their own. Files that would
  /// not change keep their time stamps. The folder is made if it is missing.
  /// Throws HX_OutputError.
  /// \return the names of the files that were written
  std::vector<std::string> commit();

 private:
  std::filesystem::path m_Folder;
  std::map<std::string, std::string> m_Files;
  std::vector<std::filesystem::path> m_Temporary;  // written, not yet renamed
};

#endif  // HOST_HX_OUTPUT_H
