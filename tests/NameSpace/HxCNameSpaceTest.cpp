#include "NameSpace/HxCNameSpace.h"

#include <algorithm>
#include <deque>
#include <functional>
#include <map>
#include <random>
#include <span>
#include <string_view>

#include "NameSpace/HX_FailingController.h"
#include "NameSpace/HxCXStringIdServer.h"
#include "platform/model/HxCSymbol.h"
#include "support/HX_TestFixture.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using testing::StartsWith;
using Scope = HxCNameSpace::Scope;

class NameSpaceTest : public HX_TestFixture {
 protected:
  NameSpaceTest() { m_Ids.boot(); }
  ~NameSpaceTest() override { m_Ids.shutdown(); }

  // Symbols by number; the content of a symbol does not matter.
  HxCSymbol* symbol(unsigned number) {
    while (m_Symbols.size() <= number)
      m_Symbols.emplace_back("symbol", HxCSymbol::eVariable);
    return &m_Symbols[number];
  }

  HxCXStringIdServer m_Ids;
  std::deque<HxCSymbol> m_Symbols;
};

TEST_F(NameSpaceTest, HandleMakesOneScope) {
  HxCNameSpace outer(&m_Ids), inner(&m_Ids);
  EXPECT_EQ(inner.getDebugIndex(), outer.getDebugIndex() + 1);
  EXPECT_EQ(HxCNameSpace(inner).getDebugIndex(), inner.getDebugIndex());
  EXPECT_EQ(HxCNameSpace::sm_ObjectCount, inner.getDebugIndex() + 1);
  Scope* const root = outer.newEnv();
  EXPECT_EQ(outer.newScope(root), root);
  EXPECT_THAT(messages(), IsEmpty());
  EXPECT_EQ(outer.newEnv(), root);
  EXPECT_THAT(messages(), ElementsAre(testing::HasSubstr("HxCNameSpace")));
  Scope* const child = inner.newScope(root);
  EXPECT_NE(child, root);
  inner.defineString("i");
  EXPECT_TRUE(outer.stringInEnv("i"));
  EXPECT_FALSE(outer.stringInScope("i"));
  delete root;
}

TEST_F(NameSpaceTest, NamesWithoutSymbolCountOnlyForPlainQueries) {
  HxCNameSpace names(&m_Ids);
  Scope* const root = names.newEnv();
  HxCSymbol* found = symbol(0);
  HxCSmbScopeData* data = nullptr;
  int key = 0;
  names.createIdn("x", key);
  EXPECT_TRUE(names.defineIdn(key));
  EXPECT_FALSE(names.defineString("x", symbol(1))) << "taken";
  EXPECT_TRUE(names.stringInScope("x"));
  EXPECT_TRUE(names.stringInEnv("x"));
  EXPECT_FALSE(names.stringInScope("x", found));
  EXPECT_FALSE(names.stringInEnv("x", found));
  EXPECT_FALSE(names.stringInEnv("x", data));
  EXPECT_EQ(found, symbol(0));
  EXPECT_TRUE(names.defineString("y", symbol(2)));
  EXPECT_TRUE(names.stringInScope("y", found));
  ASSERT_TRUE(names.stringInEnv("y", data));
  EXPECT_EQ(found, symbol(2));
  data->incrCollisionCount();
  data->setCollisionCount(data->getCollisionCount() - 3);
  data->decrCollisionCount();
  EXPECT_EQ(data->getCollisionCount(), -3);
  auto& reports = recordDebugReports();
  data->setSymbol(nullptr);
  EXPECT_TRUE(names.stringInEnv("y", found));
  EXPECT_EQ(found, nullptr);
  found = symbol(0);
  EXPECT_TRUE(names.stringInScope("y", found));
  EXPECT_EQ(found, nullptr);
  EXPECT_THAT(reports, ElementsAre("rpSymbol", "prSymbol != 0"));
  EXPECT_TRUE(names.remove("y"));
  EXPECT_FALSE(names.stringInEnv("y"));
  EXPECT_FALSE(names.remove("y")) << "a second time";
  delete root;
}

TEST_F(NameSpaceTest, BreachedPreconditionsAssertAndGiveNothing) {
  HxCNameSpace empty(&m_Ids), serverless(nullptr), scoped(&m_Ids);
  Scope* const root = scoped.newEnv();
  serverless.setScope(root);
  HxCSymbol* found = symbol(0);
  HxCSmbScopeData old(found);
  HxCSmbScopeData* data = nullptr;
  using Names = HxCNameSpace;
  struct Operation {
    const char* what;
    std::function<bool(Names&)> call;
  };
  const Operation withString[] = {
      {"define", [](Names& n) { return n.defineString("a"); }},
      {"define symbol", [&](Names& n) { return n.defineString("a", found); }},
      {"in scope", [](Names& n) { return n.stringInScope("a"); }},
      {"symbol in scope",
       [&](Names& n) { return n.stringInScope("a", found); }},
      {"in environment", [](Names& n) { return n.stringInEnv("a"); }},
      {"data in environment",
       [&](Names& n) { return n.stringInEnv("a", data); }},
      {"symbol in environment",
       [&](Names& n) { return n.stringInEnv("a", found); }},
      {"remove", [](Names& n) { return n.remove("a"); }}};
  const Operation withKey[] = {
      {"define", [](Names& n) { return n.defineIdn(1); }},
      {"define symbol", [&](Names& n) { return n.defineIdn(1, found); }},
      {"in scope", [](Names& n) { return n.keyInScope(1); }},
      {"in environment", [](Names& n) { return n.keyInEnv(1); }},
      {"data in environment", [&](Names& n) { return n.keyInEnv(1, data); }},
      {"symbol in environment",
       [&](Names& n) { return n.keyInEnv(1, found); }}};
  const auto expectUseless = [&](const char* why, Names& names,
                                 std::span<const Operation> operations) {
    for (const Operation& operation : operations) {
      SCOPED_TRACE(testing::Message() << why << ": " << operation.what);
      clearMessages();
      data = &old;
      EXPECT_FALSE(operation.call(names));
      EXPECT_THAT(messages(), ElementsAre(StartsWith("7/3 ")));
      EXPECT_EQ(found, symbol(0));
      const bool asksForData =
          std::string_view(operation.what).starts_with("data");
      EXPECT_EQ(data, asksForData ? nullptr : &old);
    }
  };
  expectUseless("no scope", empty, withString);
  expectUseless("no scope", empty, withKey);
  expectUseless("no server", serverless, withString);
  m_Ids.shutdown();
  expectUseless("server down", scoped, withString);
  EXPECT_FALSE(root->containsInScope(0));
  delete root;
}

TEST_F(NameSpaceTest, ScopesListedTwiceOrInACycleAreDestroyedOnce) {
  HX_CountingController memory;
  Scope* const root = new Scope(nullptr);
  Scope* const child = new Scope(root);
  for (Scope* scope : {child, child, root}) root->addChild(scope);
  child->addChild(root);
  delete root;
  EXPECT_EQ(memory.liveBlocks(), 0);
}

// Plain form of a scope: searches walk over all scopes.
struct PlainScope {
  PlainScope* parent;
  Scope* scope;  // mirrored by this object
  bool isOwned;  // by another scope
  std::vector<PlainScope*> children;
  std::map<int, HxCSymbol*> entries;  // null: without scope data

  bool outward(int key, HxCSymbol*& value) const {
    for (const PlainScope* s = this; s != nullptr; s = s->parent)
      if (s->entries.count(key) != 0) return value = s->entries.at(key), true;
    return false;
  }
  bool holdsBelow(int key) const {
    for (const PlainScope* c : children)
      if (c->entries.count(key) != 0 || c->holdsBelow(key)) return true;
    return false;
  }
  HxCSymbol* lookupBelow(int key) const {
    for (const PlainScope* c : children) {
      if (c->entries.count(key) != 0) return c->entries.at(key);
      if (HxCSymbol* value = c->lookupBelow(key)) return value;
    }
    return nullptr;
  }
};

struct ForestCase {
  const char* why;
  unsigned steps;
  unsigned irregular;  // per cent of the scopes listed elsewhere or not at all
  unsigned chain;      // per cent of the scopes put into the latest one
  unsigned failing;    // per cent of the allocations
  unsigned names;      // from which those of a scope are drawn
};

const ForestCase kForestCases[] = {
    {"trees", 3000, 0, 0, 0, 300},
    {"nested deeper than the counts reach", 1500, 0, 90, 0, 300},
    {"children that are not of their parent", 2000, 15, 20, 0, 300},
    {"some listed late, many not at all", 1500, 60, 40, 0, 300},
    {"running out of memory", 3000, 0, 40, 10, 300},
    {"so many names that a filter forms", 6000, 0, 0, 0, 3000},
};

// Grows a forest and its plain form side by side.
class Forest {
 public:
  Forest(HxCXStringIdServer& ids, const ForestCase& row, unsigned seed)
      : m_Names(&ids), m_Row(row), m_Random(seed) {}
  ~Forest() {
    for (const PlainScope& plain : m_Plain)
      if (!plain.isOwned) delete plain.scope;
  }

  void step(HxCSymbol* symbol) {
    const std::size_t choice = m_Plain.empty() ? 0 : random(20);
    if (choice > 4) return defineName(symbol);
    if (choice > 1) return removeName();
    if (choice == 1 && random(100) < m_Row.irregular) return listScope();
    makeScope();
  }

  void compare() {
    // Half of the queries from the outermost scopes: most names lie below.
    const std::size_t at =
        random(random(2) == 0 ? m_Plain.size()
                              : std::min<std::size_t>(m_Plain.size(), 8));
    const int key = randomKey();
    SCOPED_TRACE(testing::Message() << "scope " << at << " key " << key);
    const PlainScope& plain = m_Plain[at];
    m_Names.setScope(plain.scope);
    HxCSymbol* value = nullptr;
    const bool isAround = plain.outward(key, value);
    if (!isAround) value = plain.lookupBelow(key);
    ASSERT_EQ(m_Names.keyInScope(key), plain.entries.count(key) != 0);
    ASSERT_EQ(m_Names.keyInEnv(key), isAround || plain.holdsBelow(key));
    HxCSmbScopeData* data = nullptr;
    ASSERT_EQ(m_Names.keyInEnv(key, data), value != nullptr);
    ASSERT_EQ(data == nullptr ? nullptr : data->getSymbol(), value);
  }

 private:
  std::size_t random(std::size_t bound) { return m_Random() % bound; }
  // Few keys are common to many scopes; some keys are negative.
  int randomKey() {
    return random(2) == 0
               ? static_cast<int>(random(4)) - 2
               : static_cast<int>(random(m_Row.names)) * 1024 - 100000;
  }
  PlainScope& randomScope() { return m_Plain[random(m_Plain.size())]; }

  void makeScope() {
    PlainScope* parent = nullptr;
    if (!m_Plain.empty() && random(40) != 0)
      parent = random(100) < m_Row.chain ? &m_Plain.back() : &randomScope();
    Scope* const around = parent == nullptr ? nullptr : parent->scope;
    const bool byHand = random(100) < m_Row.irregular;
    m_Names.setScope(nullptr);
    Scope* const scope = byHand ? new Scope(around) : m_Names.newScope(around);
    if (scope == nullptr) return;
    const bool isOwned = !byHand && parent != nullptr;
    m_Plain.push_back({parent, scope, isOwned, {}, {}});
    if (isOwned) parent->children.push_back(&m_Plain.back());
  }

  // An older scope lists a younger scope, because then no cycle arises.
  void listScope() {
    const std::size_t child = random(m_Plain.size());
    if (child == 0) return;
    std::size_t by = random(child);
    if (random(2) == 0 && m_Plain[child].parent != nullptr)
      while (&m_Plain[by] != m_Plain[child].parent) by = random(child);
    // Every path doubles the plain search, so paths stay few.
    if (m_Plain[by].children.size() > 3) return;
    ASSERT_TRUE(m_Plain[by].scope->addChild(m_Plain[child].scope));
    m_Plain[child].isOwned = true;
    m_Plain[by].children.push_back(&m_Plain[child]);
  }

  void defineName(HxCSymbol* symbol) {
    PlainScope& plain = randomScope();
    const int key = randomKey();
    const bool isNew = plain.entries.count(key) == 0;
    m_Names.setScope(plain.scope);
    if (random(3) == 0) symbol = nullptr;
    const bool isEntered = symbol == nullptr ? m_Names.defineIdn(key)
                                             : m_Names.defineIdn(key, symbol);
    ASSERT_TRUE(isEntered == isNew || (isNew && m_Row.failing != 0));
    if (isEntered) plain.entries.emplace(key, symbol);
  }

  void removeName() {
    PlainScope& plain = randomScope();
    const int key = randomKey();
    HxCSmbScopeData* const data = plain.scope->lookupInScope(key);
    plain.scope->removeKey(key);
    delete data;
    plain.entries.erase(key);
  }

  HxCNameSpace m_Names;
  const ForestCase& m_Row;
  std::mt19937 m_Random;
  std::deque<PlainScope> m_Plain;
};

TEST_F(NameSpaceTest, SearchesAgreeWithThePlainWalkAndTreesReturnAllMemory) {
  for (const ForestCase& row : kForestCases) {
    for (unsigned seed = 1; seed <= 4; ++seed) {
      SCOPED_TRACE(testing::Message() << row.why << ", seed " << seed);
      HX_FailingController memory;
      memory.setPercent(row.failing, seed);
      {
        Forest forest(m_Ids, row, seed);
        for (unsigned i = 0; i < row.steps; ++i) {
          ASSERT_NO_FATAL_FAILURE(forest.step(symbol(i % 50)));
          for (int query = 0; query < 3; ++query)
            ASSERT_NO_FATAL_FAILURE(forest.compare());
        }
      }
      EXPECT_EQ(memory.liveBlocks(), 0);
    }
  }
}

}  // namespace
