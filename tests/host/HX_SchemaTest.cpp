// What the schema and its patterns mean.
#include "host/model/HX_Schema.h"

#include <gmock/gmock.h>

#include <functional>
#include <nlohmann/json.hpp>
#include <set>

namespace {

using Json = nlohmann::json;

// Calls visit with each schema inside a schema.
void forEachSchema(Json& schema, const std::function<void(Json&)>& visit) {
  visit(schema);
  for (const char* map : {"properties", "$defs"}) {
    if (!schema.contains(map)) continue;
    for (auto& [key, inner] : schema[map].items()) forEachSchema(inner, visit);
  }
  if (schema.contains("items")) forEachSchema(schema["items"], visit);
}

TEST(SchemaTest, EveryKeywordOfTheModelSchemaIsUnderstood) {
  std::set<std::string> keywords;
  Json whole = Json::parse(kHxModelSchema);
  forEachSchema(whole, [&](Json& schema) {
    for (const auto& [key, value] : schema.items()) keywords.insert(key);
  });
  EXPECT_THAT(keywords, testing::IsSupersetOf({"$ref", "allOf", "maxDepth"}));
  EXPECT_NO_THROW(HX_Schema(whole.dump().c_str()));
  // An unknown keyword is refused: none of those above is passed over.
  Json unknown = whole;
  unknown["$defs"]["name"]["minimun"] = 1;
  EXPECT_THROW(HX_Schema(unknown.dump().c_str()), std::logic_error);
  for (const std::string& keyword : keywords) {
    SCOPED_TRACE(keyword);
    Json changed = whole;
    forEachSchema(changed, [&](Json& schema) {
      if (!schema.contains(keyword)) return;
      schema[keyword + "?"] = schema[keyword];
      if (keyword != "$ref" && keyword != "$defs" && keyword != "type" &&
          keyword != "properties")
        schema.erase(keyword);
    });
    EXPECT_THROW(HX_Schema(changed.dump().c_str()), std::logic_error);
  }
}

struct ValueCase {
  const char* schema;  // of the field "x"
  const char* value;
  const char* expected;  // empty for a value that fits
};

const ValueCase kValues[] = {
    {R"({"enum": ["a", "b"]})", "a", ""},
    {R"({"enum": ["a", "b"]})", "c", R"(one of "a", "b")"},
    {R"({"type": "string", "minLength": 2})", "\xC3\xA4",
     "a text with a length from 2"},
    {R"({"type": "string", "maxLength": 1})", "\xC3\xA4", ""},
    {R"({"type": "string", "maxLength": 1})", "ab",
     "a text with a length up to 1"},
    {R"({"type": "string", "pattern": "a+"})", "aab", "a text of the form a+"},
};

TEST(SchemaTest, KeywordsLimitTexts) {
  for (const ValueCase& row : kValues) {
    SCOPED_TRACE(row.value);
    const HX_Schema schema(
        (std::string(R"({"properties": {"x": )") + row.schema + "}}").c_str());
    HX_JsonValue value;
    value.kind = HX_JsonValue::eText;
    value.text = row.value;
    int word = -1;
    EXPECT_EQ(row.expected, schema.root->fields[0].node->mismatch(value, word));
  }
}

struct PatternCase {
  const char* pattern;
  const char* text;
  bool fits;
};

const PatternCase kPatterns[] = {
    {"", "", true},
    {"", "a", false},
    {"a", "a", true},
    {"a", "aa", false},
    {"a+", "", false},
    {"a+b", "aab", true},
    {"a*b", "b", true},
    {"a*", "", true},
    {"a*a*b*", "aab", true},
    {"[a-c]+", "abc", true},
    {"[a-c]+", "abd", false},
    {"[a-]+", "-a", true},
    {".+x", "xx", true},
    {".+x", "x", false},
    {"a+a+a+a+a+", "aaaa", false},
};

TEST(SchemaTest, PatternsFitWholeTexts) {
  for (const PatternCase& row : kPatterns) {
    SCOPED_TRACE(std::string(row.pattern) + " on " + row.text);
    EXPECT_TRUE(HX_Pattern(row.pattern).isValid());
    EXPECT_EQ(row.fits, HX_Pattern(row.pattern).fits(row.text));
  }
  for (const char* invalid : {"[a", "a|b", "(a)", "a?", "\\d"}) {
    SCOPED_TRACE(invalid);
    EXPECT_FALSE(HX_Pattern(invalid).isValid());
  }
}

}  // namespace
