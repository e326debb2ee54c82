#include "host/import/HX_Rules.h"

#include <rapidjson/document.h>
#include <rapidjson/error/en.h>
#include <rapidjson/schema.h>
#include <rapidjson/stringbuffer.h>
#include <rapidjson/writer.h>

#include <algorithm>
#include <fstream>
#include <sstream>

#include "host/import/HX_ImportError.h"
#include "host/import/HX_PartText.h"

namespace {

using Json = rapidjson::Value;

// In the order of HX_Rule::Kind.
constexpr std::string_view kKinds[] = {
    "input",      "output",        "signal",     "state",
    "parameter",  "function",      "chartState", "chartData",
    "chartEvent", "chartFunction", "task",       "type"};
static_assert(std::size(kKinds) == HX_Rule::eKinds);

std::string textOf(const Json& value) {
  return {value.GetString(), value.GetStringLength()};
}

std::string asJson(const Json& value) {
  rapidjson::StringBuffer buffer;
  rapidjson::Writer<rapidjson::StringBuffer> writer(buffer);
  value.Accept(writer);
  return buffer.GetString();
}

rapidjson::Document parse(const std::string& file, const std::string& text) {
  rapidjson::Document document;
  document.Parse<rapidjson::kParseValidateEncodingFlag>(text.c_str(),
                                                        text.size());
  if (document.HasParseError())
    throw HX_ImportError(file + ":" +
                         HX_PlaceOf(text, document.GetErrorOffset()) +
                         ": expected well-formed JSON: " +
                         rapidjson::GetParseError_En(document.GetParseError()));
  return document;
}

// "/rules/3/for: expected enum [...]": the violated keyword of the schema,
// with the argument.
void check(const std::string& file, const rapidjson::Document& document) {
  rapidjson::Document schema;
  schema.Parse(HX_Rules::schemaText());
  const rapidjson::SchemaDocument compiled(schema);
  rapidjson::SchemaValidator validator(compiled);
  if (document.Accept(validator)) return;
  rapidjson::StringBuffer place;
  validator.GetInvalidDocumentPointer().Stringify(place);
  const std::string keyword = validator.GetInvalidSchemaKeyword();
  const Json* rule = validator.GetInvalidSchemaPointer().Get(schema);
  std::string argument;
  if (rule != nullptr && rule->IsObject() && rule->HasMember(keyword.c_str()))
    argument = asJson((*rule)[keyword.c_str()]);
  if (keyword == "additionalProperties" && rule != nullptr) {
    argument.clear();
    for (const auto& member : (*rule)["properties"].GetObject())
      argument += (argument.empty() ? "one of the fields " : ", ") +
                  textOf(member.name);
  }
  throw HX_ImportError(
      file + ": " + (place.GetSize() == 0 ? "/" : place.GetString()) +
      ": expected " + (keyword == "additionalProperties" ? "" : keyword + " ") +
      argument);
}

void readText(const Json& node, const char* field, std::string& text) {
  if (node.HasMember(field)) text = textOf(node[field]);
}

void readTexts(const Json& node, const char* field,
               std::vector<std::string>& texts) {
  if (!node.HasMember(field)) return;
  for (const Json& text : node[field].GetArray()) texts.push_back(textOf(text));
}

void readFlag(const Json& node, const char* field, std::optional<bool>& flag) {
  if (node.HasMember(field)) flag = node[field].GetBool();
}

HX_Rule ruleOf(const Json& node) {
  HX_Rule rule;
  readText(node, "name", rule.name);
  const auto* const kind =
      std::find(std::begin(kKinds), std::end(kKinds), textOf(node["for"]));
  rule.kind = static_cast<HX_Rule::Kind>(kind - std::begin(kKinds));
  readTexts(node, "blockTypes", rule.blockTypes);
  readText(node, "path", rule.path);
  readTexts(node, "parameters", rule.parameters);
  readTexts(node, "dataScopes", rule.dataScopes);
  readFlag(node, "labelled", rule.labelled);
  readFlag(node, "several", rule.several);
  readFlag(node, "variable", rule.variable);
  rule.hasTemplate = node.HasMember("template");
  readText(node, "template", rule.nameTemplate);
  readText(node, "type", rule.type);
  rule.inFunction =
      node.HasMember("scope") && textOf(node["scope"]) == "function";
  return rule;
}

bool holds(const std::vector<std::string>& list, std::string_view text) {
  return list.empty() ||
         std::find(list.begin(), list.end(), text) != list.end();
}

bool fits(const HX_Rule& rule, const HX_RuleItem& item) {
  return rule.labelled.value_or(item.labelled) == item.labelled &&
         rule.several.value_or(item.several) == item.several &&
         rule.variable.value_or(item.variable) == item.variable &&
         holds(rule.blockTypes, item.blockType) &&
         holds(rule.parameters, item.parameter) &&
         holds(rule.dataScopes, item.dataScope) &&
         (rule.path.empty() || HX_MatchesPath(rule.path, item.path));
}

}  // namespace

HX_Rules::HX_Rules() { read("built-in rules", defaultText()); }

HX_Rules::HX_Rules(const std::filesystem::path& file) {
  std::ifstream stream(file, std::ios::binary);
  std::error_code ignored;
  if (!stream.is_open() || std::filesystem::is_directory(file, ignored))
    throw HX_ImportError(file.string() + ": expected a file that can be read");
  std::ostringstream text;
  text << stream.rdbuf();
  read(file.string(), text.str());
}

void HX_Rules::read(const std::string& file, const std::string& text) {
  const rapidjson::Document document = parse(file, text);
  check(file, document);
  readText(document, "systemId", systemId);
  readTexts(document, "keywords", keywords);
  if (document.HasMember("limitNames"))
    limitNames = document["limitNames"].GetBool();
  for (const Json& node : document["rules"].GetArray()) {
    const HX_Rule rule = ruleOf(node);
    m_Parameters.insert(rule.parameters.begin(), rule.parameters.end());
    m_ByKind[rule.kind].push_back(rule);
  }
}

const HX_Rule* HX_Rules::find(const HX_RuleItem& item) const {
  for (const HX_Rule& rule : m_ByKind[item.kind]) {
    if (fits(rule, item)) return rule.hasTemplate ? &rule : nullptr;
  }
  return nullptr;
}

std::string HX_Rules::typeName(std::string_view text,
                               const std::string& name) const {
  const HX_Rule* rule = find({HX_Rule::eType, {}, text});
  if (rule == nullptr) return name;
  std::string result = rule->nameTemplate;
  for (std::size_t at = result.find("$X"); at != std::string::npos;
       at = result.find("$X", at + name.size()))
    result.replace(at, 2, name);
  return result;
}

// Backtracks to the last "**", and to the last '*' behind "**", only.
bool HX_MatchesPath(std::string_view pattern, std::string_view path) {
  struct Star {
    std::size_t pattern = std::string_view::npos;  // behind the star
    std::size_t path = 0;  // where the rest of the pattern was tried
  };
  Star star;
  Star doubleStar;
  std::size_t p = 0;
  std::size_t t = 0;
  for (;;) {
    if (pattern.substr(p, 2) == "**") {
      p += 2;
      doubleStar = {p, t};
      star = {};
    } else if (p < pattern.size() && pattern[p] == '*') {
      star = {++p, t};
    } else if (p < pattern.size() && t < path.size() && pattern[p] == path[t]) {
      ++p;
      ++t;
    } else if (p == pattern.size() && t == path.size()) {
      return true;
    } else if (star.pattern != std::string_view::npos &&
               star.path < path.size() && path[star.path] != '/') {
      t = ++star.path;
      p = star.pattern;
    } else if (doubleStar.pattern != std::string_view::npos &&
               doubleStar.path < path.size()) {
      t = ++doubleStar.path;
      p = doubleStar.pattern;
      star = {};
    } else {
      return false;
    }
  }
}
