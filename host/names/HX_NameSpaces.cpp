#include "host/names/HX_NameSpaces.h"

#include "platform/messages/HX_MessageHandler.h"

namespace {

// Messages 408 to 410 report a reserved word of one of these kinds.
constexpr int kFirstMessage = 408;
constexpr const char* kWordKinds[] = {"keyword", "base type name", "type name"};

}  // namespace

HX_NameSpaces::HX_NameSpaces(const HX_Model& model,
                             const std::vector<const HX_TypeItem*>& types) {
  m_Ids.boot();
  for (const HX_ScopeItem& item : model.scopes) {
    Space& space = m_Spaces.try_emplace(&item, &m_Ids).first->second;
    if (item.kind == "file") space.scoped.setScope(m_File.newEnv());
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

// The names of types are not formed but given; each is checked before it
// becomes a reserved word itself.
void HX_NameSpaces::reserve(const std::vector<const HX_TypeItem*>& types) {
  for (const HX_TypeItem* type : types) {
    for (const auto& [field, fieldType] : type->fields)
      m_Names.isStringValidCVariableName(field.c_str());
    for (const auto& [constant, value] : type->values) {
      m_Names.isStringValidCVariableName(constant.c_str());
      m_File.defineString(constant.c_str());
    }
    if (!type->isNameless)
      m_Names.isStringValidCVariableName(type->name.c_str());
  }
  for (const HX_TypeItem* type : types) {
    if (!type->isNameless)
      m_Names.addToKeywordDict(type->name.c_str(),
                               type->kind == "base"
                                   ? HxCNames::eDictBaseTypeName
                                   : HxCNames::eDictUserTypeName);
  }
}

std::string HX_NameSpaces::define(HX_Name& name, KyCXString& text,
                                  bool changeable) {
  Space& space = m_Spaces.at(name.scope);
  std::string conflict = conflictOf(space, text);
  name.isDefined = conflict.empty() || changeable;
  if (!name.isDefined) return conflict;

  if (!conflict.empty()) deriveFreeName(space, text);
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

// Empty for a free name. The library reports reserved words and nothing else.
std::string HX_NameSpaces::conflictOf(Space& space, const KyCXString& text) {
  const auto& messages = HX_MessageHandler::instance().messages();
  const std::size_t before = messages.size();
  m_Names.isStringValidCVariableName(text);
  if (messages.size() > before)
    return kWordKinds[messages.back().row - kFirstMessage];

  const HX_Name* owner = nullptr;
  if (space.scoped.getScope() == nullptr) {
    const auto found = space.owners.find(text.cstring());
    if (found == space.owners.end()) return {};
    owner = found->second;
  } else {
    if (!space.scoped.stringInEnv(text)) return {};
    HxCSymbol* symbol = nullptr;
    if (!space.scoped.stringInEnv(text, symbol)) return "taken by a constant";
    owner = static_cast<Symbol*>(symbol)->owner;
  }
  return "taken by '" + owner->id + "'";
}

// A flat set derives variants by itself; scopes say only whether one is free.
// What was reported about reserved words has no object any more.
void HX_NameSpaces::deriveFreeName(Space& space, KyCXString& text) {
  KyCXString base = text;
  int& suffix = space.nextSuffix[base.cstring()];
  do {
    text = base;
    if (space.scoped.getScope() == nullptr) {
      space.flat.add(base);  // a reserved word is not there yet
      space.flat.addUnique(text);
    } else {
      m_Names.appendSuffix(text, suffix++);
    }
  } while (!conflictOf(space, text).empty());
  HX_MessageHandler::instance().clear();
}
