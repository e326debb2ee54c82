// A model document: JSON in the form that host/model.schema.json describes.
//
//   HX_Document document("cruise_control.json", folder);
//   for (const HX_Json& name : HX_FieldOrEmpty(document.root, "names"))
//     if (isTaken(name["id"])) document.fail(name["id"], "another id");
//
// What a schema cannot tell (ids that repeat or lead nowhere) is up to the
// reader.

#ifndef HOST_MODEL_HX_DOCUMENT_H
#define HOST_MODEL_HX_DOCUMENT_H

#include <filesystem>
#include <nlohmann/json.hpp>
#include <stdexcept>
#include <string>

using HX_Json = nlohmann::json;

/// What is wrong with a document: one line with file, place and expectation.
class HX_DocumentError : public std::runtime_error {
 public:
  using std::runtime_error::runtime_error;
};

struct HX_Document {
  /// Throws HX_DocumentError for a file that cannot be read, is no JSON, or
  /// does not have the form of the schema.
  /// \param file  as the user wrote it, counted from \p folder
  HX_Document(const std::string& file, const std::filesystem::path& folder);

  /// Throws the error "<file>: <place>: expected <expectation>"; the place is
  /// the JSON pointer (RFC 6901) of \p value, which lies in the document.
  [[noreturn]] void fail(const HX_Json& value,
                         const std::string& expectation) const;

  std::string file;
  HX_Json root;
};

/// A field of an object; an empty object if it is missing.
const HX_Json& HX_FieldOrEmpty(const HX_Json& node, const char* field);

#endif  // HOST_MODEL_HX_DOCUMENT_H
