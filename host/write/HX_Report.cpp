#include "host/write/HX_Report.h"

#include <rapidjson/writer.h>

#include <algorithm>
#include <ostream>
#include <unordered_map>

#include "host/base/HX_Text.h"
#include "host/write/HX_ReportPage.h"
#include "platform/messages/HX_MessageHandler.h"

namespace {

/// Stream under the JSON writer. '<' occurs only inside texts of JSON; escaped,
/// no text can end the script element around the data.
class ScriptStream {
 public:
  using Ch = char;
  explicit ScriptStream(std::ostream& out) : m_Out(out) {}
  void Put(char c) {
    if (c == '<')
      m_Out << "\\u003c";
    else
      m_Out.put(c);
  }
  void Flush() {}

 private:
  std::ostream& m_Out;
};

using Writer = rapidjson::Writer<ScriptStream>;
using Column = std::vector<int>;

/// Distinct texts by number.
class Texts {
 public:
  int add(const std::string& text) {
    const auto [entry, isNew] =
        m_Numbers.emplace(text, static_cast<int>(m_Texts.size()));
    if (isNew) m_Texts.push_back(&entry->first);
    return entry->second;
  }
  int add(std::string_view text) { return add(std::string(text)); }
  int add(const KyCXString& text) { return add(HX_ToUtf8(text)); }
  const std::vector<const std::string*>& all() const { return m_Texts; }

 private:
  std::unordered_map<std::string, int> m_Numbers;  // elements never move
  std::vector<const std::string*> m_Texts;
};

/// Nodes with names, parents before children.
struct Tree {
  Column name;
  Column kind;
  Column parent;

  int add(int nameText, int kindText, int parentNode) {
    name.push_back(nameText);
    kind.push_back(kindText);
    parent.push_back(parentNode);
    return static_cast<int>(name.size()) - 1;
  }
};

struct Graph {
  Column name;
  std::vector<Column> uses;  // positions of the items that stand before
};

// Bits of the names' states, as the page counts them.
enum HxEStateBit {
  kChanged = 1,
  kShortened = 2,
  kDerived = 4,
  kReserved = 8,
  kError = 16,
  kWarning = 32,
  kIncomplete = 64,
  kRenamed = 128
};

int bitsOf(HX_Change::HxEReasonTag reason) {
  switch (reason) {
    case HX_Change::eNone:
      return 0;
    case HX_Change::eMadeIdentifier:
      return kChanged;
    case HX_Change::eShortened:
      return kChanged | kShortened;
    case HX_Change::eKeyword:
    case HX_Change::eBaseType:
    case HX_Change::eType:
      return kChanged | kReserved;
    case HX_Change::ePattern:
    case HX_Change::eLibrary:
    case HX_Change::eMacro:
      return kChanged | kReserved;
    case HX_Change::eRewritten:
    case HX_Change::eLocked:
    case HX_Change::eNoVariant:
      return kChanged;
    case HX_Change::eTakenByConstant:
    case HX_Change::eTakenByName:
    case HX_Change::eIndistinct:
    case HX_Change::eHeld:
    case HX_Change::eRetired:
      return kChanged | kDerived;
  }
  return kChanged;
}

int stateOf(const HX_FormedName& name) {
  int state = name.isComplete ? 0 : kIncomplete;
  for (const HX_Change& change : name.changes) state |= bitsOf(change.reason);
  for (const HX_Finding& finding : name.findings) {
    if (finding.isError())
      state |= kError;
    else if (finding.severity % 4 == HX_Finding::eWarning)
      state |= kWarning;
  }
  return state;
}

// Items that lie on a cycle or between two cycles: all that remain after items
// without remaining uses, and then items without remaining users, have gone.
Column cycleOf(const Graph& graph) {
  const std::size_t count = graph.uses.size();
  std::vector<Column> users(count);
  for (std::size_t user = 0; user < count; ++user) {
    for (const int used : graph.uses[user])
      users[static_cast<std::size_t>(used)].push_back(static_cast<int>(user));
  }
  std::vector<bool> isGone(count, false);
  const auto strip = [&](const std::vector<Column>& needs,
                         const std::vector<Column>& neededBy) {
    std::vector<std::size_t> open(count, 0);
    std::vector<std::size_t> ready;
    for (std::size_t item = 0; item < count; ++item) {
      for (const int need : needs[item])
        if (!isGone[static_cast<std::size_t>(need)]) ++open[item];
      if (open[item] == 0 && !isGone[item]) ready.push_back(item);
    }
    while (!ready.empty()) {
      const std::size_t item = ready.back();
      ready.pop_back();
      isGone[item] = true;
      for (const int next : neededBy[item])
        if (--open[static_cast<std::size_t>(next)] == 0)
          ready.push_back(static_cast<std::size_t>(next));
    }
  };
  strip(graph.uses, users);
  strip(users, graph.uses);
  Column members;
  for (std::size_t item = 0; item < count; ++item)
    if (!isGone[item]) members.push_back(static_cast<int>(item));
  return members;
}

class Report {
 public:
  Report(std::ostream& out, const HX_ReportInput& input)
      : m_Stream(out), m_Writer(m_Stream), m_Input(input) {}

  void write() {
    collectPlaces();
    collectScopes();
    m_Writer.StartObject();
    writeText("model", m_Input.model.name);
    writeText("program", m_Input.program);
    writeText("since", m_Input.since);
    writeNames();
    writeTree("places", m_Places);
    writeTree("scopes", m_Scopes);
    writeOrder();
    writeTimes();
    m_Writer.Key("texts");
    m_Writer.StartArray();
    for (const std::string* text : m_Texts.all()) writeText(*text);
    m_Writer.EndArray();
    m_Writer.EndObject();
  }

 private:
  void writeText(const std::string& text) {
    m_Writer.String(text.data(), static_cast<rapidjson::SizeType>(text.size()));
  }
  void writeText(const char* key, const std::string& text) {
    m_Writer.Key(key);
    writeText(text);
  }
  void writeColumn(const Column& column) {
    m_Writer.StartArray();
    for (const int value : column) m_Writer.Int(value);
    m_Writer.EndArray();
  }
  void writeColumn(const char* key, const Column& column) {
    m_Writer.Key(key);
    writeColumn(column);
  }
  void writeColumns(const char* key, const std::vector<Column>& columns) {
    m_Writer.Key(key);
    m_Writer.StartArray();
    for (const Column& column : columns) writeColumn(column);
    m_Writer.EndArray();
  }
  void writeTree(const char* key, const Tree& tree) {
    m_Writer.Key(key);
    m_Writer.StartObject();
    writeColumn("name", tree.name);
    writeColumn("kind", tree.kind);
    writeColumn("parent", tree.parent);
    m_Writer.EndObject();
  }

  int addPlace(const std::string& path, const std::string& name,
               std::string_view kind, int parent) {
    const int place =
        m_Places.add(m_Texts.add(name), m_Texts.add(kind), parent);
    m_PlaceOfPath.emplace(path, place);  // the first of equal paths counts
    return place;
  }

  void collectPlaces() {
    std::unordered_map<const HX_Block*, int> placeOf;
    for (const auto& block : m_Input.model.blocks) {
      const auto parent = placeOf.find(block->getParent());
      KyCXString path;
      block->getFullPathName(path, false, false);
      const bool isChart = block->isStateflowBlock() != nullptr;
      placeOf[block.get()] =
          addPlace(HX_ToUtf8(path), HX_ToUtf8(block->getName()),
                   isChart ? "chart" : "block",
                   parent == placeOf.end() ? -1 : parent->second);
    }
    for (const SC_State& object : m_Input.model.chartObjects) {
      const std::string path = HX_PathOf(object.getStateflowSrcRef());
      if (m_PlaceOfPath.count(path) != 0) continue;  // the chart itself
      const std::size_t slash = path.rfind('/');
      const auto parent = m_PlaceOfPath.find(path.substr(0, slash));
      addPlace(path, path.substr(slash + 1), "object",
               parent == m_PlaceOfPath.end() ? -1 : parent->second);
    }
  }

  int placeOf(const HX_FormedName& name) {
    const std::string path = name.sourcePath();
    if (path.empty()) return -1;
    const auto known = m_PlaceOfPath.find(path);
    if (known != m_PlaceOfPath.end()) return known->second;
    if (m_OtherPlaces < 0)
      m_OtherPlaces = addPlace("", "Data dictionary and others", "", -1);
    return addPlace(path, path, "object", m_OtherPlaces);
  }

  void collectScopes() {
    for (const HX_ScopeItem& scope : m_Input.model.scopes) {
      const auto parent = m_NumberOfScope.find(scope.parent);
      m_NumberOfScope[&scope] =
          m_Scopes.add(m_Texts.add(scope.id),
                       m_Texts.add(HX_WordOf(kHxScopeKinds, scope.kind)),
                       parent == m_NumberOfScope.end() ? -1 : parent->second);
    }
  }

  void writeNames() {
    enum { kId, kKind, kType, kScope, kPlace, kTemplate, kWanted };
    enum { kFormal = kWanted + 1, kActual, kState, kBefore, kReason, kCount };
    constexpr const char* kKeys[kCount] = {
        "id",     "kind",   "type",   "scope", "place",  "template",
        "wanted", "formal", "actual", "state", "before", "reason"};
    Column columns[kCount];
    std::vector<Column> steps;
    std::vector<Column> changes;
    std::vector<Column> messages;
    for (const HX_FormedName* name : m_Input.result.names) {
      const HX_WantedName& wanted = *name->wanted;
      std::string expanded;
      steps.push_back(stepsOf(wanted, expanded));
      changes.push_back(changesOf(*name));
      messages.push_back(messagesOf(*name));
      const auto scope = m_NumberOfScope.find(wanted.scope);
      const auto& renamed = m_Input.renamed;
      const auto older = renamed.find(wanted.id);
      const int row[kCount] = {
          m_Texts.add(wanted.id),
          m_Texts.add(HX_WordOf(kHxNameKinds, wanted.kind)),
          wanted.type != nullptr ? m_Texts.add(wanted.type->name) : -1,
          scope != m_NumberOfScope.end() ? scope->second : -1,
          placeOf(*name),
          m_Texts.add(*wanted.nameTemplate->shown),
          m_Texts.add(expanded),
          m_Texts.add(name->formal()),
          m_Texts.add(name->actual),
          stateOf(*name) | (older != renamed.end() ? kRenamed : 0),
          older != renamed.end() ? m_Texts.add(older->second.name) : -1,
          older != renamed.end() ? m_Texts.add(older->second.reason) : -1};
      for (int i = 0; i < kCount; ++i) columns[i].push_back(row[i]);
    }
    m_Writer.Key("names");
    m_Writer.StartObject();
    for (int i = 0; i < kCount; ++i) writeColumn(kKeys[i], columns[i]);
    writeColumns("steps", steps);
    writeColumns("changes", changes);
    writeColumns("messages", messages);
    m_Writer.EndObject();
  }

  Column stepsOf(const HX_WantedName& name, std::string& expanded) {
    Column steps;
    for (const HX_ExplainedMacro& macro : m_Input.explain(name)) {
      steps.push_back(m_Texts.add(macro.macro));
      steps.push_back(m_Texts.add(macro.value));
      steps.push_back(m_Texts.add(macro.origin));
      expanded += macro.value;
    }
    return steps;
  }

  Column changesOf(const HX_FormedName& name) {
    Column changes;
    for (const HX_Change& change : name.changes)
      changes.push_back(m_Texts.add(change.text()));
    return changes;
  }

  Column messagesOf(const HX_FormedName& name) {
    Column messages;
    for (const HX_Finding& finding : name.findings) {
      messages.push_back(m_Texts.add(
          std::string_view(HX_MessageHandler::severityName(finding.severity))));
      messages.push_back(finding.id);
      messages.push_back(m_Texts.add(finding.text));
    }
    return messages;
  }

  // Types in the order of definition; in the order of the document if a cycle
  // left no order.
  void writeOrder() {
    std::vector<const HX_TypeItem*> types = m_Input.result.types;
    if (types.empty())
      for (const HX_TypeItem& type : m_Input.model.types)
        types.push_back(&type);
    const Graph typeGraph = graphOf(
        types,
        [](const HX_TypeItem& type) -> const std::string& { return type.name; },
        [](const HX_TypeItem& type, auto use) {
          use(type.of);
          for (const HX_TypeItem::Field& field : type.fields) use(field.type);
        });
    std::unordered_map<const HX_WantedName*, const HX_FormedName*> formedOf;
    for (const HX_FormedName& name : m_Input.result.formed)
      formedOf.emplace(name.wanted, &name);
    const Graph variableGraph = graphOf(
        m_Input.result.variables,
        [](const HX_FormedName& name) { return name.actual; },
        [&](const HX_FormedName& name, auto use) {
          for (const HX_WantedName* wanted : name.wanted->dependsOn) {
            const auto found = formedOf.find(wanted);
            if (found != formedOf.end()) use(found->second);
          }
        });
    writeGraph("types", typeGraph);
    writeGraph("variables", variableGraph);
    writeCycle(typeGraph);
  }

  template <class Item, class NameOf, class EachUse>
  Graph graphOf(const std::vector<const Item*>& items, NameOf nameOf,
                EachUse eachUse) {
    std::unordered_map<const Item*, int> position;
    for (const Item* item : items)
      position.emplace(item, static_cast<int>(position.size()));
    Graph graph;
    for (const Item* item : items) {
      graph.name.push_back(m_Texts.add(nameOf(*item)));
      Column& uses = graph.uses.emplace_back();
      eachUse(*item, [&](const Item* used) {
        const auto found = position.find(used);
        if (found != position.end()) uses.push_back(found->second);
      });
    }
    return graph;
  }

  void writeGraph(const char* key, const Graph& graph) {
    m_Writer.Key(key);
    m_Writer.StartObject();
    writeColumn("name", graph.name);
    writeColumns("uses", graph.uses);
    m_Writer.EndObject();
  }

  // The library reports a cycle with message 403, which has the id 17051.
  void writeCycle(const Graph& types) {
    constexpr int kCycleMessage = 17051;
    m_Writer.Key("cycle");
    const auto& findings = m_Input.result.findings;
    const auto found = std::find_if(
        findings.begin(), findings.end(),
        [](const HX_Finding& each) { return each.id == kCycleMessage; });
    if (found == findings.end()) {
      m_Writer.Null();
      return;
    }
    m_Writer.StartObject();
    writeText("kind", "types");
    writeColumn("members", cycleOf(types));
    m_Writer.Key("text");
    m_Writer.Int(m_Texts.add(found->text));
    m_Writer.EndObject();
  }

  void writeTimes() {
    const auto runs = HX_RunsByBegin(m_Input.runs);
    Column names;
    for (const HX_TimedRun* run : runs) names.push_back(m_Texts.add(run->name));
    m_Writer.Key("times");
    m_Writer.StartObject();
    writeColumn("name", names);
    m_Writer.Key("start");
    m_Writer.StartArray();
    for (const HX_TimedRun* run : runs) m_Writer.Int64(run->begin);
    m_Writer.EndArray();
    m_Writer.Key("end");
    m_Writer.StartArray();
    for (const HX_TimedRun* run : runs)
      m_Writer.Int64(run->begin + run->duration);
    m_Writer.EndArray();
    m_Writer.EndObject();
  }

  ScriptStream m_Stream;
  Writer m_Writer;
  const HX_ReportInput& m_Input;
  Texts m_Texts;
  Tree m_Places;
  Tree m_Scopes;
  std::unordered_map<std::string, int> m_PlaceOfPath;
  std::unordered_map<const HX_ScopeItem*, int> m_NumberOfScope;
  int m_OtherPlaces = -1;
};

}  // namespace

void HX_WriteReport(std::ostream& out, const HX_ReportInput& input) {
  for (std::size_t i = 0; i < kHxPageBeforeDataCount; ++i)
    out << kHxPageBeforeData[i];
  Report(out, input).write();
  for (std::size_t i = 0; i < kHxPageAfterDataCount; ++i)
    out << kHxPageAfterData[i];
}
