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

void writeName(HX_JsonWriter& json, const HX_FormedName& name) {
  json.next();
  json.open('{');
  json.field("id", name.wanted->id);
  const HxCSrcRef* best = HX_BestSource(*name.wanted);
  const std::string path = HX_PathOf(best);
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

}  // namespace

void HX_WriteJson(std::ostream& stream, const HX_RunResult& result) {
  HX_JsonWriter json(stream, 2);
  json.open('{');
  json.key("names");
  json.open('[');
  for (const HX_FormedName* name : result.names) writeName(json, *name);
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

void HX_WriteCsv(std::ostream& stream, const HX_RunResult& result) {
  HX_TextPieces out(stream);
  out.text += "id,template,formal,actual,changes,source\r\n";
  for (const HX_FormedName* name : result.names) {
    appendCsv(out.text, name->wanted->id, ',');
    appendCsv(out.text, *name->wanted->nameTemplate->shown, ',');
    appendCsv(out.text, HX_ToUtf8(name->formal()), ',');
    appendCsv(out.text, HX_ToUtf8(name->actual), ',');
    appendCsv(out.text, HX_JoinedChanges(*name, "; "), ',');
    appendCsv(out.text, name->sourcePath(), '\r');
    out.text += '\n';
    out.endPiece();
  }
}
