// One complaint or remark, with the places that a machine can use.

#ifndef HOST_MESSAGES_HX_DIAGNOSTIC_H
#define HOST_MESSAGES_HX_DIAGNOSTIC_H

#include <string>

/// Texts are UTF-8. Empty texts and zeros: not known.
struct HX_Diagnostic {
  int number = 0;    ///< of the program, or the id of a library's message
  int severity = 2;  ///< see HX_Finding
  std::string text;
  std::string item;    ///< id of a name of the document
  std::string source;  ///< path in the model, or JSON pointer
  std::string file = {};
  int line = 0;    ///< from 1
  int column = 0;  ///< characters, from 1

  bool isError() const { return severity % 4 >= 2; }
};

/// RETURNS: "FILE:LINE:COLUMN: POINTER: " as far as known, for a diagnostic
/// about a text file; empty without a file.
inline std::string HX_PlaceOf(const HX_Diagnostic& diagnostic) {
  std::string place = diagnostic.file;
  if (place.empty()) return place;
  if (diagnostic.line > 0) place += ':' + std::to_string(diagnostic.line);
  if (diagnostic.column > 0) place += ':' + std::to_string(diagnostic.column);
  place += ": ";
  if (!diagnostic.source.empty()) place += diagnostic.source + ": ";
  return place;
}

#endif  // HOST_MESSAGES_HX_DIAGNOSTIC_H
