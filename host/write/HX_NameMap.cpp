#include "host/write/HX_NameMap.h"

#include <ostream>
#include <string>

#include "host/base/HX_JsonWriter.h"
#include "host/base/HX_Text.h"
#include "platform/messages/HX_MessageHandler.h"

namespace {

void writeFindings(HX_JsonWriter& json,
                   const std::vector<HX_Finding>& findings) {
  json.key("messages");
  json.open('[');
  for (const HX_Finding& finding : findings) {
    json.next();
    json.open('{');
    json.rawField("id", std::to_string(finding.id));
    json.field("severity", HX_MessageHandler::severityName(finding.severity));
    json.field("text", finding.text);
    json.field("source", finding.source);
    json.close('}');
  }
  json.close(']');
}

void writeName(HX_JsonWriter& json, const HX_FormedName& name,
               const std::string& path) {
  json.next();
  json.open('{');
  json.field("id", name.wanted->id);
  const HxCSrcRef* best = HX_BestSource(*name.wanted);
  json.field("source", path);
  json.key("sources");
  json.open('[');
  name.wanted->sources().forEach([&](const HxCSrcRef* source) {
    json.element(source == best ? path : HX_PathOf(source));
  });
  json.close(']');
  json.field("template", *name.wanted->nameTemplate->shown);
  json.field("formal", HX_ToUtf8(name.formal()));
  json.field("actual", HX_ToUtf8(name.actual));
  json.rawField("complete", name.isComplete ? "true" : "false");
  json.rawField("defined", name.isDefined ? "true" : "false");
  json.key("changes");
  json.open('[');
  for (const HX_Change& change : name.changes) json.element(change.text());
  json.close(']');
  writeFindings(json, name.findings);
  json.close('}');
}

// Doubled quotes inside quotes, where the text needs quotes.
void appendCsv(std::string& line, const std::string& text, char behind) {
  if (text.find_first_of(",\"\r\n") == std::string::npos) {
    line += text;
  } else {
    line += '"';
    for (const char c : text) {
      if (c == '"') line += c;
      line += c;
    }
    line += '"';
  }
  line += behind;
}

void writeCsvLine(std::string& out, const HX_FormedName& name,
                  const std::string& path) {
  appendCsv(out, name.wanted->id, ',');
  appendCsv(out, *name.wanted->nameTemplate->shown, ',');
  appendCsv(out, HX_ToUtf8(name.formal()), ',');
  appendCsv(out, HX_ToUtf8(name.actual), ',');
  appendCsv(out, HX_JoinedChanges(name, "; "), ',');
  appendCsv(out, path, '\r');
  out += '\n';
}

void beginJson(HX_JsonWriter& json) {
  json.open('{');
  json.key("names");
  json.open('[');
}

// Everything behind the names.
void endJson(HX_JsonWriter& json, const HX_RunResult& result) {
  json.close(']');
  json.key("types");
  json.open('[');
  for (const HX_TypeItem* type : result.types) json.element(type->name);
  json.close(']');
  json.key("variables");
  json.open('[');
  for (const HX_FormedName* name : result.variables)
    json.element(HX_ToUtf8(name->actual));
  json.close(']');
  writeFindings(json, result.findings);
  json.close('}');
  json.end();
}

}  // namespace

void HX_WriteJson(std::ostream& stream, const HX_RunResult& result) {
  HX_JsonWriter json(stream, 2);
  beginJson(json);
  for (const HX_FormedName* name : result.names)
    writeName(json, *name, name->sourcePath());
  endJson(json, result);
}

// Both files in one pass: a large model does not fit the caches, and the path
// is made once.
void HX_WriteNameMap(std::ostream& jsonStream, std::ostream& csvStream,
                     const HX_RunResult& result, HX_Progress& progress) {
  progress.begin("writing the name map", result.names.size());
  HX_JsonWriter json(jsonStream, 2);
  HX_TextPieces csv(csvStream);
  csv.text += "id,template,formal,actual,changes,source\r\n";
  beginJson(json);
  for (const HX_FormedName* name : result.names) {
    const std::string path = name->sourcePath();
    writeName(json, *name, path);
    writeCsvLine(csv.text, *name, path);
    csv.endPiece();
    progress.step();
  }
  endJson(json, result);
}
