#include "SafeNames/HX_SafeNames.h"

#include <cstring>
#include <new>
#include <utility>

#include "Control/HX_Memory.h"
#include "NameSpace/HxCObjectEnvironment.h"
#include "NameSpace/HxCXStringIdServer.h"
#include "SafeNames/HX_NameLock.h"
#include "SafeNames/HX_ReservedNames.h"
#include "SafeNames/implSafeNames/HX_TextLines.h"
#include "SafeNames/implSafeNames/HX_VariantCounts.h"
#include "implContainers/HX_HashTable.h"
#include "implContainers/HX_PlainArray.h"
#include "implContainers/HX_TextArena.h"
#include "platform/model/HX_Options.h"
#include "platform/model/HxCGlobal.h"
#include "platform/model/HxCSymbol.h"

namespace {

constexpr auto kActual = HxCCIdentifier::eActualName;
constexpr char kRewritePrefix[] = "n_";

// Answers about words of the keyword dictionary.
struct WordRow {
  HxCNames::HxEVariableNameTag answer;
  HxCNames::tagHxEDictEntryType kind;
};
constexpr WordRow kWords[] = {
    {HxCNames::eVariableNameCKeyword, HxCNames::eDictCKeyword},
    {HxCNames::eVariableNameBaseType, HxCNames::eDictBaseTypeName},
    {HxCNames::eVariableNameUserType, HxCNames::eDictUserTypeName},
    {HxCNames::eVariableNameOtherWord, HxCNames::eDictCKeyword}};

// Value of a key in an environment.
struct Holder : HX_Allocated {
  const char* text;  // the whole name
  HxCSymbol* symbol;
  int lockPosition;  // of the item that the name is held for; -1: defined
};

using Environment = HxCObjectEnvironment<Holder*>;

// Why a name cannot be defined.
struct Conflict {
  bool isFree = true;
  HX_SafeName::HxEStepTag kind = HX_SafeName::eTaken;
  const char* reason = nullptr;
  const char* other = nullptr;
  const HxCSymbol* symbol = nullptr;
  HxCNames::tagHxEDictEntryType wordKind = HxCNames::eDictCKeyword;
};

Conflict conflict(HX_SafeName::HxEStepTag kind, const char* reason = nullptr) {
  Conflict found;
  found.isFree = false;
  found.kind = kind;
  found.reason = reason;
  return found;
}

// Longest length of names that may change; 0 without a limit.
int longestLength() {
  return HxCGlobal::getOptions()->getLimitVariableNameLength()
             ? HxCSymbol::sm_MaxNameLength
             : 0;
}

// Head and end of the text with one '_' between, and no further '_' beside.
KyCXString shortened(const KyCXString& text, int limit) {
  const int length = text.length();
  if (limit <= 0 || length <= limit) return text;
  int head = limit / 2;
  int tail = length - (limit - head - 1);
  while (head > 0 && text[head - 1] == '_') --head;
  while (tail < length && text[tail] == '_') ++tail;
  KyCXString result = text.head(head);
  result += "_";
  result += text.sub(tail, length - 1);
  return result;
}

// A single '_' for a run.
KyCXString withoutRuns(const KyCXString& text) {
  KyCXString result;
  for (int i = 0; i < text.length(); ++i)
    if (text[i] != '_' || i == 0 || text[i - 1] != '_')
      result += text.sub(i, i);
  return result;
}

// A text that matches none of the patterns, but for "_t" at the end, which a
// suffix hides.
KyCXString rewritten(const KyCXString& text, unsigned int patterns,
                     bool isAtFileScope, int limit) {
  using Names = HX_ReservedNames;
  constexpr unsigned int kLeading = Names::ePatternUnderscoreCapital |
                                    Names::ePatternFirstUnderscores |
                                    Names::ePatternFileUnderscore;
  const unsigned int fronts =
      patterns & ~static_cast<unsigned int>(Names::ePatternType);
  KyCXString result =
      (patterns & Names::ePatternUnderscores) != 0 ? withoutRuns(text) : text;
  while (Names::matching(result, patterns & kLeading, isAtFileScope) != 0)
    result = result.sub(1, result.length() - 1);
  if (!result.isValidCIdentifier() ||
      Names::matching(result, fronts, isAtFileScope) != 0)
    result = KyCXString(kRewritePrefix) + result;
  return shortened(result, limit);
}

}  // namespace

class HX_SafeNames::Scope : public HX_Allocated {
 public:
  Environment* environment = nullptr;  // of a root owned, else by the parent
  bool isRoot = true;
  std::string_view name;
  // A variant may be taken for external names only.
  hx_detail::HX_VariantCounts counts;
  hx_detail::HX_VariantCounts externalCounts;
};

struct HX_SafeNames::Content : HX_Allocated {
  Content() { texts.boot(); }
  Content(const Content&) = delete;
  Content& operator=(const Content&) = delete;
  ~Content() {
    for (const Scope* scope : scopes) {
      if (scope->isRoot) delete scope->environment;
      delete scope;
    }
    texts.shutdown();
  }

  Scope* addScope(std::string_view name, Scope* parent);
  Scope* findScope(std::string_view name) const;
  void holdAll();
  void releaseAll();
  bool create(HxCCIdentifier& id, HX_DataType* type, const Request& request,
              HX_SafeName& result);
  bool define(HxCCIdentifier& id, const Request& request, HX_SafeName& result);

  void fit(HxCCIdentifier& id, bool mayChange, HX_SafeName& result);
  bool settle(KyCXString& text, bool mayChange, const Request& request,
              HX_SafeName& result);
  bool takeLocked(KyCXString& text, bool mayChange, const Request& request,
                  HX_SafeName& result);
  bool derive(KyCXString& text, const Request& request, HX_SafeName& result);
  void enter(const KyCXString& text, const KyCXString& wanted,
             const Request& request);

  Conflict conflictOf(const KyCXString& text, const Request& request);
  Conflict reservedBy(const KyCXString& text, bool isAtFileScope) const;
  Conflict takenBy(const Environment& environment, int key,
                   const KyCXString& text, int owner);
  Conflict conflictWith(const Holder& holder, const KyCXString& text) const;
  bool place(Environment& environment, int key, const char* text,
             HxCSymbol* symbol, int lockPosition);
  void noteInLock(const KyCXString& text, const KyCXString& wanted,
                  const Request& request);

  unsigned int patterns() const {
    return reserved == nullptr ? 0 : reserved->patterns();
  }
  int variantLimit(bool isExternal) const;
  int idOf(const KyCXString& text);
  int keyOf(const KyCXString& text, int count);

  const HX_ReservedNames* reserved = nullptr;
  HX_NameLock* lock = nullptr;
  // By position in the lock: hold of the present name; null for none.
  HX_PlainArray<Holder*> held;
  int position = -1;          // of the current item in the lock
  Holder* claimed = nullptr;  // hold that the current item takes
  int checkedKey = 0;         // of the last text checked, in scopes
  int checkedOuterKey = 0;    // among external names
  int internalCount = 0;
  int externalCount = 0;
  bool foldsCase = false;
  HX_PlainArray<Scope*> scopes;            // owned
  HX_HashTable<int, Scope*> scopesByName;  // by the hash of the name
  HX_TextArena scopeNames;
  HxCXStringIdServer texts;  // names, their significant parts, heads
  Environment externals{nullptr};
  HxCNames naming;
};

// --- Result ---

void HX_SafeName::clear() {
  m_Text = KyCXString();
  m_Wanted = KyCXString();
  m_IsComplete = true;
  m_IsDefined = false;
  m_StepCount = 0;
}

// No road has more steps than the array; the last step is overwritten at worst.
HX_SafeName::Step& HX_SafeName::add(HxEStepTag kind, const KyCXString& text) {
  Step& step = m_Steps[m_StepCount < kMaxSteps ? m_StepCount++ : kMaxSteps - 1];
  step.kind = kind;
  step.text = text;
  step.reason = nullptr;
  step.symbol = nullptr;
  step.other = nullptr;
  step.wordKind = HxCNames::eDictCKeyword;
  return step;
}

// --- Scopes ---

HX_SafeNames::HX_SafeNames() : m_pContent(new Content) {}

HX_SafeNames::~HX_SafeNames() { delete m_pContent; }

void HX_SafeNames::setReserved(const HX_ReservedNames* reserved) {
  if (m_pContent != nullptr) m_pContent->reserved = reserved;
}

void HX_SafeNames::setSignificance(int internal, int external, bool foldsCase) {
  if (m_pContent == nullptr) return;
  m_pContent->internalCount = internal;
  m_pContent->externalCount = external;
  m_pContent->foldsCase = foldsCase;
}

HX_SafeNames::Scope* HX_SafeNames::addScope(std::string_view name,
                                            Scope* parent) {
  return m_pContent == nullptr ? nullptr : m_pContent->addScope(name, parent);
}

HX_SafeNames::Scope* HX_SafeNames::Content::addScope(std::string_view name,
                                                     Scope* parent) {
  Environment* const outer = parent == nullptr ? nullptr : parent->environment;
  auto* const scope = new Scope;
  auto* const environment = new Environment(outer);
  const char* const kept = scopeNames.add(name.data(), name.size());
  bool isMade = scope != nullptr && environment != nullptr && kept != nullptr;
  if (isMade && scopes.append(scope)) {
    scope->name = {kept, name.size()};
    scope->environment = environment;
    scope->isRoot = outer == nullptr;
    const int key = hx_detail::keyOf(name);
    isMade = (outer == nullptr || outer->addChild(environment));
    if (isMade && scopesByName.add(key, scope) != nullptr) return scope;
    scopes.dropLast();
    if (isMade && outer != nullptr) {
      delete scope;  // the outer environment keeps the empty inner one
      return nullptr;
    }
  }
  delete environment;
  delete scope;
  return nullptr;
}

HX_SafeNames::Scope* HX_SafeNames::Content::findScope(
    std::string_view name) const {
  const auto* const slot = scopesByName.find(
      hx_detail::keyOf(name),
      [&](const Scope* scope) { return scope->name == name; });
  return slot == nullptr ? nullptr : slot->value;
}

// --- Names that are taken ---

// Throws std::bad_alloc.
int HX_SafeNames::Content::idOf(const KyCXString& text) {
  int id = 0;
  if (!texts.findOrAdd(text, id)) throw std::bad_alloc();
  return id;
}

// The id of the characters that have to differ.
int HX_SafeNames::Content::keyOf(const KyCXString& text, int count) {
  const bool isWhole = count <= 0 || text.length() <= count;
  if (isWhole && !foldsCase) return idOf(text);
  return idOf(hx_detail::significantPart(text, count, foldsCase));
}

// Enters a name, or turns the hold of the item at \p lockPosition into the
// name. RETURNS: false if the key stands for anything else.
bool HX_SafeNames::Content::place(Environment& environment, int key,
                                  const char* text, HxCSymbol* symbol,
                                  int lockPosition) {
  if (Holder* const holder = environment.lookupInScope(key)) {
    if (holder->lockPosition < 0 || holder->lockPosition != lockPosition)
      return false;
    holder->text = text;
    holder->symbol = symbol;
    holder->lockPosition = -1;
    return true;
  }
  auto* const holder = new Holder;
  if (holder == nullptr) throw std::bad_alloc();
  holder->text = text;
  holder->symbol = symbol;
  holder->lockPosition = -1;
  if (environment.defineKey(key, holder)) return true;
  delete holder;
  throw std::bad_alloc();
}

Conflict HX_SafeNames::Content::conflictWith(const Holder& holder,
                                             const KyCXString& text) const {
  Conflict found = conflict(HX_SafeName::eTaken);
  found.symbol = holder.symbol;
  found.other = holder.text;
  if (holder.lockPosition >= 0) {
    const HX_NameLock::Entry& entry = lock->entry(holder.lockPosition);
    const bool isFormer = entry.name != holder.text || entry.retiredRuns >= 0;
    found.kind = isFormer ? HX_SafeName::eRetired : HX_SafeName::eHeld;
    found.other = entry.item.data();
  } else if (std::strcmp(holder.text, text.cstring()) != 0) {
    found.kind = HX_SafeName::eIndistinct;
  }
  return found;
}

// A name held for the item at \p owner is free for that item.
Conflict HX_SafeNames::Content::takenBy(const Environment& environment, int key,
                                        const KyCXString& text, int owner) {
  const Holder* const holder = environment.lookupInEnv(key);
  if (holder == nullptr) return {};
  if (holder->lockPosition >= 0 && holder->lockPosition == owner) return {};
  return conflictWith(*holder, text);
}

Conflict HX_SafeNames::Content::reservedBy(const KyCXString& text,
                                           bool isAtFileScope) const {
  if (text.isEmpty()) return conflict(HX_SafeName::eEmpty);
  const auto answer = HxCNames::checkCVariableName(text);
  for (const WordRow& row : kWords) {
    if (row.answer != answer) continue;
    Conflict found = conflict(HX_SafeName::eKeyword);
    found.wordKind = row.kind;
    return found;
  }
  if (reserved == nullptr) return {};
  const auto reservation = reserved->find(text, isAtFileScope);
  if (!reservation) return {};
  if (reservation.profile != nullptr)
    return conflict(HX_SafeName::eReserved, reservation.profile);
  return conflict(HX_SafeName::ePattern,
                  HX_ReservedNames::patternName(reservation.pattern));
}

// Leaves the keys of \p text in checkedKey and checkedOuterKey.
Conflict HX_SafeNames::Content::conflictOf(const KyCXString& text,
                                           const Request& request) {
  Conflict found = reservedBy(text, request.scope->isRoot);
  if (!found.isFree) return found;
  checkedKey = keyOf(text, internalCount);
  found = takenBy(*request.scope->environment, checkedKey, text, position);
  if (!found.isFree || !request.isExternal) return found;
  checkedOuterKey = keyOf(text, externalCount);
  return takenBy(externals, checkedOuterKey, text, position);
}

bool HX_SafeNames::reserveName(const KyCXString& name, Scope* scope,
                               HxCSymbol* symbol) {
  if (m_pContent == nullptr) return false;
  Content& content = *m_pContent;
  return HX_WithinMemory(false, [&] {
    const int key = content.keyOf(name, content.internalCount);
    if (!content.takenBy(*scope->environment, key, name, -1).isFree)
      return false;
    return content.place(*scope->environment, key,
                         content.texts.getString(content.idOf(name)), symbol,
                         -1);
  });
}

// --- Lock ---

bool HX_SafeNames::useLock(HX_NameLock* lock) {
  if (m_pContent == nullptr) return false;
  m_pContent->lock = lock;
  lock->beginRun();
  if (HX_WithinMemory([&] { m_pContent->holdAll(); })) return true;
  m_pContent->releaseAll();
  m_pContent->lock = nullptr;
  return false;
}

// Names of a lock may exclude names of the same lock after a change of the
// scopes. The later name is not held, and the item gets a new name.
void HX_SafeNames::Content::holdAll() {
  // The text of the lock lives as long as the hold.
  const auto hold = [this](Environment& environment, const KyCXString& text,
                           int count, const char* kept, int at) -> Holder* {
    const int key = keyOf(text, count);
    if (environment.lookupInEnv(key) != nullptr) return nullptr;
    place(environment, key, kept, nullptr, -1);
    Holder* const holder = environment.lookupInScope(key);
    holder->lockPosition = at;
    return holder;
  };
  while (held.size() < static_cast<unsigned int>(lock->size()))
    if (!held.append(nullptr)) throw std::bad_alloc();
  const Scope* last = nullptr;
  lock->forEachHeldName([&](std::string_view name, std::string_view scopeName,
                            bool isExternal, int at) {
    const Scope* const scope = last != nullptr && last->name == scopeName
                                   ? last
                                   : findScope(scopeName);
    if (scope == nullptr) return;
    last = scope;
    const KyCXString text(name.data());
    Holder* const holder =
        hold(*scope->environment, text, internalCount, name.data(), at);
    if (name.data() == lock->entry(at).name.data())
      held[static_cast<unsigned int>(at)] = holder;
    if (isExternal) hold(externals, text, externalCount, name.data(), at);
  });
}

// Needs no memory: every key exists or was never made.
void HX_SafeNames::Content::releaseAll() {
  const auto release = [this](Environment& environment, const KyCXString& text,
                              int count) {
    const int key = keyOf(text, count);
    Holder* const holder = environment.lookupInScope(key);
    if (holder == nullptr || holder->lockPosition < 0) return;
    environment.removeKey(key);
    delete holder;
  };
  lock->forEachHeldName([&](std::string_view name, std::string_view scopeName,
                            bool isExternal, int) {
    Scope* const scope = findScope(scopeName);
    HX_WithinMemory([&] {
      const KyCXString text(name.data());
      if (scope == nullptr) return;
      release(*scope->environment, text, internalCount);
      if (isExternal) release(externals, text, externalCount);
    });
  });
}

// True if \p text has become the name of the lock. A name that is held still is
// free: nothing else can have been defined in the environment of the hold.
bool HX_SafeNames::Content::takeLocked(KyCXString& text, bool mayChange,
                                       const Request& request,
                                       HX_SafeName& result) {
  if (position < 0 || held.size() <= static_cast<unsigned int>(position))
    return false;
  Holder* const holder = held[static_cast<unsigned int>(position)];
  const HX_NameLock::Entry& entry = lock->entry(position);
  if (holder == nullptr || holder->lockPosition != position ||
      entry.wanted != text.cstring() || entry.scope != request.scope->name ||
      entry.isExternal != request.isExternal)
    return false;
  const bool isWanted = entry.name == entry.wanted;
  const KyCXString locked = isWanted ? text : KyCXString(entry.name.data());
  const int limit = longestLength();
  if (!isWanted && (!mayChange || (limit > 0 && locked.length() > limit)))
    return false;
  if (!reservedBy(locked, request.scope->isRoot).isFree) return false;
  if (request.isExternal) {
    checkedOuterKey = keyOf(locked, externalCount);
    if (!takenBy(externals, checkedOuterKey, locked, position).isFree)
      return false;
  }
  claimed = holder;
  if (isWanted) return true;
  result.add(HX_SafeName::eLocked, locked);
  text = locked;
  return true;
}

// --- Forming ---

int HX_SafeNames::Content::variantLimit(bool isExternal) const {
  int limit = longestLength();
  for (const int count : {internalCount, isExternal ? externalCount : 0})
    if (count > 0 && (limit == 0 || count < limit)) limit = count;
  return limit;
}

// A C identifier that is not too long, in \p id.
void HX_SafeNames::Content::fit(HxCCIdentifier& id, bool mayChange,
                                HX_SafeName& result) {
  const KyCXString expanded = id.getCookedName(kActual);
  id.makeCIdentifier();
  const KyCXString whole = id.getCookedName(kActual);
  if (!(whole == expanded)) result.add(HX_SafeName::eIdentifier, whole);
  id.adaptSize();
  const int limit = longestLength();
  const bool isShortened = !(id.getCookedName(kActual) == whole);
  if (isShortened) {
    // The two '_' of adaptSize() must not match a pattern.
    const unsigned int runs =
        patterns() & HX_ReservedNames::ePatternUnderscores;
    if (runs != 0 && HX_ReservedNames::matching(whole, runs, false) == 0)
      id.setCookedName(shortened(whole, limit), kActual);
    result.add(HX_SafeName::eShortened, id.getCookedName(kActual));
  } else if (!mayChange && limit > 0 && whole.length() > limit) {
    result.add(HX_SafeName::eTooLong, whole);
  }
}

// Notes \p found and its text in \p result.
static void report(const Conflict& found, const KyCXString& text,
                   HX_SafeName::Step& step) {
  step.kind = found.kind;
  step.text = text;
  step.reason = found.reason;
  step.other = found.other;
  step.symbol = found.symbol;
  step.wordKind = found.wordKind;
}

// Makes \p text free; false if that is not possible or not allowed.
bool HX_SafeNames::Content::settle(KyCXString& text, bool mayChange,
                                   const Request& request,
                                   HX_SafeName& result) {
  if (takeLocked(text, mayChange, request, result)) return true;
  Conflict found = conflictOf(text, request);
  if (found.isFree) return true;
  report(found, text, result.add(found.kind, text));
  if (!mayChange || found.kind == HX_SafeName::eEmpty) return false;
  const KyCXString other =
      rewritten(text, patterns(), request.scope->isRoot, longestLength());
  if (!(other == text)) {
    text = other;
    result.add(HX_SafeName::eRewritten, text);
    found = conflictOf(text, request);
    if (found.isFree) return true;
    report(found, text, result.add(found.kind, text));
  }
  return derive(text, request, result);
}

bool HX_SafeNames::Content::derive(KyCXString& text, const Request& request,
                                   HX_SafeName& result) {
  // The '_' of a suffix must not extend a run of '_'.
  const bool joins =
      (patterns() & (HX_ReservedNames::ePatternUnderscores |
                     HX_ReservedNames::ePatternFirstUnderscores)) != 0;
  const bool isFound = hx_detail::deriveVariant(
      text, variantLimit(request.isExternal), joins,
      request.isExternal ? request.scope->externalCounts
                         : request.scope->counts,
      [&](const KyCXString& head) { return idOf(head); },
      [&](const KyCXString& variant) {
        return conflictOf(variant, request).isFree;
      });
  result.add(isFound ? HX_SafeName::eDerived : HX_SafeName::eNoVariant, text);
  return isFound;
}

// Throws std::bad_alloc, with no name entered.
void HX_SafeNames::Content::enter(const KyCXString& text,
                                  const KyCXString& wanted,
                                  const Request& request) {
  Environment& environment = *request.scope->environment;
  // The last check was about this text.
  const bool isWhole = internalCount <= 0 && !foldsCase;
  const int key = checkedKey;
  const int outerKey = checkedOuterKey;
  const bool wasHeld = claimed != nullptr || environment.containsInScope(key);
  const bool wasHeldOutside =
      request.isExternal && externals.containsInScope(outerKey);
  bool isPlaced = false;
  bool isPlacedOutside = false;
  const bool isDone = HX_WithinMemory([&] {
    const char* const kept = claimed != nullptr
                                 ? claimed->text
                                 : texts.getString(isWhole ? key : idOf(text));
    if (claimed != nullptr) {
      claimed->symbol = request.symbol;
      claimed->lockPosition = -1;
    } else {
      place(environment, key, kept, request.symbol, position);
    }
    isPlaced = true;
    isPlacedOutside = request.isExternal && place(externals, outerKey, kept,
                                                  request.symbol, position);
    noteInLock(text, wanted, request);
  });
  if (isDone) return;
  const auto takeBack = [this](Environment& from, int which, bool isHeld,
                               Holder* holder) {
    if (holder == nullptr) holder = from.lookupInScope(which);
    holder->lockPosition = position;
    if (isHeld) return;
    from.removeKey(which);
    delete holder;
  };
  if (isPlaced) takeBack(environment, key, wasHeld, claimed);
  if (isPlacedOutside) takeBack(externals, outerKey, wasHeldOutside, nullptr);
  throw std::bad_alloc();
}

// Throws std::bad_alloc, with the lock unchanged.
void HX_SafeNames::Content::noteInLock(const KyCXString& text,
                                       const KyCXString& wanted,
                                       const Request& request) {
  if (lock == nullptr || request.item.empty()) return;
  if (claimed != nullptr) return lock->noteKept(position);
  HX_NameLock::Entry entry;
  entry.item = request.item;
  entry.name = text.cstring();
  entry.wanted = wanted.cstring();
  entry.scope = request.scope->name;
  entry.isExternal = request.isExternal;
  if (!lock->note(entry)) throw std::bad_alloc();
}

bool HX_SafeNames::Content::define(HxCCIdentifier& id, const Request& request,
                                   HX_SafeName& result) {
  position = lock == nullptr ? -1 : lock->find(request.item);
  claimed = nullptr;
  id.activateActualName();
  const bool mayChange = id.getIdentifierChangeable(kActual);
  fit(id, mayChange, result);
  KyCXString text = id.getCookedName(kActual);
  result.m_Wanted = text;
  if (!settle(text, mayChange, request, result)) return false;
  enter(text, result.m_Wanted, request);
  id.setCookedName(text, kActual);
  result.m_Text = std::move(text);
  result.m_IsDefined = true;
  return true;
}

bool HX_SafeNames::Content::create(HxCCIdentifier& id, HX_DataType* type,
                                   const Request& request,
                                   HX_SafeName& result) {
  KyCXString form = id.getCookedName(kActual);
  form.replace("$R", "");  // changes nothing but what may be done later
  result.m_IsComplete = naming.createNameFromForm(
      id, type, request.retainedMacros, request.provisionalMacros,
      request.suppressMessages);
  const KyCXString& expanded = id.getCookedName(kActual);
  if (!(expanded == form)) result.add(HX_SafeName::eExpanded, expanded);
  if (result.m_IsComplete || request.retainedMacros == 0)
    return define(id, request, result);
  result.add(HX_SafeName::eIncomplete, expanded);
  return false;
}

bool HX_SafeNames::create(HxCCIdentifier& id, HX_DataType* type,
                          const Request& request, HX_SafeName& result) {
  result.clear();
  const bool hasMemory = m_pContent != nullptr && HX_WithinMemory([&] {
                           m_pContent->create(id, type, request, result);
                         });
  if (!hasMemory) result.add(HX_SafeName::eNoMemory, KyCXString());
  return result.m_IsDefined;
}

bool HX_SafeNames::define(HxCCIdentifier& id, const Request& request,
                          HX_SafeName& result) {
  result.clear();
  const bool hasMemory = m_pContent != nullptr && HX_WithinMemory([&] {
                           m_pContent->define(id, request, result);
                         });
  if (!hasMemory) result.add(HX_SafeName::eNoMemory, KyCXString());
  return result.m_IsDefined;
}
