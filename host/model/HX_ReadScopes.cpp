// The scopes of a model.
#include <optional>

#include "host/model/HX_ModelReading.h"

namespace {

using Reading = HX_ModelReading;
using Value = HX_BoundValue;

HX_ScopeRecord& scope(Reading& r) {
  return r.scopes[static_cast<std::size_t>(r.openScopes.back())];
}

void beginScope(Reading& r, HX_TokenEnd) {
  HX_ScopeRecord& record = r.scopes.emplace_back();
  if (!r.openScopes.empty()) record.parent = r.openScopes.back();
  r.openScopes.push_back(static_cast<int>(r.scopes.size()) - 1);
}

void endScope(Reading& r, bool isFaulty) {
  scope(r).isFaulty = isFaulty;
  if (!scope(r).id.isGiven()) r.scopeIds.isWhole = false;
  r.openScopes.pop_back();
}

constexpr HX_FieldBinding kBindings[] = {
    {"scope", nullptr, beginScope, endScope},
    {"scope.id",
     [](Reading& r, const Value& v) { scope(r).id = r.scopeIds.use(v); }},
    {"scope.kind",
     [](Reading& r, const Value& v) {
       scope(r).kind = HX_ValueOf(kHxScopeKinds, v.text);
       scope(r).kindPlace = v.place;
     }},
    {"scope.function",
     [](Reading& r, const Value& v) { scope(r).function = r.nameIds.use(v); }},
};

// The kind of scope that a kind of scope may stand in; no value means the
// document itself. A block may also stand in a block.
std::optional<HX_ScopeKind> parentOf(HX_ScopeKind kind) {
  switch (kind) {
    case HX_ScopeKind::eFunction:
      return HX_ScopeKind::eFile;
    case HX_ScopeKind::eBlock:
      return HX_ScopeKind::eFunction;
    case HX_ScopeKind::eFile:
    case HX_ScopeKind::eFlat:
      break;
  }
  return {};
}

std::string kindText(const std::optional<HX_ScopeKind>& kind) {
  return kind ? std::string(HX_WordOf(kHxScopeKinds, *kind)) : "the document";
}

/// Makes the scopes of the model from the records.
class Maker {
 public:
  explicit Maker(Reading& reading)
      : m_Reading(reading), m_Model(reading.model) {}

  void make() {
    for (const HX_ScopeRecord& record : m_Reading.scopes) makeScope(record);
    if (m_Model.fileScope == nullptr) {
      m_Model.fileScope = &m_Model.scopes.emplace_back();
      m_Model.fileScope->id = "file";
    }
  }

 private:
  void makeScope(const HX_ScopeRecord& record) {
    const std::size_t index = m_Model.scopes.size();
    HX_ScopeItem& item = m_Model.scopes.emplace_back();
    m_Reading.define(m_Reading.scopeIds, record.id, index);
    if (record.id.isGiven()) item.id = m_Reading.scopeIds.text(record.id.entry);
    item.kind = record.kind;
    HX_ScopeItem* parent = nullptr;
    if (record.parent >= 0)
      parent = &m_Model.scopes[static_cast<std::size_t>(record.parent)];
    item.parent = parent;
    if (record.isFaulty || !checkParent(record, item)) return;
    if (item.kind == HX_ScopeKind::eBlock) parent->blocks[item.id] = &item;
    if (item.kind == HX_ScopeKind::eFunction) enterFunction(record, item);
    if (item.kind != HX_ScopeKind::eFile) return;
    if (m_Model.fileScope != nullptr)
      m_Reading.faults.add(record.kindPlace, "a second file scope",
                           "one file scope");
    else
      m_Model.fileScope = &item;
  }

  bool checkParent(const HX_ScopeRecord& record, const HX_ScopeItem& item) {
    const std::optional<HX_ScopeKind> wanted = parentOf(item.kind);
    std::optional<HX_ScopeKind> found;
    if (item.parent != nullptr) found = item.parent->kind;
    const bool isBlockInBlock =
        item.kind == HX_ScopeKind::eBlock && found == HX_ScopeKind::eBlock;
    if (found == wanted || isBlockInBlock) return true;
    m_Reading.faults.add(
        record.kindPlace,
        HX_Quoted(kindText(item.kind)) + " in " + kindText(found),
        "a scope of this kind only in " + kindText(wanted));
    return false;
  }

  // The function that the scope is the body of.
  void enterFunction(const HX_ScopeRecord& record, const HX_ScopeItem& item) {
    const int index = m_Reading.nameIds.find(record.function);
    if (index < 0) return;
    HX_WantedName& name = m_Model.names[static_cast<std::size_t>(index)];
    if (m_Reading.names[static_cast<std::size_t>(index)].isFaulty) return;
    if (name.isFunction() && name.body == nullptr)
      name.body = &item;
    else
      m_Reading.faults.add(
          record.function.place, HX_Quoted(name.id),
          "the id of a function, task or isr without another scope");
  }

  Reading& m_Reading;
  HX_Model& m_Model;
};

}  // namespace

HX_Bindings HX_ScopeBindings() { return {kBindings, std::size(kBindings)}; }

void HX_ResolveScopes(HX_ModelReading& reading) { Maker(reading).make(); }
