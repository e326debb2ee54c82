// The names that a model asks for.
#include "Naming/HX_MacroTable.h"
#include "host/model/HX_ModelReading.h"
#include "host/model/HX_UseGraph.h"

namespace {

using Reading = HX_ModelReading;
using Value = HX_BoundValue;

// The schema admits macros with a bit only.
unsigned int bitOf(const Value& macro) {
  return HX_FindMacro(HX_FromUtf8(macro.text))->bit;
}

constexpr HX_Word<HxCNames::tagMacroKindEnum> kSubstitutionKinds[] = {
    {"exact", HxCNames::eMacroKindExact},
    {"any", HxCNames::eMacroKindAnyCase},
    {"selects", HxCNames::eMacroKindCaseSelectsValue},
};

constexpr HX_Word<int> kSymbolKinds[] = {
    {"variable", HxCSymbol::eVariable},
    {"constant", HxCSymbol::eConstant},
    {"function", HxCSymbol::eFunction},
};

HX_WantedName& name(Reading& r) { return r.model.names.back(); }
HX_RareWishes& rare(Reading& r) { return name(r).makeRare(); }
HX_NameRecord& record(Reading& r) { return r.names.back(); }
HX_RareUses& uses(Reading& r) { return r.rareUses[r.names.size() - 1]; }

void beginName(Reading& r, HX_TokenEnd place) {
  r.model.names.emplace_back().index = r.names.size();
  r.names.emplace_back().place = place;
}

void endName(Reading& r, bool isFaulty) {
  record(r).isFaulty = isFaulty;
  if (record(r).id.isGiven())
    name(r).id = r.nameIds.text(record(r).id.entry);
  else
    r.nameIds.isWhole = false;
}

template <auto member>
void setRareText(Reading& r, const Value& value) {
  rare(r).*member = value.nameText();
}

template <auto member>
void setUse(Reading& r, const Value& value) {
  record(r).*member = r.sources.ids.use(value);
}

template <auto member>
void setTimed(Reading& r, const Value& value) {
  uses(r).*member = r.nameIds.use(value);
}

template <auto member, auto ids>
void addListed(Reading& r, const Value& value) {
  (r.*member).push_back({r.names.size() - 1, ids(r).use(value)});
}

HX_Ids& sourceIds(Reading& r) { return r.sources.ids; }
HX_Ids& nameIds(Reading& r) { return r.nameIds; }

template <auto member>
void setPlacement(Reading& r, const Value& value) {
  rare(r).placement.*member = value.boolean;
  uses(r).placement.any = value.place;
}

void setStatic(Reading& r, const Value& value) {
  setPlacement<&HX_Placement::isStatic>(r, value);
  uses(r).placement.isStatic = value.place;
}

void setSection(Reading& r, const Value& value) {
  rare(r).placement.section = value.text;
  uses(r).placement.any = uses(r).placement.section = value.place;
}

void setAlignment(Reading& r, const Value& value) {
  rare(r).placement.alignment = value.integer();
  uses(r).placement.any = uses(r).placement.alignment = value.place;
}

void setInitial(Reading& r, const Value& value) {
  name(r).initial.push_back(value.number);
  record(r).initialPlace = value.place;
}

constexpr HX_FieldBinding kBindings[] = {
    {"name", nullptr, beginName, endName},
    {"name.id",
     [](Reading& r, const Value& v) { record(r).id = r.nameIds.use(v); }},
    {"name.template",
     [](Reading& r, const Value& v) {
       name(r).nameTemplate = r.model.enterTemplate(v.text);
     }},
    {"name.rule",
     [](Reading& r, const Value& v) {
       name(r).rule = r.model.enterRule(v.text);
     }},
    {"name.kind",
     [](Reading& r, const Value& v) {
       name(r).kind = HX_ValueOf(kHxNameKinds, v.text);
     }},
    {"name.source", setUse<&HX_NameRecord::source>},
    {"name.dd", setUse<&HX_NameRecord::dd>},
    {"name.alsoFrom", addListed<&Reading::alsoFrom, sourceIds>},
    {"name.ivBlock", setRareText<&HX_RareWishes::ivBlock>},
    {"name.label",
     [](Reading& r, const Value& v) { name(r).label = v.nameText(); }},
    {"name.x", setRareText<&HX_RareWishes::x>},
    {"name.type",
     [](Reading& r, const Value& v) { record(r).type = r.typeIds.use(v); }},
    {"name.scope",
     [](Reading& r, const Value& v) { record(r).scope = r.scopeIds.use(v); }},
    {"name.retained",
     [](Reading& r, const Value& v) { rare(r).retained |= bitOf(v); }},
    {"name.provisional",
     [](Reading& r, const Value& v) { rare(r).provisional |= bitOf(v); }},
    {"name.modelContext",
     [](Reading& r, const Value& v) { rare(r).modelContext = v.boolean; }},
    {"name.symbol.name",
     [](Reading& r, const Value& v) { uses(r).symbolName = v.nameText(); }},
    {"name.symbol.kind",
     [](Reading& r, const Value& v) {
       uses(r).symbolKind = HX_ValueOf(kSymbolKinds, v.text);
     }},
    {"name.symbol.x",
     [](Reading& r, const Value& v) {
       uses(r).symbolX = v.nameText().cstring();
     }},
    {"name.symbol.type",
     [](Reading& r, const Value& v) { uses(r).symbolType = r.typeIds.use(v); }},
    {"name.substitute", nullptr,
     [](Reading& r, HX_TokenEnd) { rare(r).substitutions.emplace_back(); }},
    {"name.substitute.macro",
     [](Reading& r, const Value& v) {
       rare(r).substitutions.back().macro = v.nameText();
     }},
    {"name.substitute.value",
     [](Reading& r, const Value& v) {
       rare(r).substitutions.back().value = v.nameText();
     }},
    {"name.substitute.case",
     [](Reading& r, const Value& v) {
       rare(r).substitutions.back().kind =
           HX_ValueOf(kSubstitutionKinds, v.text);
     }},
    {"name.task", setTimed<&HX_RareUses::task>},
    {"name.isr", setTimed<&HX_RareUses::isr>},
    {"name.event", setRareText<&HX_RareWishes::event>},
    {"name.counter", setRareText<&HX_RareWishes::counter>},
    {"name.message", setRareText<&HX_RareWishes::message>},
    {"name.messageVariable", setRareText<&HX_RareWishes::messageVariable>},
    {"name.osObject", setRareText<&HX_RareWishes::osObject>},
    {"name.period",
     [](Reading& r, const Value& v) { rare(r).period = v.number; }},
    {"name.offset",
     [](Reading& r, const Value& v) { rare(r).offset = v.number; }},
    {"name.cyclic",
     [](Reading& r, const Value& v) { rare(r).cyclic = v.boolean; }},
    {"name.unit", [](Reading& r, const Value& v) { rare(r).unit = v.text; }},
    {"name.const", setPlacement<&HX_Placement::isConst>},
    {"name.volatile", setPlacement<&HX_Placement::isVolatile>},
    {"name.static", setStatic},
    {"name.section", setSection},
    {"name.alignment", setAlignment},
    {"name.initial", setInitial},
    {"name.lsb", [](Reading& r, const Value& v) { name(r).lsb = v.number; }},
    {"name.zero", [](Reading& r, const Value& v) { name(r).zero = v.number; }},
    {"name.dependsOn", addListed<&Reading::dependsOn, nameIds>},
};

/// Completes the names of the model from the records.
class Resolver {
 public:
  explicit Resolver(Reading& reading)
      : m_Reading(reading), m_Model(reading.model) {}

  void resolve() {
    for (std::size_t i = 0; i < m_Reading.names.size(); ++i) {
      const HX_NameRecord& record = m_Reading.names[i];
      if (!record.isFaulty) resolve(record, m_Model.names[i], usesOf(i));
    }
    for (const HX_ListedUse& also : m_Reading.alsoFrom) {
      HX_WantedName& name = m_Model.names[also.name];
      name.makeRare().alsoFrom.push_back(source(also.use));
    }
    resolveDependencies();
    HX_CheckPlacements(m_Reading);
  }

 private:
  const HX_RareUses& usesOf(std::size_t index) const {
    static const HX_RareUses s_None;
    const auto found = m_Reading.rareUses.find(index);
    return found == m_Reading.rareUses.end() ? s_None : found->second;
  }

  void refuse(const HX_Use& use, const std::string& found,
              const std::string& expected) {
    m_Reading.faults.add(use.place, HX_Quoted(found), expected);
  }

  const HxCSrcRef* source(const HX_Use& use) {
    HX_SourceRecords& sources = m_Reading.sources;
    const int index = sources.ids.find(use);
    return index < 0 ? nullptr : sources.items[static_cast<std::size_t>(index)];
  }

  HX_TypeItem* type(const HX_Use& use) {
    const int index = m_Reading.typeIds.find(use);
    return index < 0 ? nullptr
                     : &m_Model.types[static_cast<std::size_t>(index)];
  }

  const HX_WantedName* otherName(const HX_Use& use) {
    const int index = m_Reading.nameIds.find(use);
    return index < 0 ? nullptr
                     : &m_Model.names[static_cast<std::size_t>(index)];
  }

  // Faults of the other name may cause faults of this use.
  bool isFaulty(const HX_Use& use) {
    const int index = m_Reading.nameIds.find(use);
    return m_Reading.names[static_cast<std::size_t>(index)].isFaulty;
  }

  static std::string textOf(const HX_Ids& ids, const HX_Use& use) {
    return std::string(ids.text(use.entry));
  }

  void resolve(const HX_NameRecord& record, HX_WantedName& name,
               const HX_RareUses& rareUses) {
    name.source = source(record.source);
    name.dd = source(record.dd);
    if (name.dd != nullptr && name.dd->isDd() == nullptr)
      refuse(record.dd, textOf(m_Reading.sources.ids, record.dd),
             "the id of a dictionary object");
    name.type = type(record.type);
    resolveScope(record, name);
    resolveTimed(rareUses.task, HX_NameKind::eTask, name, &HX_RareWishes::task);
    resolveTimed(rareUses.isr, HX_NameKind::eIsr, name, &HX_RareWishes::isr);
    if (rareUses.symbolKind != 0) makeSymbol(rareUses, name);
    if (name.kind == HX_NameKind::eVariable) resolveVariable(record, name);
  }

  void resolveScope(const HX_NameRecord& record, HX_WantedName& name) {
    const int index = m_Reading.scopeIds.find(record.scope);
    name.scope = index < 0 ? m_Model.fileScope
                           : &m_Model.scopes[static_cast<std::size_t>(index)];
    if (index < 0) return;
    const std::string& id = name.scope->id;
    if (name.isFunction() && name.scope->kind != HX_ScopeKind::eFile)
      refuse(record.scope, id, "the id of a file scope for a function");
    if (name.kind == HX_NameKind::eVariable &&
        name.scope->kind == HX_ScopeKind::eFlat)
      refuse(record.scope, id, "the id of a scope that is not flat");
  }

  void resolveTimed(const HX_Use& use, HX_NameKind kind, HX_WantedName& name,
                    const HX_WantedName* HX_RareWishes::*member) {
    const HX_WantedName* timed = otherName(use);
    if (timed == nullptr || isFaulty(use)) return;
    if (timed->kind != kind || timed == &name)
      refuse(use, timed->id,
             "the id of another name of kind " +
                 std::string(HX_WordOf(kHxNameKinds, kind)));
    name.makeRare().*member = timed;
  }

  void makeSymbol(const HX_RareUses& rareUses, HX_WantedName& name) {
    HX_TypeItem* symbolType = type(rareUses.symbolType);
    name.makeRare().symbol = std::make_unique<HxCSymbol>(
        rareUses.symbolName, rareUses.symbolKind,
        symbolType != nullptr ? &symbolType->type : nullptr);
    name.makeRare().symbol->setDollarX(rareUses.symbolX.c_str());
  }

  void resolveVariable(const HX_NameRecord& record, HX_WantedName& name) {
    if (name.type != nullptr)
      name.type = HX_FindDeclarableType(m_Reading, record.type);
    if (name.type != nullptr && m_Reading.areChainsShort &&
        name.type->scalar() != nullptr)
      checkInitial(record, name);
  }

  void resolveDependencies() {
    HX_UseGraph graph(m_Model.names.size());
    for (const HX_ListedUse& listed : m_Reading.dependsOn) {
      const HX_WantedName* first = otherName(listed.use);
      HX_WantedName& name = m_Model.names[listed.name];
      if (first == nullptr || isFaulty(listed.use) ||
          name.kind != HX_NameKind::eVariable)
        continue;
      if (first->kind != HX_NameKind::eVariable) {
        refuse(listed.use, first->id, "the id of a variable");
        continue;
      }
      name.dependsOn.push_back(first);
      graph.add(listed.name, static_cast<std::size_t>(
                                 m_Reading.nameIds.item(listed.use.entry)));
    }
    graph.walk({}, [this](const HX_UseGraph::Circle& circle) {
      m_Model.variableCircle.enter(circle,
                                   m_Reading.names[circle.front()].place);
    });
  }

  void checkInitial(const HX_NameRecord& record, const HX_WantedName& name) {
    if (record.initialPlace == 0) return;
    for (const HX_TypeItem* at = name.type; at != nullptr; at = at->of)
      if (m_Reading.types[at->index].isFaulty) return;
    HX_CheckInitial(m_Reading, record.initialPlace, name);
  }

  Reading& m_Reading;
  HX_Model& m_Model;
};

}  // namespace

HX_Bindings HX_NameBindings() { return {kBindings, std::size(kBindings)}; }

void HX_ResolveNames(HX_ModelReading& reading) { Resolver(reading).resolve(); }
