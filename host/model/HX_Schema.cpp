#include "host/model/HX_Schema.h"

#include <rapidjson/document.h>

#include <algorithm>
#include <charconv>
#include <stdexcept>

#include "host/base/HX_CheckedAllocator.h"
#include "host/base/HX_Text.h"

namespace {

using Pool = rapidjson::MemoryPoolAllocator<HX_CheckedAllocator>;
using Document =
    rapidjson::GenericDocument<rapidjson::UTF8<>, Pool, HX_CheckedAllocator>;
using Json = Document::ValueType;

std::string_view textOf(const Json& value) {
  return {value.GetString(), value.GetStringLength()};
}

struct TypeRow {
  const char* word;
  unsigned type;
  const char* shown;
};

constexpr TypeRow kTypes[] = {
    {"object", HX_SchemaNode::eObject, "an object"},
    {"array", HX_SchemaNode::eList, "a list"},
    {"string", HX_SchemaNode::eText, "a text"},
    {"boolean", HX_SchemaNode::eBoolean, "true or false"},
    {"number", HX_SchemaNode::eNumber, "a number"},
    {"integer", HX_SchemaNode::eWhole, "a whole number"},
};

[[noreturn]] void refuse(const std::string& what) {
  throw std::logic_error("schema: " + what);
}

unsigned typeOf(const Json& word) {
  for (const TypeRow& row : kTypes) {
    if (textOf(word) == row.word) return row.type;
  }
  refuse("type " + std::string(textOf(word)));
}

std::uint64_t bitOf(int index) {
  if (index < 0) refuse("a rule names no field of the object or no word");
  return std::uint64_t{1} << index;
}

int indexIn(const std::vector<std::string>& words, std::string_view word) {
  const auto found = std::find(words.begin(), words.end(), word);
  return found == words.end() ? -1 : static_cast<int>(found - words.begin());
}

/// Turns the JSON of the schema into nodes.
class Compiler {
 public:
  Compiler(HX_Schema& schema, const Json& root) : m_Schema(schema) {
    if (root.HasMember("$defs")) m_Definitions = &root["$defs"];
    m_Schema.root = compile(root, "");
  }

 private:
  using Read = void (Compiler::*)(HX_SchemaNode&, const Json&);
  struct KeywordRow {
    const char* keyword;
    Read read;  // null for a comment
  };
  // In this order, since "required" and "allOf" speak of properties.
  static const KeywordRow kKeywords[];

  HX_SchemaNode* compile(const Json& json, const std::string& path) {
    if (json.HasMember("$ref")) {
      // A reference stands alone, or with a comment.
      const bool hasMore =
          json.MemberCount() > 2 ||
          (json.MemberCount() == 2 && !json.HasMember("description"));
      if (hasMore) refuse("keywords beside a reference");
      return definition(json["$ref"]);
    }
    HX_SchemaNode& node =
        *m_Schema.nodes.emplace_back(std::make_unique<HX_SchemaNode>());
    fill(node, json, path);
    return &node;
  }

  // Definitions may contain themselves: entered before they are complete.
  HX_SchemaNode* definition(const Json& reference) {
    constexpr std::string_view kPrefix = "#/$defs/";
    const std::string name(textOf(reference).substr(kPrefix.size()));
    if (m_Definitions == nullptr || !m_Definitions->HasMember(name.c_str()))
      refuse("reference " + name);
    HX_SchemaNode*& node = m_Defined[name];
    if (node != nullptr) return node;
    node = m_Schema.nodes.emplace_back(std::make_unique<HX_SchemaNode>()).get();
    HX_SchemaNode* const made = node;
    fill(*made, (*m_Definitions)[name.c_str()], name);
    return made;
  }

  void fill(HX_SchemaNode& node, const Json& json, const std::string& path);

  void readNothing(HX_SchemaNode&, const Json&) {}
  void readType(HX_SchemaNode& node, const Json& value) {
    if (value.IsString()) node.types = typeOf(value);
    if (!value.IsArray()) return;
    for (const Json& word : value.GetArray()) node.types |= typeOf(word);
  }
  void readWords(HX_SchemaNode& node, const Json& value) {
    node.types |= HX_SchemaNode::eText;
    for (const Json& word : value.GetArray())
      node.words.emplace_back(textOf(word));
    if (node.words.size() > HX_SchemaNode::kMostFields) refuse("enum");
  }
  void readProperties(HX_SchemaNode& node, const Json& value) {
    for (const auto& [key, json] : value.GetObject()) {
      HX_SchemaField field;
      field.key = textOf(key);
      field.path = node.path.empty() ? field.key : node.path + '.' + field.key;
      field.node = compile(json, field.path);
      node.fields.push_back(field);
    }
    std::sort(node.fields.begin(), node.fields.end(),
              [](const HX_SchemaField& a, const HX_SchemaField& b) {
                return a.key < b.key;
              });
    if (node.fields.size() > HX_SchemaNode::kMostFields) refuse("properties");
  }
  std::uint64_t fieldBits(const HX_SchemaNode& node, const Json& keys) {
    std::uint64_t bits = 0;
    for (const Json& key : keys.GetArray())
      bits |= bitOf(node.findField(textOf(key), 0));
    return bits;
  }
  void readRequired(HX_SchemaNode& node, const Json& value) {
    node.required = fieldBits(node, value);
  }
  void readClosed(HX_SchemaNode& node, const Json& value) {
    node.isClosed = value.IsFalse();
  }
  void readItems(HX_SchemaNode& node, const Json& value) {
    node.items = compile(value, node.path);
  }
  // {"if": {"properties": {FIELD: {"enum": [...]}}}, "then": {"required": []}};
  // a condition without its field never holds.
  void readRules(HX_SchemaNode& node, const Json& value) {
    for (const Json& json : value.GetArray()) {
      const auto& condition = *json["if"]["properties"].MemberBegin();
      node.ruleField = node.findField(textOf(condition.name), 0);
      const std::vector<std::string>& words =
          node.fields.at(static_cast<std::size_t>(node.ruleField)).node->words;
      HX_SchemaRule& rule = node.rules.emplace_back();
      for (const Json& word : condition.value["enum"].GetArray())
        rule.words |= bitOf(indexIn(words, textOf(word)));
      rule.required = fieldBits(node, json["then"]["required"]);
    }
  }
  template <auto member>
  void readCount(HX_SchemaNode& node, const Json& value) {
    node.*member = value.GetUint();
  }
  template <auto member>
  void readBound(HX_SchemaNode& node, const Json& value) {
    node.*member = value.GetDouble();
  }
  template <auto member>
  void readLimit(HX_SchemaNode&, const Json& value) {
    m_Schema.*member = value.GetUint();
  }
  void readPattern(HX_SchemaNode& node, const Json& value) {
    node.patternText = textOf(value);
    node.pattern.emplace(node.patternText);
    if (!node.pattern->isValid()) refuse("pattern " + node.patternText);
  }

  HX_Schema& m_Schema;
  const Json* m_Definitions = nullptr;
  std::map<std::string, HX_SchemaNode*> m_Defined;
};

const Compiler::KeywordRow Compiler::kKeywords[] = {
    {"$schema", nullptr},
    {"$comment", nullptr},
    {"$defs", nullptr},
    {"title", nullptr},
    {"description", nullptr},
    {"type", &Compiler::readType},
    {"enum", &Compiler::readWords},
    {"properties", &Compiler::readProperties},
    {"required", &Compiler::readRequired},
    {"additionalProperties", &Compiler::readClosed},
    {"allOf", &Compiler::readRules},
    {"items", &Compiler::readItems},
    {"minItems", &Compiler::readCount<&HX_SchemaNode::minItems>},
    {"maxItems", &Compiler::readCount<&HX_SchemaNode::maxItems>},
    {"minLength", &Compiler::readCount<&HX_SchemaNode::minLength>},
    {"maxLength", &Compiler::readCount<&HX_SchemaNode::maxLength>},
    {"pattern", &Compiler::readPattern},
    {"minimum", &Compiler::readBound<&HX_SchemaNode::minimum>},
    {"maximum", &Compiler::readBound<&HX_SchemaNode::maximum>},
    {"exclusiveMinimum",
     &Compiler::readBound<&HX_SchemaNode::exclusiveMinimum>},
    {"maxDepth", &Compiler::readLimit<&HX_Schema::maxDepth>},
    {"maxElements", &Compiler::readLimit<&HX_Schema::maxElements>},
    {"maxChain", &Compiler::readLimit<&HX_Schema::maxChain>},
};

void Compiler::fill(HX_SchemaNode& node, const Json& json,
                    const std::string& path) {
  node.path = path;
  rapidjson::SizeType known = 0;
  for (const KeywordRow& row : kKeywords) {
    const auto found = json.FindMember(row.keyword);
    if (found == json.MemberEnd()) continue;
    ++known;
    if (row.read != nullptr) (this->*row.read)(node, found->value);
  }
  if (known == json.MemberCount()) return;
  for (const auto& [key, value] : json.GetObject()) {
    const auto isKey = [&, name = textOf(key)](const KeywordRow& row) {
      return name == row.keyword;
    };
    if (std::none_of(std::begin(kKeywords), std::end(kKeywords), isKey))
      refuse("keyword " + std::string(textOf(key)));
  }
}

std::string shown(double number) {
  char text[32];
  return {text, std::to_chars(text, text + sizeof text, number).ptr};
}

std::size_t charactersIn(std::string_view utf8) {
  return static_cast<std::size_t>(std::count_if(
      utf8.begin(), utf8.end(), [](char c) { return (c & '\xC0') != '\x80'; }));
}

}  // namespace

HX_Schema::HX_Schema(const char* text) {
  Document json;
  if (json.Parse(text).HasParseError()) refuse("JSON");
  Compiler(*this, json);
}

int HX_SchemaNode::findField(std::string_view key, int guess) const {
  if (static_cast<std::size_t>(guess) < fields.size() &&
      fields[static_cast<std::size_t>(guess)].key == key)
    return guess;
  const auto found = std::lower_bound(
      fields.begin(), fields.end(), key,
      [](const HX_SchemaField& field, std::string_view wanted) {
        return field.key < wanted;
      });
  if (found == fields.end() || found->key != key) return -1;
  return static_cast<int>(found - fields.begin());
}

std::string HX_SchemaNode::expectedTypes() const {
  std::string text;
  for (const TypeRow& row : kTypes) {
    if ((types & row.type) == 0) continue;
    text += (text.empty() ? "" : " or ") + std::string(row.shown);
  }
  return text;
}

std::string HX_SchemaNode::mismatch(const HX_JsonValue& value,
                                    int& word) const {
  if (value.kind == HX_JsonValue::eText) {
    if (!words.empty()) {
      word = indexIn(words, value.text);
      if (word >= 0) return {};
      std::string list;
      for (const std::string& each : words)
        list += (list.empty() ? "" : ", ") + HX_Quoted(each);
      return "one of " + list;
    }
    const std::size_t length = charactersIn(value.text);
    if (length < minLength)
      return "a text with a length from " + std::to_string(minLength);
    if (length > maxLength)
      return "a text with a length up to " + std::to_string(maxLength);
    if (pattern && !pattern->fits(value.text))
      return "a text of the form " + patternText;
    if (value.text.find('\0') != value.text.npos)
      return "a text without the character 0";
    return {};
  }
  if (value.kind != HX_JsonValue::eWhole &&
      value.kind != HX_JsonValue::eFraction)
    return {};
  if (minimum && value.number < *minimum)
    return "a number from " + shown(*minimum);
  if (maximum && value.number > *maximum)
    return "a number up to " + shown(*maximum);
  if (exclusiveMinimum && value.number <= *exclusiveMinimum)
    return "a number above " + shown(*exclusiveMinimum);
  return {};
}
