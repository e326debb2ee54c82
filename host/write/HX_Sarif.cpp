// Static Analysis Results Interchange Format, version 2.1.0 (OASIS, 2020).
#include <algorithm>
#include <ostream>

#include "host/base/HX_JsonWriter.h"
#include "host/write/HX_DiagnosticLog.h"

namespace {

using Entry = HX_DiagnosticLog::Entry;

std::string ruleId(int number) { return "HX" + std::to_string(number); }

const char* levelOf(int severity) {
  constexpr const char* kLevels[] = {"note", "warning", "error", "error"};
  return kLevels[severity % 4];
}

// RFC 3986: bytes other than unreserved characters and '/' as "%XX".
std::string uriOf(const std::string& path) {
  constexpr char kDigits[] = "0123456789ABCDEF";
  constexpr std::string_view kPlain =
      "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789-._~/";
  std::string uri = path.starts_with('/') ? "file://" : "";
  for (const char c : path) {
    const auto byte = static_cast<unsigned char>(c);
    if (kPlain.find(c) != kPlain.npos)
      uri += c;
    else
      uri += {'%', kDigits[byte >> 4], kDigits[byte & 0xF]};
  }
  return uri;
}

void writeText(HX_JsonWriter& json, const char* key, const std::string& text) {
  json.key(key);
  json.open('{');
  json.field("text", text);
  json.close('}');
}

void writeRule(HX_JsonWriter& json, int number) {
  const HX_MessageFacts facts = HX_FactsOf(number);
  json.next();
  json.open('{');
  json.field("id", ruleId(number));
  if (!facts.cause.empty()) {
    writeText(json, "shortDescription", facts.text);
    writeText(json, "fullDescription", facts.cause);
    writeText(json, "help", facts.cure);
    json.key("defaultConfiguration");
    json.open('{');
    json.field("level", levelOf(facts.severity));
    json.close('}');
  }
  json.close('}');
}

void writePhysical(HX_JsonWriter& json, const HX_Diagnostic& diagnostic,
                   const std::string& file) {
  json.key("physicalLocation");
  json.open('{');
  json.key("artifactLocation");
  json.open('{');
  json.field("uri", uriOf(file));
  json.close('}');
  if (diagnostic.line > 0) {
    json.key("region");
    json.open('{');
    json.rawField("startLine", std::to_string(diagnostic.line));
    if (diagnostic.column > 0)
      json.rawField("startColumn", std::to_string(diagnostic.column));
    json.close('}');
  }
  json.close('}');
}

void writeLogical(HX_JsonWriter& json, const HX_Diagnostic& diagnostic) {
  if (diagnostic.source.empty() && diagnostic.item.empty()) return;
  json.key("logicalLocations");
  json.open('[');
  json.next();
  json.open('{');
  if (!diagnostic.item.empty()) json.field("name", diagnostic.item);
  if (!diagnostic.source.empty())
    json.field("fullyQualifiedName", diagnostic.source);
  json.close('}');
  json.close(']');
}

void writeLocations(HX_JsonWriter& json, const HX_Diagnostic& diagnostic,
                    const std::string& model) {
  const std::string& file = diagnostic.file.empty() ? model : diagnostic.file;
  json.key("locations");
  json.open('[');
  if (!file.empty() || !diagnostic.source.empty() || !diagnostic.item.empty()) {
    json.next();
    json.open('{');
    if (!file.empty()) writePhysical(json, diagnostic, file);
    writeLogical(json, diagnostic);
    json.close('}');
  }
  json.close(']');
}

void writeResult(HX_JsonWriter& json, const Entry& entry,
                 const std::vector<int>& rules, const std::string& model) {
  const auto rule =
      std::lower_bound(rules.begin(), rules.end(), entry.first.number);
  json.next();
  json.open('{');
  json.field("ruleId", ruleId(entry.first.number));
  json.rawField("ruleIndex", std::to_string(rule - rules.begin()));
  json.field("level", levelOf(entry.first.severity));
  writeText(json, "message", entry.first.text);
  writeLocations(json, entry.first, model);
  json.rawField("occurrenceCount", std::to_string(1 + entry.further));
  json.close('}');
}

void writeTool(HX_JsonWriter& json, const std::vector<int>& rules) {
  json.key("tool");
  json.open('{');
  json.key("driver");
  json.open('{');
  json.field("name", "hx_codegen");
  json.field("version", HX_PROGRAM_VERSION);
  json.key("rules");
  json.open('[');
  for (const int number : rules) writeRule(json, number);
  json.close(']');
  json.close('}');
  json.close('}');
}

}  // namespace

void HX_WriteSarif(std::ostream& out, const std::vector<Entry>& entries,
                   const std::string& model, int exitCode) {
  std::vector<int> rules;
  for (const Entry& entry : entries) rules.push_back(entry.first.number);
  std::sort(rules.begin(), rules.end());
  rules.erase(std::unique(rules.begin(), rules.end()), rules.end());

  HX_JsonWriter json(out, 2);
  json.open('{');
  json.field("$schema", "https://json.schemastore.org/sarif-2.1.0.json");
  json.field("version", "2.1.0");
  json.key("runs");
  json.open('[');
  json.next();
  json.open('{');
  writeTool(json, rules);
  json.key("invocations");
  json.open('[');
  json.next();
  json.open('{');
  json.rawField("exitCode", std::to_string(exitCode));
  json.rawField("executionSuccessful", exitCode == 2 ? "false" : "true");
  json.close('}');
  json.close(']');
  json.field("columnKind", "unicodeCodePoints");
  json.key("results");
  json.open('[');
  for (const Entry& entry : entries) writeResult(json, entry, rules, model);
  json.close(']');
  json.close('}');
  json.close(']');
  json.close('}');
  json.end();
}
