// Long command lines from files: "@file" stands for the words of the file.
//
//   HX_ExpandArguments(argc, argv);   // {"generate", "model.json", ...}

#ifndef HOST_BASE_HX_RESPONSEFILE_H
#define HOST_BASE_HX_RESPONSEFILE_H

#include <string>
#include <vector>

/// The words behind the name of the program. White space separates the words of
/// a file; quotation marks of both kinds keep white space, and a backslash
/// keeps the next character. A file may name further files. A word "@file"
/// without a file stays. Throws HX_InputError for files in a circle.
std::vector<std::string> HX_ExpandArguments(int argc, const char* const* argv);

#endif  // HOST_BASE_HX_RESPONSEFILE_H
