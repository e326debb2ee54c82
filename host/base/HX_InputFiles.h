// The files that a run has read, for dependency files.

#ifndef HOST_BASE_HX_INPUTFILES_H
#define HOST_BASE_HX_INPUTFILES_H

#include <set>
#include <string>

/// The files of this process, as the user or a file names them.
inline std::set<std::string>& HX_InputFiles() {
  static std::set<std::string> s_Files;
  return s_Files;
}

#endif  // HOST_BASE_HX_INPUTFILES_H
