#include "host/names/HX_NameSpaces.h"

#include "host/base/HX_Text.h"

HX_NameSpaces::HX_NameSpaces(const HX_Model& model,
                             const std::vector<const HX_TypeItem*>& types) {
  m_Ids.boot();
  for (const HX_ScopeItem& item : model.scopes) {
    Space& space = m_Spaces.try_emplace(&item, &m_Ids).first->second;
    if (item.kind == HX_ScopeKind::eFile)
      space.scoped.setScope(m_File.newEnv());
    if (item.parent != nullptr)
      space.scoped.newScope(m_Spaces.at(item.parent).scoped.getScope());
  }
  HxCNames::boot();
  for (const std::string& word : model.words)
    m_Names.addToKeywordDict(word.c_str(), HxCNames::eDictCKeyword);
  reserve(types);
}

HX_NameSpaces::~HX_NameSpaces() {
  delete m_File.getScope();
  HxCNames::shutdown();
  m_Ids.shutdown();
}

// Names of types are given, not formed. Each name is checked before the name
// becomes a reserved word.
void HX_NameSpaces::reserve(const std::vector<const HX_TypeItem*>& types) {
  for (const HX_TypeItem* type : types) {
    for (const HX_TypeItem::Field& field : type->fields)
      check(field.name, field.place);
    for (const HX_TypeItem::Constant& constant : type->values) {
      check(constant.name, constant.place);
      m_File.defineString(constant.name.c_str());
    }
    if (!type->isNameless) check(type->name, type->place);
  }
  for (const HX_TypeItem* type : types) {
    if (!type->isNameless)
      m_Names.addToKeywordDict(type->name.c_str(),
                               type->kind == HX_TypeKind::eBase
                                   ? HxCNames::eDictBaseTypeName
                                   : HxCNames::eDictUserTypeName);
  }
}

void HX_NameSpaces::check(const std::string& name, HX_TokenEnd place) {
  const HX_Change conflict{reservedAs(name.c_str())};
  if (conflict.reason != HX_Change::eNone)
    m_ReservedUses.push_back({name, place, conflict});
}

HX_Change HX_NameSpaces::define(const HX_WantedName& name, KyCXString& text,
                                bool changeable) {
  Space& space = m_Spaces.at(name.scope);
  const HX_Change conflict = conflictOf(space, text);
  const bool isFree = conflict.reason == HX_Change::eNone;
  if (!isFree && !changeable) {
    if (isReported(conflict)) m_Names.isStringValidCVariableName(text);
    return conflict;
  }
  if (!isFree) deriveFreeName(space, text);
  if (space.scoped.getScope() == nullptr) {
    space.flat.add(text);
    space.owners.emplace(text.cstring(), &name);
    return conflict;
  }
  Symbol& symbol =
      m_Symbols.emplace_back(text, HxCSymbol::eVariable,
                             name.type != nullptr ? &name.type->type : nullptr);
  symbol.owner = &name;
  space.scoped.defineString(text, &symbol);
  return conflict;
}

bool HX_NameSpaces::isReported(const HX_Change& conflict) {
  return conflict.reason == HX_Change::eKeyword ||
         conflict.reason == HX_Change::eBaseType ||
         conflict.reason == HX_Change::eType;
}

HX_Change HX_NameSpaces::conflictOf(Space& space, const KyCXString& text) {
  const HX_Change::HxEReasonTag reserved = reservedAs(text);
  if (reserved != HX_Change::eNone) return {reserved};
  if (space.scoped.getScope() == nullptr) {
    const auto found = space.owners.find(text.cstring());
    if (found == space.owners.end()) return {};
    return {HX_Change::eTakenByName, found->second};
  }
  if (!space.scoped.stringInEnv(text)) return {};
  HxCSymbol* symbol = nullptr;
  if (!space.scoped.stringInEnv(text, symbol))
    return {HX_Change::eTakenByConstant};
  return {HX_Change::eTakenByName, static_cast<Symbol*>(symbol)->owner};
}

HX_Change::HxEReasonTag HX_NameSpaces::reservedAs(const KyCXString& text) {
  constexpr int kFirstMessage = 17056;  // the next two have the next numbers
  constexpr HX_Change::HxEReasonTag kReasons[] = {
      HX_Change::eKeyword, HX_Change::eBaseType, HX_Change::eType};
  std::vector<HX_Finding> reported;
  {
    const HX_MessageCollector collector(reported);
    m_Names.isStringValidCVariableName(text);
  }
  if (reported.empty()) return HX_Change::eNone;
  return kReasons[reported[0].id - kFirstMessage];
}

// A flat set derives variants on its own. Scopes only tell whether a variant is
// free.
void HX_NameSpaces::deriveFreeName(Space& space, KyCXString& text) {
  KyCXString base = text;
  int& suffix = space.nextSuffix[base.cstring()];
  do {
    text = base;
    if (space.scoped.getScope() == nullptr) {
      space.flat.add(base);  // absent so far if the text is a reserved word
      space.flat.addUnique(text);
    } else {
      m_Names.appendSuffix(text, suffix++);
    }
  } while (conflictOf(space, text).reason != HX_Change::eNone);
}
