#include "host/import/HX_ModelDocument.h"

#include <rapidjson/prettywriter.h>
#include <rapidjson/stringbuffer.h>

#include <algorithm>
#include <charconv>

#include "host/import/HX_Dictionary.h"
#include "host/import/HX_ModelTree.h"
#include "host/import/HX_NameItems.h"
#include "host/import/HX_Rules.h"
#include "host/import/HX_TypeTable.h"

namespace {

/// The identification and number of a subsystem, $I and the number in $S.
struct SystemId {
  std::string id;
  int number = 0;
};

// "98:12" into "98" and "12"; "642::105" into "642" and "105".
std::vector<std::string> partsOf(const std::string& id) {
  std::vector<std::string> parts(1);
  for (const char c : id) {
    if (c != ':')
      parts.back() += c;
    else if (!parts.back().empty())
      parts.emplace_back();
  }
  return parts;
}

bool readNumber(const std::string& text, int& number) {
  const char* end = text.data() + text.size();
  const auto result = std::from_chars(text.data(), end, number);
  return result.ec == std::errc() && result.ptr == end && number >= 0;
}

// The number comes from the model file, so names stay when subsystems come and
// go. The text before the number belongs to the identification: block 98:12
// gives "a98_" and 12, and $S is "Sa98_12".
SystemId systemIdOf(const HX_ModelBlock& block, const std::string& root) {
  SystemId system{root, 0};
  if (block.parent == nullptr) return system;
  std::vector<std::string> parts = partsOf(block.id);
  // Objects of a chart have numbers already: $C is "Ca264_12".
  if (!block.isChart && readNumber(parts.back(), system.number))
    parts.pop_back();
  for (const std::string& part : parts) {
    for (const char c : part)
      system.id += (c >= '0' && c <= '9') || (c >= 'a' && c <= 'z') ||
                           (c >= 'A' && c <= 'Z')
                       ? c
                       : '_';
    system.id += '_';
  }
  return system;
}

class Writer {
 public:
  explicit Writer(const HX_ModelParts& parts) : m_Parts(parts) {
    m_Json.SetIndent(' ', 1);
    m_Json.SetFormatOptions(rapidjson::kFormatSingleLineArray);
  }

  std::string write() {
    m_Json.StartObject();
    key("model");
    m_Json.StartObject();
    field("name", m_Parts.root.name);
    field("systemId", m_Parts.rules.systemId);
    m_Json.EndObject();
    writeOptions();
    openList("blocks");
    writeBlock(m_Parts.root);
    m_Json.EndArray();
    writeDictionary();
    openList("types");
    for (const HX_ImportedType& type : m_Parts.types.types()) writeType(type);
    m_Json.EndArray();
    writeScopes();
    openList("names");
    for (const HX_ImportedName& name : m_Parts.items.names()) writeName(name);
    m_Json.EndArray();
    m_Json.EndObject();
    return std::string(m_Buffer.GetString(), m_Buffer.GetSize()) + "\n";
  }

 private:
  void key(std::string_view name) {
    m_Json.Key(name.data(), static_cast<rapidjson::SizeType>(name.size()));
  }
  void text(std::string_view value) {
    m_Json.String(value.data(), static_cast<rapidjson::SizeType>(value.size()));
  }
  void field(std::string_view name, std::string_view value) {
    key(name);
    text(value);
  }
  void given(std::string_view name, std::string_view value) {
    if (!value.empty()) field(name, value);
  }
  void field(std::string_view name, int value) {
    key(name);
    m_Json.Int(value);
  }
  void field(std::string_view name, double value) {
    key(name);
    m_Json.Double(value);
  }
  void openList(std::string_view name) {
    key(name);
    m_Json.StartArray();
  }

  void writeOptions() {
    key("options");
    m_Json.StartObject();
    key("limitNames");
    m_Json.Bool(m_Parts.rules.limitNames);
    openList("keywords");
    for (const std::string& list : m_Parts.rules.keywords) text(list);
    m_Json.EndArray();
    m_Json.EndObject();
  }

  void writeBlock(const HX_ModelBlock& block) {
    m_Json.StartObject();
    field("id", block.id);
    field("name", block.name);
    if (block.hasContent || block.isFunction) {
      const SystemId system = systemIdOf(block, m_Parts.rules.systemId);
      key("subsystem");
      m_Json.StartObject();
      field("id", system.id);
      field("number", system.number);
      m_Json.EndObject();
    }
    if (block.isChart) {
      key("chart");
      m_Json.StartObject();
      field("number", std::max(block.chart.number, 0));
      writeObjects(block.chart.objects);
      m_Json.EndObject();
    }
    if (!block.blocks.empty()) {
      openList("blocks");
      for (const HX_ModelBlock& inner : block.blocks) writeBlock(inner);
      m_Json.EndArray();
    }
    m_Json.EndObject();
  }

  void writeObjects(const std::vector<HX_ChartObject>& objects) {
    if (objects.empty()) return;
    openList("objects");
    for (const HX_ChartObject& object : objects) {
      m_Json.StartObject();
      field("id", object.id);
      field("name", object.name);
      field("number", std::max(object.number, 0));
      writeObjects(object.objects);
      m_Json.EndObject();
    }
    m_Json.EndArray();
  }

  void writeDictionary() {
    if (m_Parts.dictionary.entries().empty()) return;
    // In the order of HX_DictionaryEntry::Kind.
    static constexpr const char* kFolders[] = {
        "Enumerations", "Buses", "Parameters", "Signals", "Types", "Others"};
    key("dataDictionary");
    m_Json.StartObject();
    openList("objects");
    for (const auto& [name, entry] : m_Parts.dictionary.entries()) {
      m_Json.StartObject();
      field("id", "dd:" + name);
      field("path", "//DD0/" + entry.dictionary + "/" + kFolders[entry.kind] +
                        "/" + name);
      m_Json.EndObject();
    }
    m_Json.EndArray();
    m_Json.EndObject();
  }

  void writeType(const HX_ImportedType& type) {
    m_Json.StartObject();
    field("id", type.id);
    field("name", type.name);
    field("kind", type.kind);
    given("c", type.c);
    given("cut", type.cut);
    given("of", type.of);
    if (type.length > 0) field("length", type.length);
    if (!type.isSigned && type.kind == "integer64") {
      key("signed");
      m_Json.Bool(false);
    }
    if (!type.fields.empty()) {
      openList("fields");
      for (const auto& [name, id] : type.fields) {
        m_Json.StartObject();
        field("name", name);
        field("type", id);
        m_Json.EndObject();
      }
      m_Json.EndArray();
    }
    if (!type.values.empty()) {
      openList("values");
      for (const auto& [name, value] : type.values) {
        m_Json.StartObject();
        field("name", name);
        field("value", value);
        m_Json.EndObject();
      }
      m_Json.EndArray();
    }
    m_Json.EndObject();
  }

  void writeScopes() {
    openList("scopes");
    m_Json.StartObject();
    field("id", "file");
    field("kind", "file");
    openList("scopes");
    for (const HX_ImportedBody& body : m_Parts.items.bodies()) {
      m_Json.StartObject();
      field("id", body.scope);
      field("kind", "function");
      field("function", body.function);
      m_Json.EndObject();
    }
    m_Json.EndArray();
    m_Json.EndObject();
    m_Json.EndArray();
  }

  void writeName(const HX_ImportedName& name) {
    m_Json.StartObject();
    field("id", name.id);
    field("template", name.rule->nameTemplate);
    field("rule", name.rule->name);
    field("kind", name.kind);
    given("source", name.source);
    given("dd", name.dd);
    given("label", name.label);
    given("x", name.x);
    given("type", name.type);
    field("scope", name.scope);
    given("task", name.task);
    if (name.period) {
      field("period", *name.period);
      field("offset", name.offset);
    }
    if (name.initial.size() == 1) {
      field("initial", name.initial.front());
    } else if (!name.initial.empty()) {
      openList("initial");
      for (const double value : name.initial) m_Json.Double(value);
      m_Json.EndArray();
    }
    if (name.lsb != 1) field("lsb", name.lsb);
    if (name.zero != 0) field("zero", name.zero);
    m_Json.EndObject();
  }

  const HX_ModelParts& m_Parts;
  rapidjson::StringBuffer m_Buffer;
  rapidjson::PrettyWriter<rapidjson::StringBuffer> m_Json{m_Buffer};
};

}  // namespace

std::string HX_WriteModelDocument(const HX_ModelParts& parts) {
  return Writer(parts).write();
}
