// The form of model documents, as nodes that a reader walks through.
//
// Understands the part of JSON Schema that model.schema.json uses, see
// kHxSchemaKeywords; any other keyword is a fault of the schema. Keywords of
// our own: "maxDepth" at the root limits the nesting of lists and objects,
// "maxElements" of a type the elements of nested arrays and structures,
// "maxChain" of a type the types that stand on each other.

#ifndef HOST_MODEL_HX_SCHEMA_H
#define HOST_MODEL_HX_SCHEMA_H

#include <cstddef>
#include <cstdint>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "host/base/HX_JsonReader.h"
#include "host/model/HX_Pattern.h"

/// The text of host/model.schema.json, which the build puts into the program.
extern const char kHxModelSchema[];

struct HX_SchemaNode;

/// The binding of a place of the schema to the reader of models; see
/// host/model/HX_ModelReading.h.
struct HX_FieldBinding;

struct HX_SchemaField {
  std::string key;
  HX_SchemaNode* node = nullptr;
  std::string path;  // for example "name.symbol.kind"
  const HX_FieldBinding* binding = nullptr;
};

/// If the field `kind` has one of the words, further fields are required.
struct HX_SchemaRule {
  std::uint64_t words = 0;     // bits by index in the enum of the field
  std::uint64_t required = 0;  // bits by index of field
};

struct HX_SchemaNode {
  enum HxETypeTag : unsigned {
    eObject = 1,
    eList = 2,
    eText = 4,
    eBoolean = 8,
    eNumber = 16,
    eWhole = 32
  };
  static constexpr int kMostFields = 64;

  unsigned types = 0;  // 0 for any
  std::string path;    // the definition, or the fields that lead here
  const HX_FieldBinding* binding = nullptr;

  std::vector<HX_SchemaField> fields;  // sorted by key
  std::uint64_t required = 0;          // bits by index of field
  bool isClosed = false;               // no other fields
  int ruleField = -1;                  // the field of the conditions of rules
  std::vector<HX_SchemaRule> rules;

  HX_SchemaNode* items = nullptr;
  std::size_t minItems = 0;
  std::size_t maxItems = SIZE_MAX;

  std::vector<std::string> words;  // enum
  std::size_t minLength = 0;       // characters
  std::size_t maxLength = SIZE_MAX;
  std::string patternText;
  std::optional<HX_Pattern> pattern;
  std::optional<double> minimum;
  std::optional<double> maximum;
  std::optional<double> exclusiveMinimum;

  /// Index of the field; -1 for none. \p guess is looked at first.
  int findField(std::string_view key, int guess) const;
  /// The expectation of the types: "a text", "a number or a list".
  std::string expectedTypes() const;
  /// RETURNS: the violated expectation of a value with the right type, empty if
  /// there is none. \param[out] word  index in `words`, if there are words
  std::string mismatch(const HX_JsonValue& value, int& word) const;
};

class HX_Schema {
 public:
  /// Throws std::logic_error with the unknown or misused keyword.
  explicit HX_Schema(const char* text);

  HX_SchemaNode* root = nullptr;
  std::size_t maxDepth = 0;
  std::size_t maxElements = 0;
  std::size_t maxChain = 0;
  /// Every node, for binding.
  std::vector<std::unique_ptr<HX_SchemaNode>> nodes;
};

#endif  // HOST_MODEL_HX_SCHEMA_H
