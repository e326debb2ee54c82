#include "host/write/HX_NameMap.h"

#include <nlohmann/json.hpp>
#include <ostream>

#include "host/base/HX_Text.h"
#include "platform/messages/HX_MessageHandler.h"

using nlohmann::ordered_json;

namespace {

ordered_json asJson(const std::vector<HX_Finding>& findings) {
  ordered_json messages = ordered_json::array();
  for (const HX_Finding& finding : findings)
    messages.push_back(
        {{"id", finding.id},
         {"severity", HX_MessageHandler::severityName(finding.severity)},
         {"text", finding.text},
         {"source", finding.source}});
  return messages;
}

ordered_json asJson(const std::vector<HX_Change>& changes) {
  ordered_json texts = ordered_json::array();
  for (const HX_Change& change : changes) texts.push_back(change.text());
  return texts;
}

// Line feeds inside a text are escaped: every line feed ends a line.
std::string indented(const std::string& json, const std::string& indent) {
  std::string text;
  for (const char c : json) {
    text += c;
    if (c == '\n') text += indent;
  }
  return text;
}

// Writes field by field: building the object first takes half as long again.
void writeJson(std::ostream& out, const HX_FormedName& name) {
  ordered_json sources = ordered_json::array();
  name.wanted->sources.forEach(
      [&](const HxCSrcRef* srcRef) { sources.push_back(HX_PathOf(srcRef)); });
  const std::pair<const char*, ordered_json> fields[] = {
      {"id", name.wanted->id},
      {"source", name.sourcePath()},
      {"sources", sources},
      {"template", HX_ToUtf8(name.wanted->nameTemplate)},
      {"formal", HX_ToUtf8(name.formal)},
      {"actual", HX_ToUtf8(name.actual)},
      {"complete", name.isComplete},
      {"defined", name.isDefined},
      {"changes", asJson(name.changes)},
      {"messages", asJson(name.findings)}};
  const char* separator = "    {\n      \"";
  for (const auto& [key, value] : fields) {
    out << separator << key << "\": " << indented(value.dump(2), "      ");
    separator = ",\n      \"";
  }
  out << "\n    }";
}

// Doubled quotes inside quotes, where the text needs them.
std::string csvField(const std::string& text) {
  if (text.find_first_of(",\"\r\n") == std::string::npos) return text;
  std::string quoted = "\"";
  for (const char c : text) quoted += c == '"' ? "\"\"" : std::string(1, c);
  return quoted + '"';
}

}  // namespace

void HX_WriteJson(std::ostream& out, const HX_RunResult& result) {
  out << "{\n  \"names\": [";
  const char* separator = "\n";
  for (const HX_FormedName* name : result.names) {
    out << separator;
    writeJson(out, *name);
    separator = ",\n";
  }
  ordered_json types = ordered_json::array();
  for (const HX_TypeItem* type : result.types) types.push_back(type->name);
  ordered_json variables = ordered_json::array();
  for (const HX_FormedName* name : result.variables)
    variables.push_back(HX_ToUtf8(name->actual));
  const ordered_json rest{{"types", types},
                          {"variables", variables},
                          {"messages", asJson(result.findings)}};
  out << (result.names.empty() ? "]," : "\n  ],") << rest.dump(2).substr(1)
      << '\n';  // without the opening brace
}

void HX_WriteCsv(std::ostream& out, const HX_RunResult& result) {
  out << "id,template,formal,actual,changes,source\r\n";
  for (const HX_FormedName* name : result.names)
    out << csvField(name->wanted->id) << ','
        << csvField(HX_ToUtf8(name->wanted->nameTemplate)) << ','
        << csvField(HX_ToUtf8(name->formal)) << ','
        << csvField(HX_ToUtf8(name->actual)) << ','
        << csvField(HX_JoinedChanges(*name, "; ")) << ','
        << csvField(name->sourcePath()) << "\r\n";
}
