#include "host/HX_NameSpaces.h"

namespace {

std::string takenBy(const std::string& id) { return "taken by '" + id + "'"; }

}  // namespace

HX_NameSpaces::HX_NameSpaces(
    const std::vector<std::unique_ptr<HX_ScopeItem>>& scopes,
    const HX_Keywords& keywords)
    : m_Keywords(keywords) {
  m_Ids.boot();
  for (const auto& item : scopes) {  // parents first
    auto space = std::make_unique<Space>(&m_Ids);
    space->isFlat = item->kind == "flat";
    const auto parent = m_Spaces.find(item->parent);
    if (space->isFlat) {
      for (const auto& [word, type] : keywords.words()) {
        KyCXString text(word.c_str());
        space->flat.add(text);
      }
    } else if (parent == m_Spaces.end() || parent->second->isFlat) {
      m_Roots.push_back(space->scoped.newEnv());
    } else {
      space->scoped.newScope(parent->second->scoped.getScope());
    }
    m_Spaces.emplace(item.get(), std::move(space));
  }
}

HX_NameSpaces::~HX_NameSpaces() {
  for (HxCNameSpace::Scope* root : m_Roots) delete root;
  m_Ids.shutdown();
}

HX_NameSpaces::Result HX_NameSpaces::define(const HX_NameItem& item,
                                            KyCXString& name, bool changeable) {
  Space& space = *m_Spaces.at(item.scope);
  Result result{true, conflictOf(space, name)};
  if (!result.conflict.empty()) {
    result.isDefined = changeable;
    if (!changeable) return result;
    deriveFreeName(space, name);
  } else if (space.isFlat) {
    space.flat.add(name);
  }

  if (space.isFlat) {
    space.owners.emplace(name.cstring(), item.id);
    return result;
  }
  m_Symbols.push_back(std::make_unique<HX_HostSymbol>(
      name, HxCSymbol::eVariable,
      item.type != nullptr ? &item.type->type : nullptr));
  m_Symbols.back()->id = item.id;
  space.scoped.defineString(name, m_Symbols.back().get());
  return result;
}

// Empty for a free name.
std::string HX_NameSpaces::conflictOf(Space& space,
                                      const KyCXString& name) const {
  if (const char* kind = m_Keywords.isReserved(name.cstring())) return kind;
  if (space.isFlat) {
    const auto found = space.owners.find(name.cstring());
    return found == space.owners.end() ? std::string() : takenBy(found->second);
  }
  if (!space.scoped.stringInEnv(name)) return {};
  HxCSymbol* symbol = nullptr;
  if (!space.scoped.stringInEnv(name, symbol)) return "taken by a constant";
  return takenBy(static_cast<HX_HostSymbol*>(symbol)->id);
}

// A flat set derives variants by itself; scopes say only whether one is free.
void HX_NameSpaces::deriveFreeName(Space& space, KyCXString& name) {
  if (space.isFlat) return space.flat.addUnique(name);
  const KyCXString base = name;
  int& suffix = space.nextSuffix[base.cstring()];
  do {
    name = base;
    m_Names.appendSuffix(name, suffix++);
  } while (!conflictOf(space, name).empty());
}

void HX_NameSpaces::takeInFiles(const std::string& name) {
  for (const auto& [item, space] : m_Spaces) {
    if (item->kind == "file") space->scoped.defineString(name.c_str());
  }
}
