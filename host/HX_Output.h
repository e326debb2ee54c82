// Writes a set of files into a folder, all of them or none.
//
//   HX_Output output("out");
//   output.open("model.h") << declarations;
//   output.open("model.c") << definitions;
//   output.finish();   // both are safe under temporary names
//   output.commit();   // and now have their own

#ifndef HOST_HX_OUTPUT_H
#define HOST_HX_OUTPUT_H

#include <filesystem>
#include <fstream>
#include <map>
#include <stdexcept>
#include <string>
#include <vector>

/// Something that cannot be written; tells what and why in one line.
class HX_OutputError : public std::runtime_error {
 public:
  using std::runtime_error::runtime_error;
};

/// Every operation throws HX_OutputError. Destruction without commit(), or
/// after one that failed, leaves everything as it was: files that had been
/// replaced are back, and a folder that was made is gone.
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
  void makeFolders();

  const std::filesystem::path m_Folder;
  // In m_Folder, so that moving a file is renaming it.
  const std::filesystem::path m_Temporary;
  const std::filesystem::path m_New;
  const std::filesystem::path m_Old;
  std::vector<std::filesystem::path> m_MadeFolders;  // inner before outer
  std::map<std::string, std::ofstream> m_Files;
  std::vector<std::string> m_Changed;
  std::vector<std::string> m_Moved;  // by a commit() that did not end
};

#endif  // HOST_HX_OUTPUT_H
