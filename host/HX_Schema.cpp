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

struct Type {
  const char* shown;
  bool (HX_Json::*holds)() const noexcept;
};

const std::map<std::string, Type> kTypes = {
    {"object", {"an object", &HX_Json::is_object}},
    {"array", {"a list", &HX_Json::is_array}},
    {"string", {"a text", &HX_Json::is_string}},
    {"boolean", {"true or false", &HX_Json::is_boolean}},
    {"number", {"a number", &HX_Json::is_number}},
    {"integer", {"a whole number", &HX_Json::is_number_integer}},
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

void checkType(Json value, Json names) {
  std::string expected;
  const auto holds = [&](Json name) {
    const Type& type = kTypes.at(name.get_ref<const std::string&>());
    if (!expected.empty()) expected += " or ";
    expected += type.shown;
    return (value.*type.holds)();
  };
  const bool isOne = names.is_array()
                         ? std::any_of(names.begin(), names.end(), holds)
                         : holds(names);
  if (!isOne) throw Misfit{value, expected};
}

bool hasForm(const std::string& text, const std::string& pattern) {
  static std::map<std::string, std::regex> s_Patterns;
  return std::regex_match(
      text, s_Patterns.try_emplace(pattern, pattern).first->second);
}

const HX_Json& schemaOfModels() {
  static const HX_Json s_Schema = HX_Json::parse(kHxModelSchema);
  return s_Schema;
}

void check(Json value, Json schema);

bool checkReference(Json value, Json target) {
  constexpr std::size_t kPrefix = sizeof("#/$defs/") - 1;
  const auto& text = target.get_ref<const std::string&>();
  check(value, schemaOfModels()["$defs"][text.substr(kPrefix)]);
  return true;
}

bool checkRequired(Json value, Json fields) {
  for (Json field : fields) {
    if (!value.contains(field)) throw Misfit{value, "a field " + field.dump()};
  }
  return true;
}

bool checkProperties(Json value, Json properties) {
  for (auto it = value.begin(); it != value.end(); ++it) {
    const auto property = properties.find(it.key());
    if (property != properties.end()) check(*it, *property);
  }
  return true;
}

void checkNoOtherFields(Json value, Json properties) {
  for (auto it = value.begin(); it != value.end(); ++it) {
    if (properties.contains(it.key())) continue;
    HX_Json keys;
    for (const auto& [key, property] : properties.items()) keys += key;
    throw Misfit{*it, "one of the fields " + shown(keys)};
  }
}

bool checkItems(Json value, Json item) {
  if (!value.is_array()) return true;  // but the other type that is possible
  for (Json element : value) check(element, item);
  return true;
}

bool checkConditions(Json value, Json rules) {
  for (Json rule : rules) {
    try {
      check(value, rule["if"]);
    } catch (const Misfit&) {
      continue;
    }
    check(value, rule["then"]);
  }
  return true;
}

/// Tests a value of the right type.
struct Keyword {
  bool (*holds)(Json value, Json argument);
  const char* expectation;  // before the argument; null: holds() throws itself
};

// Any other keyword is a comment.
const std::map<std::string, Keyword> kKeywords = {
    {"$ref", {checkReference, nullptr}},
    {"allOf", {checkConditions, nullptr}},
    {"items", {checkItems, nullptr}},
    {"properties", {checkProperties, nullptr}},
    {"required", {checkRequired, nullptr}},
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

void check(Json value, Json schema) {
  if (schema.contains("type")) checkType(value, schema["type"]);
  if (schema.contains("additionalProperties"))
    checkNoOtherFields(value, schema["properties"]);
  for (auto it = schema.begin(); it != schema.end(); ++it) {
    const auto keyword = kKeywords.find(it.key());
    if (keyword != kKeywords.end() && !keyword->second.holds(value, *it))
      throw Misfit{value, keyword->second.expectation + shown(*it)};
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
