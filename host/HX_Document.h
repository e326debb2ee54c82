// A model document and the places in it.
//
//   const HX_Document document("cruise_control.json");
//   document.root().forEach("names", [](const HX_DocumentNode& name) {
//     if (name.text("id") == "x") name.at("id").fail("another id");
//   });
//
// A document that was read has the form that host/model.schema.json describes;
// what a schema cannot tell (ids that repeat or lead nowhere) is up to the
// reader of the nodes.

#ifndef HOST_HX_DOCUMENT_H
#define HOST_HX_DOCUMENT_H

#include <cstddef>
#include <filesystem>
#include <nlohmann/json.hpp>
#include <stdexcept>
#include <string>

/// What is wrong with a document: one line with file, place and expectation.
class HX_DocumentError : public std::runtime_error {
 public:
  using std::runtime_error::runtime_error;
};

/// One value of a document that knows its place. Light, made on the spot; the
/// node it was reached from must outlive it.
class HX_DocumentNode {
 public:
  HX_DocumentNode(const nlohmann::json& value, const std::string& file)
      : m_Value(value), m_File(file) {}

  const nlohmann::json& value() const { return m_Value; }
  /// JSON pointer (RFC 6901) from the root; "/" for the root itself.
  std::string pointer() const;

  bool has(const char* field) const { return m_Value.contains(field); }
  /// A field or an element that is there.
  HX_DocumentNode at(const char* field) const {
    return HX_DocumentNode(m_Value[field], *this, field, 0);
  }
  HX_DocumentNode at(std::size_t index) const {
    return HX_DocumentNode(m_Value[index], *this, nullptr, index);
  }

  // A field that the schema gives this type, or the fallback if it is missing.
  std::string text(const char* field, const char* fallback = "") const;
  double number(const char* field, double fallback) const;
  int integer(const char* field, int fallback) const;
  bool flag(const char* field, bool fallback) const;

  /// Visits the elements of a list; a list that is missing has none.
  template <class Visit>
  void forEach(const char* field, Visit visit) const {
    if (!has(field)) return;
    const HX_DocumentNode list = at(field);
    for (std::size_t i = 0; i < list.m_Value.size(); ++i) visit(list.at(i));
  }

  /// Throws the error "<file>: <pointer>: expected <expectation>".
  [[noreturn]] void fail(const std::string& expectation) const;

 private:
  HX_DocumentNode(const nlohmann::json& value, const HX_DocumentNode& parent,
                  const char* key, std::size_t index)
      : m_Value(value),
        m_File(parent.m_File),
        m_Parent(&parent),
        m_Key(key),
        m_Index(index) {}

  const nlohmann::json& m_Value;
  const std::string& m_File;
  const HX_DocumentNode* m_Parent = nullptr;
  const char* m_Key = nullptr;  // null for an element of a list
  std::size_t m_Index = 0;
};

class HX_Document {
 public:
  /// Throws HX_DocumentError for a file that cannot be read, is no JSON, or
  /// does not have the form of the schema.
  /// \param file  as the user wrote it, counted from \p folder
  explicit HX_Document(const std::string& file,
                       const std::filesystem::path& folder = {});

  HX_DocumentNode root() const { return HX_DocumentNode(m_Json, m_File); }

 private:
  std::string m_File;
  nlohmann::json m_Json;
};

#endif  // HOST_HX_DOCUMENT_H
