// The text of a model document, and the places of faults in the text.
//
//   HX_Document document("cruise_control.json", folder);
//   document.faults.add(end, "7", "a text");
//   document.throwIfFaulty();
//   // cruise_control.json:12:15: /names/3/id: found 7, expected a text

#ifndef HOST_MODEL_HX_DOCUMENT_H
#define HOST_MODEL_HX_DOCUMENT_H

#include <filesystem>
#include <map>
#include <string>

#include "host/base/HX_Faults.h"

struct HX_Document {
  /// Reads the file. Throws HX_InputError if the file cannot be read.
  /// \param name  as the user wrote the name, counted from \p folder
  HX_Document(const std::string& name, const std::filesystem::path& folder);

  /// A document that was made, not read; \p name is for messages.
  static HX_Document ofText(const std::string& name, std::string text);

  /// Throws HX_DocumentError with a line for each fault, if there are faults:
  /// "FILE:LINE:COLUMN: POINTER: found FOUND, expected EXPECTED".
  void throwIfFaulty() const;

  /// "FILE:LINE:COLUMN: POINTER" of the token.
  std::string placeText(HX_TokenEnd end) const;

  /// Line and column of the token in front of \p end, and its JSON pointer
  /// (RFC 6901, "/" for the root), for tokens and for a fault of the syntax.
  struct Place {
    std::size_t begin = 0;
    std::string pointer = "/";
  };
  /// Reads the text once more for all places.
  std::map<std::size_t, Place> locate(const HX_Faults& list) const;
  std::string shown(const Place& place) const;

  std::string file;
  std::string text;
  HX_Faults faults;  // places are ends of tokens

 private:
  HX_Document() = default;
};

#endif  // HOST_MODEL_HX_DOCUMENT_H
