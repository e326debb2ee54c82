#include "host/model/HX_Schema.h"

#include <algorithm>
#include <map>
#include <regex>

#include "host/model/HX_Document.h"

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

/// What a value of the right type has to fulfil.
struct Condition {
  bool (*holds)(Json value, Json argument);
  const char* expectation;  // before the argument
};

const std::map<std::string, Condition> kConditions = {
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

void check(Json value, Json schema);

bool fits(Json value, Json schema) {
  try {
    check(value, schema);
    return true;
  } catch (const Misfit&) {
    return false;
  }
}

void checkObject(Json object, Json schema) {
  Json properties = HX_FieldOrEmpty(schema, "properties");
  for (auto it = object.begin(); it != object.end(); ++it) {
    const auto property = properties.find(it.key());
    if (property != properties.end()) {
      check(*it, *property);
    } else if (schema.contains("additionalProperties")) {
      HX_Json keys;
      for (const auto& [key, other] : properties.items()) keys += key;
      throw Misfit{*it, "one of the fields " + shown(keys)};
    }
  }
  for (Json field : HX_FieldOrEmpty(schema, "required")) {
    if (!object.contains(field))
      throw Misfit{object, "a field " + field.dump()};
  }
  for (Json rule : HX_FieldOrEmpty(schema, "allOf")) {
    if (fits(object, rule["if"])) check(object, rule["then"]);
  }
}

// A keyword that is not looked for is a comment.
void check(Json value, Json schema) {
  const auto reference = schema.find("$ref");
  if (reference != schema.end()) {
    constexpr std::size_t kPrefix = sizeof("#/$defs/") - 1;
    const auto& text = reference->get_ref<const std::string&>();
    return check(value, schemaOfModels()["$defs"][text.substr(kPrefix)]);
  }
  if (schema.contains("type")) checkType(value, schema["type"]);
  for (auto it = schema.begin(); it != schema.end(); ++it) {
    const auto condition = kConditions.find(it.key());
    if (condition != kConditions.end() && !condition->second.holds(value, *it))
      throw Misfit{value, condition->second.expectation + shown(*it)};
  }
  if (value.is_object()) checkObject(value, schema);
  if (!value.is_array()) return;
  for (Json element : value) check(element, HX_FieldOrEmpty(schema, "items"));
}

}  // namespace

void HX_CheckSchema(const HX_Document& document) {
  try {
    check(document.root, schemaOfModels());
  } catch (const Misfit& misfit) {
    document.fail(misfit.value, misfit.expected);
  }
}
