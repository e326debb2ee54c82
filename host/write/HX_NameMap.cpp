#include "host/write/HX_NameMap.h"

#include <ostream>
#include <string>

#include "host/base/HX_JsonWriter.h"
#include "host/base/HX_Text.h"
#include "host/names/HX_CFiles.h"
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

/// What the entries of one map share.
struct Map {
  Map(const HX_Model& model, const HX_RunResult& run)
      : modelName(model.name), result(run), files(HX_CFiles::ofModel()) {
    if (!run.codeFile.empty()) files.code = run.codeFile;
  }

  std::string fileOf(const HX_FormedName& name) const {
    switch (name.code.file) {
      case HX_CodePlace::eHeader:
        return files.code + ".h";
      case HX_CodePlace::eSource:
        return files.code + ".c";
      case HX_CodePlace::eNone:
        break;
    }
    return {};
  }

  const std::string& modelName;
  const HX_RunResult& result;
  HX_CFiles files;
};

void textOrNull(HX_JsonWriter& json, const char* field,
                const std::string& text) {
  if (text.empty())
    json.rawField(field, "null");
  else
    json.field(field, text);
}

std::string typeOf(const HX_FormedName& name) {
  return name.wanted->type != nullptr ? name.wanted->type->name : std::string();
}

void writeReasons(HX_JsonWriter& json, const HX_FormedName& name) {
  json.key("reasons");
  json.open('[');
  for (const HX_Change& change : name.changes) {
    json.next();
    json.open('{');
    json.field("kind", change.kind());
    json.field("text", change.text());
    if (change.owner != nullptr) json.field("id", change.owner->id);
    json.close('}');
  }
  json.close(']');
}

// The fields of a name.
void writeName(HX_JsonWriter& json, const Map& map, const HX_FormedName& name,
               const std::string& path) {
  const HX_WantedName& wanted = *name.wanted;
  json.field("id", wanted.id);
  json.field("kind", HX_WordOf(kHxNameKinds, wanted.kind));
  textOrNull(json, "type", typeOf(name));
  json.field("scope", wanted.scope->id);
  const HxCSrcRef* best = HX_BestSource(wanted);
  json.field("source", path);
  json.key("sources");
  json.open('[');
  wanted.sources().forEach([&](const HxCSrcRef* source) {
    json.element(source == best ? path : HX_PathOf(source));
  });
  json.close(']');
  textOrNull(json, "file", map.fileOf(name));
  json.rawField("line",
                name.code.line == 0 ? "null" : std::to_string(name.code.line));
  json.field("template", *wanted.nameTemplate->shown);
  json.field("formal", HX_ToUtf8(name.formal()));
  json.field("wanted", HX_ToUtf8(name.wantedText()));
  json.field("actual", HX_ToUtf8(name.actual));
  json.rawField("complete", name.isComplete ? "true" : "false");
  json.rawField("defined", name.isDefined ? "true" : "false");
  writeReasons(json, name);
  writeFindings(json, name.findings);
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

void writeCsvLine(std::string& out, const Map& map, const HX_FormedName& name,
                  const std::string& path) {
  const HX_WantedName& wanted = *name.wanted;
  appendCsv(out, wanted.id, ',');
  appendCsv(out, std::string(HX_WordOf(kHxNameKinds, wanted.kind)), ',');
  appendCsv(out, typeOf(name), ',');
  appendCsv(out, wanted.scope->id, ',');
  appendCsv(out, path, ',');
  appendCsv(out, map.fileOf(name), ',');
  appendCsv(out, name.code.line == 0 ? "" : std::to_string(name.code.line),
            ',');
  appendCsv(out, *wanted.nameTemplate->shown, ',');
  appendCsv(out, HX_ToUtf8(name.formal()), ',');
  appendCsv(out, HX_ToUtf8(name.wantedText()), ',');
  appendCsv(out, HX_ToUtf8(name.actual), ',');
  appendCsv(out, HX_JoinedChanges(name, "; "), '\r');
  out += '\n';
}

void writeHead(HX_JsonWriter& json, const Map& map) {
  json.rawField("nameMap", std::to_string(kHxNameMapVersion));
  json.field("model", map.modelName);
}

// Everything behind the names.
void writeEnd(HX_JsonWriter& json, const HX_RunResult& result) {
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
}

/// Writes one document.
class WholeForm {
 public:
  WholeForm(std::ostream& out, const Map& map) : m_Map(map), m_Json(out, 2) {
    m_Json.open('{');
    writeHead(m_Json, map);
    m_Json.key("names");
    m_Json.open('[');
  }
  void add(const HX_FormedName& name, const std::string& path) {
    m_Json.next();
    m_Json.open('{');
    writeName(m_Json, m_Map, name, path);
    m_Json.close('}');
  }
  void end() {
    m_Json.close(']');
    writeEnd(m_Json, m_Map.result);
    m_Json.close('}');
    m_Json.end();
  }

 private:
  const Map& m_Map;
  HX_JsonWriter m_Json;
};

/// Writes a document on each line: head, names, end.
class LineForm {
 public:
  LineForm(std::ostream& out, const Map& map)
      : m_Map(map), m_Json(out, HX_JsonWriter::kOneLine) {
    writeLine("head", [&] { writeHead(m_Json, map); });
  }
  void add(const HX_FormedName& name, const std::string& path) {
    writeLine("name", [&] { writeName(m_Json, m_Map, name, path); });
  }
  void end() {
    writeLine("end", [&] { writeEnd(m_Json, m_Map.result); });
  }

 private:
  template <class Content>
  void writeLine(const char* record, Content content) {
    m_Json.open('{');
    m_Json.field("record", record);
    content();
    m_Json.close('}');
    m_Json.end();
  }

  const Map& m_Map;
  HX_JsonWriter m_Json;
};

template <class Form>
void writeMap(std::ostream& out, const Map& map) {
  Form form(out, map);
  for (const HX_FormedName* name : map.result.names)
    form.add(*name, name->sourcePath());
  form.end();
}

// Both files in one pass: a large model does not fit the caches, and the path
// is made once.
template <class Form>
void writeBoth(std::ostream& jsonStream, std::ostream& csvStream,
               const Map& map, HX_Progress& progress) {
  progress.begin("writing the name map", map.result.names.size());
  Form form(jsonStream, map);
  HX_TextPieces csv(csvStream);
  csv.text +=
      "id,kind,type,scope,source,file,line,template,formal,wanted,actual,"
      "reasons\r\n";
  for (const HX_FormedName* name : map.result.names) {
    const std::string path = name->sourcePath();
    form.add(*name, path);
    writeCsvLine(csv.text, map, *name, path);
    csv.endPiece();
    progress.step();
  }
  form.end();
}

}  // namespace

void HX_WriteJson(std::ostream& out, const HX_Model& model,
                  const HX_RunResult& result, bool asLines) {
  const Map map(model, result);
  if (asLines)
    writeMap<LineForm>(out, map);
  else
    writeMap<WholeForm>(out, map);
}

void HX_WriteNameMap(std::ostream& json, std::ostream& csv,
                     const HX_Model& model, const HX_RunResult& result,
                     bool asLines, HX_Progress& progress) {
  const Map map(model, result);
  if (asLines)
    writeBoth<LineForm>(json, csv, map, progress);
  else
    writeBoth<WholeForm>(json, csv, map, progress);
}
