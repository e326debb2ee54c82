// Compares the files of a run with the files of a folder, and writes nothing.
//
//   HX_ComparingOutput output("out");
//   output.open("model.h") << declarations;
//   output.changed();   // {"model.h"} if out/model.h is absent or differs

#ifndef HOST_BASE_HX_COMPARINGOUTPUT_H
#define HOST_BASE_HX_COMPARINGOUTPUT_H

#include <filesystem>
#include <map>
#include <memory>
#include <string>
#include <vector>

#include "host/base/HX_FileSink.h"

/// COST: reads each old file once, piece by piece, as the new text comes.
class HX_ComparingOutput : public HX_FileSink {
 public:
  explicit HX_ComparingOutput(const std::filesystem::path& folder);
  HX_ComparingOutput(const HX_ComparingOutput&) = delete;
  HX_ComparingOutput& operator=(const HX_ComparingOutput&) = delete;
  ~HX_ComparingOutput() override;

  std::ostream& open(const std::string& name) override;

  /// The names of all files, ascending.
  std::vector<std::string> names() const;
  /// The names of files that a run would write, ascending.
  /// REQUIRES: all text was written.
  std::vector<std::string> changed();

 private:
  struct File;

  const std::filesystem::path m_Folder;
  std::map<std::string, std::unique_ptr<File>> m_Files;
};

#endif  // HOST_BASE_HX_COMPARINGOUTPUT_H
