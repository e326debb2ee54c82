#include "host/HX_Schema.h"

#include <algorithm>
#include <map>
#include <regex>

#include "host/HX_Document.h"

using nlohmann::json;

namespace {

struct TypeRow {
  const char* name;  // in the schema
  const char* shown;
  bool (*holds)(const json& value);
};

constexpr TypeRow kTypes[] = {
    {"object", "an object", [](const json& v) { return v.is_object(); }},
    {"array", "a list", [](const json& v) { return v.is_array(); }},
    {"string", "a text", [](const json& v) { return v.is_string(); }},
    {"boolean", "true or false", [](const json& v) { return v.is_boolean(); }},
    {"number", "a number", [](const json& v) { return v.is_number(); }},
    {"integer", "a whole number",
     [](const json& v) { return v.is_number_integer(); }},
};

std::string listed(const json& items) {
  std::string text;
  for (const json& item : items)
    text += (text.empty() ? "" : ", ") + item.dump();
  return text;
}

class Checker {
 public:
  explicit Checker(const json& schema) : m_Schema(schema) {}

  void check(const HX_DocumentNode& node, const json& schema) {
    if (schema.contains("additionalProperties"))
      checkNoOtherFields(node, schema["properties"]);
    for (auto it = schema.begin(); it != schema.end(); ++it) {
      for (const KeywordRow& row : s_Keywords) {
        if (it.key() == row.keyword) row.check(*this, node, it.value());
      }
    }
  }

 private:
  /// One row per keyword; a value of another type satisfies it. A keyword
  /// without a row is a comment.
  struct KeywordRow {
    const char* keyword;
    void (*check)(Checker&, const HX_DocumentNode&, const json& argument);
  };
  static const KeywordRow s_Keywords[13];

  static void checkType(Checker&, const HX_DocumentNode& node,
                        const json& type) {
    std::string expected;
    for (const TypeRow& row : kTypes) {
      const bool isNamed =
          type == row.name || (type.is_array() && contains(type, row.name));
      if (!isNamed) continue;
      if (row.holds(node.value())) return;
      expected += (expected.empty() ? "" : " or ") + std::string(row.shown);
    }
    node.fail(expected);
  }

  static void checkEnum(Checker&, const HX_DocumentNode& node,
                        const json& choices) {
    if (!contains(choices, node.value()))
      node.fail("one of " + listed(choices));
  }

  static void checkPattern(Checker& self, const HX_DocumentNode& node,
                           const json& pattern) {
    if (!node.value().is_string()) return;
    const std::string& form = pattern.get_ref<const std::string&>();
    const auto regex = self.m_Patterns.try_emplace(form, form).first;
    if (!std::regex_match(node.value().get_ref<const std::string&>(),
                          regex->second))
      node.fail("a text of the form " + form);
  }

  static void checkRequired(Checker&, const HX_DocumentNode& node,
                            const json& fields) {
    if (!node.value().is_object()) return;
    for (const json& field : fields) {
      if (!node.value().contains(field)) node.fail("a field " + field.dump());
    }
  }

  static void checkNoOtherFields(const HX_DocumentNode& node,
                                 const json& properties) {
    if (!node.value().is_object()) return;
    for (const auto& [key, value] : node.value().items()) {
      if (!properties.contains(key))
        node.at(key.c_str()).fail("one of the fields " + keysOf(properties));
    }
  }

  static std::string keysOf(const json& object) {
    json keys = json::array();
    for (const auto& [key, value] : object.items()) keys.push_back(key);
    return listed(keys);
  }

  static void checkProperties(Checker& self, const HX_DocumentNode& node,
                              const json& properties) {
    if (!node.value().is_object()) return;
    for (const auto& [key, value] : node.value().items()) {
      const auto property = properties.find(key);
      if (property != properties.end())
        self.check(node.at(key.c_str()), *property);
    }
  }

  static void checkItems(Checker& self, const HX_DocumentNode& node,
                         const json& item) {
    if (!node.value().is_array()) return;
    for (std::size_t i = 0; i < node.value().size(); ++i)
      self.check(node.at(i), item);
  }

  static void checkConditions(Checker& self, const HX_DocumentNode& node,
                              const json& rules) {
    for (const json& rule : rules) {
      if (self.holds(node, rule["if"])) self.check(node, rule["then"]);
    }
  }

  static void checkReference(Checker& self, const HX_DocumentNode& node,
                             const json& reference) {
    const json*& target = self.m_Targets[&reference];
    if (target == nullptr) {
      const std::string text = reference;  // "#/$defs/..."
      target = &self.m_Schema.at(json::json_pointer(text.substr(1)));
    }
    self.check(node, *target);
  }

  bool holds(const HX_DocumentNode& node, const json& schema) {
    try {
      check(node, schema);
      return true;
    } catch (const HX_DocumentError&) {
      return false;
    }
  }

  static bool contains(const json& list, const json& value) {
    return std::find(list.begin(), list.end(), value) != list.end();
  }

  const json& m_Schema;
  std::map<std::string, std::regex> m_Patterns;
  std::map<const json*, const json*> m_Targets;  // $ref -> what it names
};

const Checker::KeywordRow Checker::s_Keywords[13] = {
    {"$ref", checkReference},
    {"allOf", checkConditions},
    {"enum", checkEnum},
    {"items", checkItems},
    {"pattern", checkPattern},
    {"properties", checkProperties},
    {"required", checkRequired},
    {"type", checkType},
    {"minLength",
     [](Checker&, const HX_DocumentNode& node, const json& limit) {
       if (node.value().is_string() &&
           node.value().get_ref<const std::string&>().size() < limit)
         node.fail("a text that is not empty");
     }},
    {"minItems",
     [](Checker&, const HX_DocumentNode& node, const json& limit) {
       if (node.value().is_array() && node.value().size() < limit)
         node.fail("a list that is not empty");
     }},
    {"minimum",
     [](Checker&, const HX_DocumentNode& node, const json& limit) {
       if (node.value().is_number() && node.value() < limit)
         node.fail("a number from " + limit.dump());
     }},
    {"maximum",
     [](Checker&, const HX_DocumentNode& node, const json& limit) {
       if (node.value().is_number() && node.value() > limit)
         node.fail("a number up to " + limit.dump());
     }},
    {"exclusiveMinimum",
     [](Checker&, const HX_DocumentNode& node, const json& limit) {
       if (node.value().is_number() && node.value() <= limit)
         node.fail("a number above " + limit.dump());
     }},
};

}  // namespace

void HX_CheckSchema(const HX_DocumentNode& root) {
  static const json schema = json::parse(kHxModelSchema);
  Checker(schema).check(root, schema);
}
