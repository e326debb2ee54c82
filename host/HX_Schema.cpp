#include "host/HX_Schema.h"

#include <algorithm>
#include <map>
#include <regex>

#include "host/HX_Document.h"

namespace {

using Json = const HX_Json&;

/// A value, and what it should have been.
struct Misfit {
  Json value;
  std::string expected;
};

struct TypeRow {
  const char* name;  // in the schema
  const char* shown;
  bool (HX_Json::*holds)() const noexcept;
};

constexpr TypeRow kTypes[] = {
    {"object", "an object", &HX_Json::is_object},
    {"array", "a list", &HX_Json::is_array},
    {"string", "a text", &HX_Json::is_string},
    {"boolean", "true or false", &HX_Json::is_boolean},
    {"number", "a number", &HX_Json::is_number},
    {"integer", "a whole number", &HX_Json::is_number_integer},
};

bool contains(Json list, Json value) {
  return std::find(list.begin(), list.end(), value) != list.end();
}

// A list, number or pattern of the schema.
std::string shown(Json argument) {
  if (argument.is_string()) return argument;
  std::string text;
  for (Json item : argument) text += (text.empty() ? "" : ", ") + item.dump();
  return text;
}

// "object", or a list of such names.
void checkType(Json value, Json type) {
  std::string expected;
  for (const TypeRow& row : kTypes) {
    if (type != row.name && !contains(type, row.name)) continue;
    if ((value.*row.holds)()) return;
    expected += (expected.empty() ? "" : " or ") + std::string(row.shown);
  }
  throw Misfit{value, expected};
}

bool hasForm(const std::string& text, const std::string& pattern) {
  static std::map<std::string, std::regex> s_Patterns;
  return std::regex_match(
      text, s_Patterns.try_emplace(pattern, pattern).first->second);
}

/// A value of the right type holds if it bears comparison with the argument.
struct Test {
  bool (*holds)(Json value, Json argument);
  const char* expectation;  // before the argument
};

const std::map<std::string, Test> kTests = {
    {"enum", {[](Json v, Json a) { return contains(a, v); }, "one of "}},
    {"pattern",
     {[](Json v, Json a) { return hasForm(v, a); }, "a text of the form "}},
    {"minLength",
     {[](Json v, Json a) {
        return v.get_ref<const std::string&>().size() >= a;
      },
      "a text with a length from "}},
    {"minItems",
     {[](Json v, Json a) { return v.size() >= a; },
      "a list with a length from "}},
    {"minimum", {[](Json v, Json a) { return v >= a; }, "a number from "}},
    {"maximum", {[](Json v, Json a) { return v <= a; }, "a number up to "}},
    {"exclusiveMinimum",
     {[](Json v, Json a) { return v > a; }, "a number above "}},
};

const HX_Json& schemaOfModels() {
  static const HX_Json s_Schema = HX_Json::parse(kHxModelSchema);
  return s_Schema;
}

void check(Json value, Json schema);

void checkReference(Json value, Json target) {
  constexpr std::size_t kPrefix = sizeof("#/$defs/") - 1;
  const auto& text = target.get_ref<const std::string&>();
  check(value, schemaOfModels()["$defs"][text.substr(kPrefix)]);
}

void checkRequired(Json value, Json fields) {
  for (Json field : fields) {
    if (!value.contains(field)) throw Misfit{value, "a field " + field.dump()};
  }
}

void checkProperties(Json value, Json properties) {
  for (auto it = value.begin(); it != value.end(); ++it) {
    const auto property = properties.find(it.key());
    if (property != properties.end()) check(*it, *property);
  }
}

void checkNoOtherFields(Json value, Json properties) {
  for (auto it = value.begin(); it != value.end(); ++it) {
    if (properties.contains(it.key())) continue;
    HX_Json keys;
    for (const auto& [key, property] : properties.items()) keys += key;
    throw Misfit{*it, "one of the fields " + shown(keys)};
  }
}

void checkItems(Json value, Json item) {
  if (!value.is_array()) return;  // but the other type that is possible
  for (Json element : value) check(element, item);
}

void checkConditions(Json value, Json rules) {
  for (Json rule : rules) {
    try {
      check(value, rule["if"]);
    } catch (const Misfit&) {
      continue;
    }
    check(value, rule["then"]);
  }
}

// Keywords that lead on to other parts of the value or the schema.
const std::map<std::string, void (*)(Json value, Json argument)> kRules = {
    {"$ref", checkReference},    {"allOf", checkConditions},
    {"items", checkItems},       {"properties", checkProperties},
    {"required", checkRequired},
};

// A keyword without a row is a comment.
void check(Json value, Json schema) {
  if (schema.contains("type")) checkType(value, schema["type"]);
  if (schema.contains("additionalProperties"))
    checkNoOtherFields(value, schema["properties"]);
  for (auto it = schema.begin(); it != schema.end(); ++it) {
    const auto test = kTests.find(it.key());
    if (test != kTests.end() && !test->second.holds(value, *it))
      throw Misfit{value, test->second.expectation + shown(*it)};
    const auto rule = kRules.find(it.key());
    if (rule != kRules.end()) rule->second(value, *it);
  }
}

}  // namespace

void HX_CheckSchema(const HX_Document& document) {
  try {
    check(document.root, schemaOfModels());
  } catch (const Misfit& misfit) {
    document.fail(misfit.value, misfit.expected);
  }
}
