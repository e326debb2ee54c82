// Failures and limits of the import of model files.

#ifndef HOST_IMPORT_HX_IMPORTERROR_H
#define HOST_IMPORT_HX_IMPORTERROR_H

#include <cstdint>
#include <stdexcept>
#include <string>

/// Unreadable model file, dictionary or rules file. The text is a single line:
/// "FILE: PART:LINE:COLUMN: reason"; PART and the place where known.
class HX_ImportError : public std::runtime_error {
 public:
  using std::runtime_error::runtime_error;
};

/// Bounds for files of unknown origin. A file beyond a bound is refused.
struct HX_ImportLimits {
  std::uint64_t parts = 20'000;           ///< parts of an archive
  std::uint64_t partSize = 256U << 20;    ///< bytes of an unpacked part
  std::uint64_t totalSize = 1024U << 20;  ///< bytes of all unpacked parts
  /// Unpacked bytes per packed byte; counts for parts above ratioFrom bytes,
  /// because a small part of blanks is harmless.
  std::uint64_t ratio = 200;
  std::uint64_t ratioFrom = 1U << 20;
  /// Systems in systems and states in states together: a document admits 98.
  int depth = 90;
  std::size_t blocks = 2'000'000;  ///< blocks of the tree, references expanded
};

#endif  // HOST_IMPORT_HX_IMPORTERROR_H
