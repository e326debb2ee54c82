// Steps of a safe name, random names against a plain form, locks over runs with
// changes.
#include "SafeNames/HX_SafeNames.h"

#include <algorithm>
#include <map>
#include <random>
#include <string>
#include <vector>

#include "Naming/HX_NamingFixture.h"
#include "SafeNames/HX_NameLock.h"
#include "SafeNames/HX_ReservedNames.h"
#include "SafeNames/HX_SignificantNames.h"
#include "platform/model/HxCSymbol.h"

namespace {

using Names = HX_SafeNames;
using Reserved = HX_ReservedNames;

constexpr const char* kStepNames[] = {
    "expanded", "identifier", "shortened", "locked",   "rewritten",
    "derived",  "empty",      "keyword",   "reserved", "pattern",
    "taken",    "indistinct", "held",      "retired",  "incomplete",
    "long",     "none left",  "no memory"};

class SafeNamesTest : public HX_NamingFixture {
 protected:
  SafeNamesTest() { HxCNames::boot(); }
  ~SafeNamesTest() override { HxCNames::shutdown(); }

  // "text: step, step reason, step by other"
  std::string shownSteps(const HX_SafeName& name) const {
    std::string text = name.text().cstring();
    for (int i = 0; i < name.stepCount(); ++i) {
      const HX_SafeName::Step& step = name.step(i);
      text += (i == 0 ? ": " : ", ") + std::string(kStepNames[step.kind]);
      if (step.reason != nullptr) text += std::string(" ") + step.reason;
      if (step.other != nullptr) text += std::string(" by ") + step.other;
    }
    return text;
  }

  Reserved reserved;
};

struct StepCase {
  const char* why;
  const char* form;
  unsigned patterns;
  const char* result;
};

// The rows share a set of names and are defined in this order. The limit is
// on; "goto" is a keyword, "printf" a word of the profile "lib".
const StepCase kStepCases[] = {
    {"as it is", "speed", 0, "speed"},
    {"a macro", "$B", 0, "Speed_Gain: expanded"},
    {"taken", "$B$R", 0,
     "Speed_Gain_a: expanded, taken by Speed_Gain, derived"},
    {"fixed and taken", "speed:speed", 0, ": taken by speed"},
    {"keyword", "goto", 0, "goto_a: keyword, derived"},
    {"fixed keyword", "goto:goto", 0, ": keyword"},
    {"profile", "printf", 0, "printf_a: reserved lib, derived"},
    {"variant is taken, too", "printf", 0, "printf_b: reserved lib, derived"},
    {"no identifier", "a b", 0, "a_b: identifier"},
    {"shortened", "abcdefghijklmnopqrstuvwxyz0123456789", 0,
     "abcdefghijklmno__wxyz0123456789: shortened"},
    {"shortened without a pattern", "abcdefghijklmnopqrstuvwxyz0123456789",
     Reserved::ePatternUnderscores,
     "abcdefghijklmno_vwxyz0123456789: shortened"},
    {"shortened beside an underscore", "abcdefghijklmn_pqrstuvwxyz0_2345678_",
     Reserved::ePatternUnderscores,
     "abcdefghijklmn_vwxyz0_2345678_: shortened"},
    {"shortened before an underscore", "abcdefghijklmnopqrstu_wxyz0123456789",
     Reserved::ePatternUnderscores,
     "abcdefghijklmno_wxyz0123456789: shortened"},
    {"fixed and long",
     "abcdefghijklmnopqrstuvwxyz0123456:"
     "abcdefghijklmnopqrstuvwxyz0123456",
     0, "abcdefghijklmnopqrstuvwxyz0123456: long"},
    {"long variant", "abcdefghijklmno__wxyz0123456789", 0,
     "abcdefghijklmno__wxyz01234567_a: "
     "taken by abcdefghijklmno__wxyz0123456789, derived"},
    {"pattern in front", "strong", Reserved::ePatternAll,
     "n_strong: pattern str, rewritten"},
    {"the same, taken", "strong", Reserved::ePatternAll,
     "n_strong_a: pattern str, rewritten, taken by n_strong, derived"},
    {"pattern of a fixed name", "total:total", Reserved::ePatternTo,
     ": pattern to"},
    {"underscores in front", "___Speed1", Reserved::ePatternAll,
     "Speed1: pattern underscores-first, rewritten"},
    {"underscores before a digit", "__1", Reserved::ePatternAll,
     "n_1: pattern underscores-first, rewritten"},
    {"nothing but underscores", "__", Reserved::ePatternAll,
     "n_: pattern underscores-first, rewritten"},
    {"runs of underscores", "a___c__d", Reserved::ePatternUnderscores,
     "a_c_d: pattern underscores, rewritten"},
    {"a variant joins underscores", "a_c_d_", Reserved::ePatternUnderscores,
     "a_c_d_"},
    {"and again", "a_c_d_", Reserved::ePatternUnderscores,
     "a_c_d_a: taken by a_c_d_, derived"},
    {"pattern at the end", "size_t", Reserved::ePatternType,
     "size_t_a: pattern _t, derived"},
    {"pattern then taken", "_Speed_Gain", Reserved::ePatternUnderscoreCapital,
     "Speed_Gain_b: pattern underscore-capital, rewritten, "
     "taken by Speed_Gain, derived"},
    {"patterns off", "strong", 0, "strong"},
    {"capital after the underscores", "_EIO", Reserved::ePatternAll,
     "n_EIO: pattern underscore-capital, rewritten"},
};

TEST_F(SafeNamesTest, TellsTheStepsOfEachName) {
  options.setLimitVariableNameLength(true);
  HX_TextFaults faults;
  ASSERT_TRUE(reserved.readText("lib", "printf", 6, faults));
  Names safe;
  safe.setReserved(&reserved);
  Names::Request request;
  request.scope = safe.addScope("file", nullptr);
  HX_SafeName name;
  for (const StepCase& row : kStepCases) {
    SCOPED_TRACE(row.why);
    reserved.setPatterns(row.patterns);
    Id id = identifier(row.form);
    const std::string result = row.result;
    EXPECT_EQ(result[0] != ':', safe.create(id, nullptr, request, name));
    EXPECT_EQ(result, shownSteps(name));
    EXPECT_TRUE(name.isComplete());
    if (name.isDefined()) {
      EXPECT_EQ(name.text(), id.getCookedName(Id::eActiveName));
    }
  }
  EXPECT_EQ(std::vector<std::string>{}, messages());
}

TEST_F(SafeNamesTest, RetainedMacrosDefineNothing) {
  Names safe;
  Names::Request request;
  request.scope = safe.addScope("file", nullptr);
  request.retainedMacros = HxCNames::eMacroModelName;
  HX_SafeName name;
  Id id = identifier("$B_$M");
  EXPECT_FALSE(safe.create(id, nullptr, request, name));
  EXPECT_EQ(": expanded, incomplete", shownSteps(name));
  EXPECT_FALSE(name.isComplete());
  request.retainedMacros = 0;
  request.provisionalMacros = HxCNames::eMacroModelName;
  Id other = identifier("$B_$M");
  EXPECT_TRUE(safe.create(other, nullptr, request, name));
  EXPECT_FALSE(name.isComplete());
  EXPECT_STREQ("Speed_Gain_plant_v2", name.text().cstring());
}

TEST_F(SafeNamesTest, ConflictsTellTheOtherName) {
  HxCSymbol symbol("x", HxCSymbol::eVariable);
  Names safe;
  safe.setSignificance(8, 4, true);
  Names::Scope* const file = safe.addScope("file", nullptr);
  Names::Scope* const body = safe.addScope("body", file);
  Names::Scope* const other = safe.addScope("other", nullptr);
  EXPECT_TRUE(safe.reserveName("MAXIMUM_1", file, nullptr));
  EXPECT_FALSE(safe.reserveName("maximum_2", body, nullptr));
  struct {
    Names::Scope* scope;
    bool isExternal;
    const char* form;
    const char* result;
  } const kRows[] = {
      {file, true, "engine", "engine"},
      {body, false, "Engine:Engine", ": indistinct by engine"},
      {body, false, "engine:engine", ": taken by engine"},
      {other, false, "engine:engine", "engine"},
      {other, true, "enginx", "en_a: indistinct by engine, derived"},
      {body, false, "maximum_x", "maximu_a: indistinct by MAXIMUM_1, derived"},
      {body, false, "maximux_y", "maximux_y"},
      {body, false, "MAXIMUX", "MAXIMUX"},
      {file, false, "MAXIMUX", "MAXIMU_b: taken by MAXIMUX, derived"},
      // Variants taken among external names stay free for internal names.
      {file, true, "va", "va"},
      {file, true, "va_a", "va_a"},
      {other, true, "va", "va_b: taken by va, derived"},
      {other, false, "va", "va"},
      {other, false, "va", "va_a: taken by va, derived"},
  };
  HX_SafeName name;
  for (const auto& row : kRows) {
    Names::Request request;
    request.scope = row.scope;
    request.isExternal = row.isExternal;
    request.symbol = &symbol;
    Id id = identifier(row.form);
    safe.create(id, nullptr, request, name);
    EXPECT_EQ(row.result, shownSteps(name));
  }
  EXPECT_EQ(&symbol, name.step(0).symbol);
}

// --- Random names ---

const char* const kPieces[] = {"a",  "b",    "_",   "__",  "x1", "$B", "$S",
                               "$R", "str",  "is",  "int", "E",  "1",  " ",
                               "_t", "goto", "SIG", "mem", "$$", "to", "T"};

std::string randomForm(std::mt19937& random) {
  std::string form;
  const auto pieces = 1 + random() % 4;
  for (auto i = pieces; i > 0; --i)
    form += kPieces[random() % std::size(kPieces)];
  if (random() % 8 == 0) form += std::string(20 + random() % 30, 'q');
  if (random() % 6 == 0) form += ":" + form;
  return form;
}

// A defined name in the plain form.
struct Given {
  std::string name;
  int scope;
  bool isExternal;
};

struct Setting {
  unsigned patterns;
  int internal;
  int external;
  bool folds;
  bool limits;
};

class SafeNamesRandomTest : public SafeNamesTest {
 protected:
  // Scopes 0 and 3 are roots, 1 and 2 lie in 0, 4 in 1.
  static constexpr int kParents[] = {-1, 0, 0, -1, 1};

  static bool isInside(int inner, int outer) {
    while (inner >= 0 && inner != outer) inner = kParents[inner];
    return inner == outer;
  }
  static std::string part(const std::string& name, int count, bool folds) {
    std::string result =
        count > 0 ? name.substr(0, static_cast<std::size_t>(count)) : name;
    for (char& c : result)
      if (folds) c = static_cast<char>(tolower(c));
    return result;
  }
  bool isReserved(const std::string& name, int scope) const {
    return HxCNames::checkCVariableName(name.c_str()) ==
               HxCNames::eVariableNameCKeyword ||
           reserved.find(name.c_str(), kParents[scope] < 0);
  }
  bool isTaken(const std::string& name, int scope, bool isExternal) const {
    return std::any_of(given.begin(), given.end(), [&](const Given& other) {
      if ((isInside(scope, other.scope) || isInside(other.scope, scope)) &&
          part(name, setting.internal, setting.folds) ==
              part(other.name, setting.internal, setting.folds))
        return true;
      return isExternal && other.isExternal &&
             part(name, setting.external, setting.folds) ==
                 part(other.name, setting.external, setting.folds);
    });
  }
  bool isFree(const std::string& name, int scope, bool isExternal) const {
    return !name.empty() && !isReserved(name, scope) &&
           !isTaken(name, scope, isExternal);
  }

  // The names of one run over random requests.
  std::string run(unsigned seed, bool checks) {
    std::mt19937 random(seed);
    given.clear();
    reserved.setPatterns(setting.patterns);
    options.setLimitVariableNameLength(setting.limits);
    Names safe;
    safe.setReserved(&reserved);
    safe.setSignificance(setting.internal, setting.external, setting.folds);
    std::vector<Names::Scope*> scopes;
    for (const int parent : kParents)
      scopes.push_back(safe.addScope(
          std::to_string(scopes.size()),
          parent < 0 ? nullptr : scopes[static_cast<std::size_t>(parent)]));
    std::string all;
    HX_SafeName name;
    for (int i = 0; i < 120; ++i) {
      const int scope = static_cast<int>(random() % scopes.size());
      Names::Request request;
      request.scope = scopes[static_cast<std::size_t>(scope)];
      request.isExternal = random() % 3 == 0;
      request.suppressMessages = true;
      Id id = identifier(randomForm(random));
      const std::string form = id.getRawName(Id::eFormalName).cstring();
      safe.create(id, nullptr, request, name);
      if (checks) check(id, name, scope, request.isExternal, form);
      if (name.isDefined())
        given.push_back({name.text().cstring(), scope, request.isExternal});
      all += shownSteps(name) + "\n";
    }
    return all;
  }

  void check(const Id& id, const HX_SafeName& name, int scope, bool isExternal,
             const std::string& form) {
    SCOPED_TRACE(form + " -> " + shownSteps(name));
    const std::string wanted = name.wanted().cstring();
    const bool mayChange = id.getIdentifierChangeable(Id::eActualName);
    const bool wantedIsFree = isFree(wanted, scope, isExternal);
    ASSERT_EQ((mayChange && !wanted.empty()) || wantedIsFree, name.isDefined());
    if (!name.isDefined()) return;
    const std::string text = name.text().cstring();
    EXPECT_TRUE(name.text().isValidCIdentifier());
    EXPECT_TRUE(isFree(text, scope, isExternal));
    EXPECT_EQ(wantedIsFree, text == wanted);
    if (mayChange && setting.limits) {
      EXPECT_LE(text.size(), 31u);
    }
    if (wantedIsFree || setting.patterns != 0) return;
    // The first free variant, by the operation for suffixes.
    const int count =
        std::min(setting.internal > 0 ? setting.internal : 1000,
                 isExternal && setting.external > 0 ? setting.external : 1000);
    for (int index = 0;; ++index) {
      KyCXString suffix;
      names.appendSuffix(suffix, index);
      const std::size_t longest = static_cast<std::size_t>(
          std::min(setting.limits ? 31 : 1000, count) - suffix.length());
      const std::string variant = wanted.substr(0, longest) + suffix.cstring();
      if (!isFree(variant, scope, isExternal)) continue;
      EXPECT_EQ(variant, text);
      return;
    }
  }

  Setting setting{};
  std::vector<Given> given;
};

TEST_F(SafeNamesRandomTest, NamesAreFreeFitAndTheSameOnEveryRun) {
  HX_TextFaults faults;
  const std::string words = "a\nb\nax1\nstrint\nab_a\n";
  ASSERT_TRUE(reserved.readText("p", words.data(), words.size(), faults));
  std::mt19937 random(HX_Seed());
  constexpr int kCounts[] = {0, 0, 6, 8, 31};
  for (int i = 0; i < 40; ++i) {
    setting.patterns =
        i % 3 == 0 ? 0
                   : static_cast<unsigned>(random()) & Reserved::ePatternAll;
    setting.internal = kCounts[random() % 5];
    setting.external = kCounts[random() % 5];
    setting.folds = random() % 2 == 0;
    setting.limits = random() % 2 == 0;
    const auto seed = static_cast<unsigned>(random());
    SCOPED_TRACE(std::to_string(i) + ", patterns " +
                 std::to_string(setting.patterns));
    const std::string first = run(seed, true);
    ASSERT_FALSE(HasFailure());
    EXPECT_EQ(first, run(seed, false));
  }
}

// --- Locks ---

struct Item {
  std::string id;
  std::string form;
  int scope;
  bool isExternal;
};

std::string written(const HX_NameLock& lock) {
  std::string text;
  EXPECT_TRUE(lock.write([&](const char* piece, std::size_t length) {
    text.append(piece, length);
  }));
  return text;
}

class SafeNamesLockTest : public SafeNamesTest {
 protected:
  using Given = std::map<std::string, std::string>;  // id -> name

  // Forms the items in their order with the lock \p text, which becomes the
  // lock after the run.
  Given run(const std::vector<Item>& items, std::string& text,
            int retireRuns = 0) {
    HX_NameLock lock;
    HX_TextFaults faults;
    if (!text.empty()) {
      EXPECT_TRUE(lock.read(text.data(), text.size(), faults));
    }
    Names safe;
    safe.setSignificance(internal, external, true);
    Names::Scope* const file = safe.addScope("file", nullptr);
    Names::Scope* const scopes[] = {file, safe.addScope("body", file),
                                    safe.addScope("flat", nullptr)};
    EXPECT_TRUE(safe.useLock(&lock));
    Given given;
    HX_SafeName name;
    steps.clear();
    for (const Item& item : items) {
      Names::Request request;
      request.scope = scopes[item.scope];
      request.isExternal = item.isExternal;
      request.item = item.id;
      Id id = identifier(item.form);
      safe.create(id, nullptr, request, name);
      if (name.isDefined()) given[item.id] = name.text().cstring();
      steps[item.id] = shownSteps(name);
    }
    lock.endRun(retireRuns);
    text = written(lock);
    return given;
  }

  static Item randomItem(std::mt19937& random, int number) {
    static const char* const kForms[] = {"gain",     "$B",         "speed",
                                         "Gain",     "goto",       "speed_a",
                                         "gain_a_b", "engine_load"};
    return {"i" + std::to_string(number), kForms[random() % std::size(kForms)],
            static_cast<int>(random() % 3), random() % 3 == 0};
  }

  int internal = 0;
  int external = 0;
  std::map<std::string, std::string> steps;
};

TEST_F(SafeNamesLockTest, ChangesRenameNoOtherItem) {
  std::mt19937 random(HX_Seed());
  for (int round = 0; round < 30; ++round) {
    SCOPED_TRACE(round);
    internal = round % 3 == 0 ? 8 : 0;
    external = round % 2 == 0 ? 6 : 0;
    std::vector<Item> items;
    int number = 0;
    while (number < 120) items.push_back(randomItem(random, number++));
    std::string lock;
    const Given before = run(items, lock);
    ASSERT_EQ(items.size(), before.size());

    // Items in another order: the same names, the same bytes.
    std::string again = lock;
    std::shuffle(items.begin(), items.end(), random);
    EXPECT_EQ(before, run(items, again));
    EXPECT_EQ(lock, again);

    const auto changes = 1 + random() % 100;
    for (auto left = changes; left > 0; --left) {
      const auto at = static_cast<std::ptrdiff_t>(random() % items.size());
      switch (random() % 3) {
        case 0:
          items.insert(items.begin() + at, randomItem(random, number++));
          break;
        case 1:
          if (items.size() > 1) items.erase(items.begin() + at);
          break;
        default:
          std::swap(items[static_cast<std::size_t>(at)], items.front());
      }
    }
    const Given after = run(items, lock);
    ASSERT_EQ(items.size(), after.size());
    for (const auto& [item, name] : after) {
      if (before.count(item) != 0) {
        EXPECT_EQ(before.at(item), name) << item;
        continue;
      }
      // No new item has the name of a removed item of the same scope.
      const auto old =
          std::find_if(before.begin(), before.end(), [&](const auto& entry) {
            return entry.second == name && after.count(entry.first) == 0 &&
                   lock.find(entry.first + "\t" + name + "\t") !=
                       std::string::npos;
          });
      if (old == before.end()) continue;
      const auto scopeOf = [&](const std::string& id) {
        const std::size_t from = lock.find("\n" + id + "\t") + 1;
        const std::string line =
            lock.substr(from, lock.find('\n', from) - from);
        return line.find("\tflat\t") != std::string::npos;
      };
      EXPECT_NE(scopeOf(item), scopeOf(old->first)) << item << " " << name;
    }
  }
}

// Runs over one lock, item by item: "id form" -> steps.
struct LockCase {
  const char* why;
  std::vector<std::pair<const char*, const char*>> items;
  std::vector<const char*> results;
  int retireRuns;
};

const LockCase kLockCases[] = {
    {"first run",
     {{"a", "x"}, {"b", "x"}},
     {"x", "x_a: taken by x, derived"},
     2},
    {"one goes, one comes first",
     {{"c", "x"}, {"b", "x"}},
     {"x_b: held by a, derived", "x_a: locked"},
     2},
    {"while retired",
     {{"b", "x"}, {"c", "x"}, {"d", "x"}},
     {"x_a: locked", "x_b: locked", "x_c: retired by a, derived"},
     2},
    {"still",
     {{"b", "x"}, {"c", "x"}, {"d", "x"}},
     {"x_a: locked", "x_b: locked", "x_c: locked"},
     2},
    {"then free",
     {{"e", "x"}, {"b", "x"}, {"c", "x"}, {"d", "x"}},
     {"x", "x_a: locked", "x_b: locked", "x_c: locked"},
     0},
    {"another wanted name",
     {{"b", "y"}, {"f", "x_a"}},
     {"y", "x_a_a: retired by b, derived"},
     0},
    {"held for an item that follows",
     {{"g", "y"}, {"b", "y"}},
     {"y_a: held by b, derived", "y"},
     0},
    {"a fixed name does not take it",
     {{"h", "x:x"}, {"e", "x"}},
     {": retired by e", "x"},
     0},
    {"fixed now, to another name", {{"c", "x:x"}}, {": held by e"}, 0},
};

TEST_F(SafeNamesLockTest, GivesAndHoldsNames) {
  std::string lock;
  for (const LockCase& row : kLockCases) {
    SCOPED_TRACE(row.why);
    std::vector<Item> items;
    for (const auto& [id, form] : row.items)
      items.push_back({id, form, 0, false});
    run(items, lock, row.retireRuns);
    for (std::size_t i = 0; i < items.size(); ++i)
      EXPECT_EQ(row.results[i], steps[items[i].id]) << items[i].id;
  }
}

// Separate scopes became nested after the lock was written.
TEST_F(SafeNamesLockTest, ANameOfAnOuterScopeIsNotHeldInside) {
  std::string lock =
      "hx_names_lock 1\na\tx\tx\tfile\ti\t-\nb\tx\tx\tbody\ti\t-\n";
  run({{"b", "x", 1, false}, {"a", "x", 0, false}}, lock);
  EXPECT_EQ("x_a: held by a, derived", steps["b"]);
  EXPECT_EQ("x", steps["a"]);
}

TEST_F(SafeNamesLockTest, ANameReservedSinceIsGivenAnew) {
  HX_TextFaults faults;
  std::string lock;
  run({{"a", "x", 0, false}, {"b", "x", 0, false}}, lock);
  HxCNames().addToKeywordDict("x_a", HxCNames::eDictUserTypeName);
  run({{"a", "x", 0, false}, {"b", "x", 0, false}}, lock);
  EXPECT_EQ("x_b: taken by x, derived", steps["b"]);
}

// --- Memory ---

TEST_F(SafeNamesTest, DefinesAllOrNothingWithoutMemory) {
  HX_WithoutEachBlock("safe names", [] {
    HX_NameLock lock;
    HX_TextFaults faults;
    const std::string text = "hx_names_lock 1\na\tx_a\tx\tfile\te\t-\n";
    if (!lock.read(text.data(), text.size(), faults)) return false;
    Names safe;
    safe.setSignificance(8, 6, false);
    Names::Scope* const file = safe.addScope("file", nullptr);
    Names::Scope* const body = safe.addScope("body", file);
    if (file == nullptr || body == nullptr || !safe.useLock(&lock))
      return false;
    bool isDone = true;
    HX_SafeName name;
    for (int i = 0; isDone && i < 20; ++i) {
      const std::string item = i == 5 ? "a" : "i" + std::to_string(i);
      Names::Request request;
      request.scope = i % 2 == 0 ? file : body;
      request.isExternal = true;
      request.item = item;
      HxCCIdentifier id(i == 5 ? "x" : "speed");
      isDone = safe.create(id, nullptr, request, name);
      if (isDone) continue;
      EXPECT_EQ(HX_SafeName::eNoMemory, name.step(name.stepCount() - 1).kind);
      EXPECT_TRUE(name.text().isEmpty());
      EXPECT_EQ(i == 5, lock.find(item) >= 0);
    }
    return isDone;
  });
}

}  // namespace
