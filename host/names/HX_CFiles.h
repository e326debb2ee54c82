// The names of the C files of a model, and the macros that the files define.
//
//   const HX_CFiles files = HX_CFiles::ofModel();
//   // files.code == "cruise_control", guard "CRUISE_CONTROL_H"

#ifndef HOST_NAMES_HX_CFILES_H
#define HOST_NAMES_HX_CFILES_H

#include <string>
#include <vector>

struct HX_CFiles {
  /// The files of the model that lives.
  static HX_CFiles ofModel();

  /// The include guard of the header \p file, given without extension. Never
  /// begins with '_', because the compiler owns macros with '_' in front.
  static std::string guardOf(const std::string& file);

  /// Macros that place a variable: section, alignment.
  static constexpr const char* kSection = "HX_SECTION";
  static constexpr const char* kAligned = "HX_ALIGNED";

  /// All macros that the files define; no name may be equal.
  std::vector<std::string> macros() const;

  std::string types;  // without extension, as below
  std::string code;   // header and source
};

#endif  // HOST_NAMES_HX_CFILES_H
