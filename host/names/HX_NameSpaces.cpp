#include "host/names/HX_NameSpaces.h"

#include <new>

#include "host/base/HX_Text.h"
#include "host/names/HX_CFiles.h"

namespace {

// Inner scopes of different functions may have the same id.
std::string pathOf(const HX_ScopeItem& scope) {
  return scope.parent == nullptr ? scope.id
                                 : pathOf(*scope.parent) + "/" + scope.id;
}

// Compilers define macros and types of these forms, in any number.
constexpr unsigned int kCompilerPatterns =
    HX_ReservedNames::ePatternUnderscoreCapital |
    HX_ReservedNames::ePatternFirstUnderscores;

HX_Change::HxEReasonTag wordReason(HxCNames::tagHxEDictEntryType kind) {
  switch (kind) {
    case HxCNames::eDictBaseTypeName:
      return HX_Change::eBaseType;
    case HxCNames::eDictUserTypeName:
      return HX_Change::eType;
    case HxCNames::eDictCKeyword:
      break;
  }
  return HX_Change::eKeyword;
}

}  // namespace

HX_NameSpaces::HX_NameSpaces(const HX_Model& model,
                             const std::vector<const HX_TypeItem*>& types,
                             HX_NameLock* lock) {
  m_Library.reason = HX_Change::eLibrary;
  m_Macro.reason = HX_Change::eMacro;
  m_Patterns.setPatterns(model.patterns);
  m_CodePatterns.setPatterns(model.patterns | kCompilerPatterns);
  m_Safe.setSignificance(model.significance.internal,
                         model.significance.external,
                         model.significance.ignoresCase);
  for (const HX_ScopeItem& item : model.scopes) {
    HX_SafeNames::Scope* const parent =
        item.parent == nullptr ? nullptr : m_Scopes.at(item.parent);
    HX_SafeNames::Scope* const scope = m_Safe.addScope(pathOf(item), parent);
    if (scope == nullptr) throw std::bad_alloc();
    m_Scopes[&item] = scope;
  }
  HxCNames::boot();
  for (const std::string& word : model.words)
    m_Names.addToKeywordDict(word.c_str(), HxCNames::eDictCKeyword);
  reserveWordsOfCode(model.libraryWords, m_Scopes.at(model.fileScope));
  reserve(types, m_Scopes.at(model.fileScope));
  if (lock != nullptr && !m_Safe.useLock(lock)) throw std::bad_alloc();
}

HX_NameSpaces::~HX_NameSpaces() { HxCNames::shutdown(); }

void HX_NameSpaces::reserveWordsOfCode(
    const std::set<std::string>& libraryWords, HX_SafeNames::Scope* file) {
  for (const std::string& macro : HX_CFiles::ofModel().macros()) {
    m_Macros.insert(macro);
    m_Safe.reserveName(macro.c_str(), file, &m_Macro);
  }
  for (const std::string& word : libraryWords)
    m_Safe.reserveName(word.c_str(), file, &m_Library);
}

// Names of types are given, not formed. Each name is checked before the name
// becomes a reserved word.
void HX_NameSpaces::reserve(const std::vector<const HX_TypeItem*>& types,
                            HX_SafeNames::Scope* file) {
  for (const HX_TypeItem* type : types) {
    for (const HX_TypeItem::Field& field : type->fields)
      check(field.name, field.place);
    for (const HX_TypeItem::Constant& constant : type->values) {
      check(constant.name, constant.place);
      m_Safe.reserveName(constant.name.c_str(), file, nullptr);
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
  HX_Change conflict;
  switch (HxCNames::checkCVariableName(name.c_str())) {
    case HxCNames::eVariableNameCKeyword:
      conflict.reason = HX_Change::eKeyword;
      break;
    case HxCNames::eVariableNameBaseType:
      conflict.reason = HX_Change::eBaseType;
      break;
    case HxCNames::eVariableNameUserType:
      conflict.reason = HX_Change::eType;
      break;
    default:
      if (m_Macros.count(name) != 0)
        conflict.reason = HX_Change::eMacro;
      else if (const unsigned int pattern = HX_ReservedNames::matching(
                   name.c_str(), kCompilerPatterns, true))
        conflict = {HX_Change::ePattern, nullptr,
                    HX_ReservedNames::patternName(pattern)};
      else
        return;
  }
  m_ReservedUses.push_back({name, place, conflict});
}

bool HX_NameSpaces::define(const HX_WantedName& name, HxCCIdentifier& id,
                           HX_SafeName& safe) {
  Symbol& symbol =
      m_Symbols.emplace_back(KyCXString(), HxCSymbol::eVariable,
                             name.type != nullptr ? &name.type->type : nullptr);
  symbol.owner = &name;
  HX_SafeNames::Request request;
  request.scope = m_Scopes.at(name.scope);
  request.isExternal = name.scope->kind == HX_ScopeKind::eFile;
  request.symbol = &symbol;
  request.item = name.id;
  const bool isCode = name.kind == HX_NameKind::eVariable || name.isFunction();
  m_Safe.setReserved(isCode ? &m_CodePatterns : &m_Patterns);
  const bool isDefined = m_Safe.define(id, request, safe);
  if (!isDefined) m_Symbols.pop_back();
  if (safe.stepCount() > 0 &&
      safe.step(safe.stepCount() - 1).kind == HX_SafeName::eNoMemory)
    throw std::bad_alloc();
  return isDefined;
}

HX_Change HX_NameSpaces::changeOf(const HX_SafeName::Step& step) {
  const auto other = [&] { return std::string(step.other); };
  switch (step.kind) {
    case HX_SafeName::eIdentifier:
      return {HX_Change::eMadeIdentifier};
    case HX_SafeName::eShortened:
      return {HX_Change::eShortened};
    case HX_SafeName::eLocked:
      return {HX_Change::eLocked};
    case HX_SafeName::eRewritten:
      return {HX_Change::eRewritten};
    case HX_SafeName::eKeyword:
      return {wordReason(step.wordKind)};
    case HX_SafeName::eReserved:
      return {HX_Change::eKeyword};
    case HX_SafeName::ePattern:
      return {HX_Change::ePattern, nullptr, step.reason};
    case HX_SafeName::eTaken:
      if (step.symbol == nullptr) return {HX_Change::eTakenByConstant};
      return {static_cast<const Symbol*>(step.symbol)->reason,
              static_cast<const Symbol*>(step.symbol)->owner};
    case HX_SafeName::eIndistinct:
      return {HX_Change::eIndistinct,
              step.symbol == nullptr
                  ? nullptr
                  : static_cast<const Symbol*>(step.symbol)->owner,
              other()};
    case HX_SafeName::eHeld:
      return {HX_Change::eHeld, nullptr, other()};
    case HX_SafeName::eRetired:
      return {HX_Change::eRetired, nullptr, other()};
    case HX_SafeName::eNoVariant:
      return {HX_Change::eNoVariant};
    default:
      return {};
  }
}

bool HX_NameSpaces::isConflict(const HX_Change& change) {
  switch (change.reason) {
    case HX_Change::eNone:
    case HX_Change::eMadeIdentifier:
    case HX_Change::eShortened:
    case HX_Change::eRewritten:
    case HX_Change::eLocked:
      return false;
    default:
      return true;
  }
}

bool HX_NameSpaces::isReported(const HX_Change& conflict) {
  return conflict.reason == HX_Change::eKeyword ||
         conflict.reason == HX_Change::eBaseType ||
         conflict.reason == HX_Change::eType;
}
