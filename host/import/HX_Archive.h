// A zip archive of unknown origin, opened for reading.
//
//   HX_Archive archive("rc_update.slx", limits);
//   if (archive.has("simulink/blockdiagram.xml"))
//     std::string text = archive.read("simulink/blockdiagram.xml");

#ifndef HOST_IMPORT_HX_ARCHIVE_H
#define HOST_IMPORT_HX_ARCHIVE_H

#include <cstdint>
#include <filesystem>
#include <map>
#include <memory>
#include <string>
#include <string_view>

#include "host/import/HX_ImportError.h"

struct zip;

/// Every operation throws HX_ImportError. Nothing is ever unpacked to a disk.
class HX_Archive {
 public:
  /// Reads the table of contents and refuses an archive beyond \p limits, with
  /// an encrypted part, with two parts of the same name, or with a name that
  /// leads outside ("..", an absolute path, a backslash).
  HX_Archive(const std::filesystem::path& file, const HX_ImportLimits& limits);

  bool has(std::string_view part) const;

  /// RETURNS: the unpacked bytes. Refuses a part that is missing, damaged, or
  /// longer or shorter than the table of contents says.
  std::string read(std::string_view part) const;

  /// The error "FILE: PART: reason".
  [[noreturn]] void fail(std::string_view part,
                         const std::string& reason) const;

  const std::string& file() const { return m_File; }

 private:
  struct Entry {
    std::uint64_t index;
    std::uint64_t size;
  };
  struct Closer {
    void operator()(zip* archive) const;
  };

  void enter(std::uint64_t index, const HX_ImportLimits& limits);

  std::string m_File;
  std::unique_ptr<zip, Closer> m_Zip;
  std::map<std::string, Entry, std::less<>> m_Entries;
  std::uint64_t m_TotalSize = 0;
};

#endif  // HOST_IMPORT_HX_ARCHIVE_H
