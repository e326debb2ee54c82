// Searches of the environment beside walks over maps of peers. Item of work: a
// query.

#include "NameSpace/HxCNameSpace.h"

#include <algorithm>
#include <memory>
#include <unordered_map>

#include "HX_NameSpaceBench.h"
#include "NameSpace/HxCXStringIdServer.h"

#ifdef HX_HAVE_ABSL
#include <absl/container/flat_hash_map.h>
#endif
#ifdef HX_HAVE_LLVM
#include <llvm/ADT/ScopedHashTable.h>
#endif

namespace {

constexpr int kNamesPerScope = 100;
constexpr int kBlocksPerFunction = 3;
constexpr int kNesting = 8;

// Ids as the server gives them: 1024 apart within a bucket.
int keyOf(int number) {
  return number % 1024 * 1024 + number / 1024 % 1024 + (number >> 20 << 20);
}

// Keys of no scope, in no order.
std::vector<int> missingKeys(int scopes) {
  std::vector<int> keys;
  for (int i = 0; i < 1 << 16; ++i)
    keys.push_back(keyOf(scopes * kNamesPerScope + i));
  std::shuffle(keys.begin(), keys.end(), std::mt19937(4));
  return keys;
}

// A file with functions of some blocks; no name is in two scopes.
void BM_NameSpace_MissFromRoot(benchmark::State& state) {
  HxCXStringIdServer ids;
  HxCNameSpace handle(&ids);
  HxCNameSpace::Scope* const root = handle.newEnv();
  HxCNameSpace::Scope* function = root;
  const int scopes = static_cast<int>(state.range(0));
  for (int i = 0; i < scopes; ++i) {
    if (i > 0) {
      const bool isFunction = i % (1 + kBlocksPerFunction) == 1;
      handle.setScope(nullptr);
      handle.newScope(isFunction ? root : function);
      if (isFunction) function = handle.getScope();
    }
    for (int k = 0; k < kNamesPerScope; ++k)
      handle.defineIdn(keyOf(i * kNamesPerScope + k));
  }
  handle.setScope(root);
  const std::vector<int> keys = missingKeys(scopes);
  if (!handle.keyInEnv(keyOf(scopes * kNamesPerScope - 1)) ||
      handle.keyInEnv(keys[0]))
    return state.SkipWithError("wrong result");
  for (auto _ : state)
    for (int key : keys) benchmark::DoNotOptimize(handle.keyInEnv(key));
  state.SetItemsProcessed(state.iterations() *
                          static_cast<std::int64_t>(keys.size()));
  delete root;
}

#ifdef HX_HAVE_ABSL
struct WalkedScope {
  absl::flat_hash_map<int, void*> entries;
  std::vector<std::unique_ptr<WalkedScope>> children;

  bool contains(int key) const {
    return entries.contains(key) ||
           std::any_of(children.begin(), children.end(),
                       [key](const auto& c) { return c->contains(key); });
  }
};

void BM_FlatHashMap_MissFromRoot(benchmark::State& state) {
  WalkedScope root;
  WalkedScope* function = &root;
  const int scopes = static_cast<int>(state.range(0));
  for (int i = 0; i < scopes; ++i) {
    WalkedScope* scope = &root;
    if (i > 0) {
      const bool isFunction = i % (1 + kBlocksPerFunction) == 1;
      WalkedScope& parent = isFunction ? root : *function;
      parent.children.push_back(std::make_unique<WalkedScope>());
      scope = parent.children.back().get();
      if (isFunction) function = scope;
    }
    for (int k = 0; k < kNamesPerScope; ++k)
      scope->entries.emplace(keyOf(i * kNamesPerScope + k), nullptr);
  }
  std::vector<int> keys = missingKeys(scopes);
  keys.resize(64);
  for (auto _ : state)
    for (int key : keys) benchmark::DoNotOptimize(root.contains(key));
  state.SetItemsProcessed(state.iterations() *
                          static_cast<std::int64_t>(keys.size()));
}
#else
HX_MISSING_PEER(BM_FlatHashMap_MissFromRoot, "libabsl-dev")
#endif

// Queries from the innermost of some nested scopes: keys of all levels and an
// equal share of absent keys.
std::vector<int> outwardKeys() {
  std::vector<int> keys;
  for (int i = 0; i < (kNesting + 1) * kNamesPerScope; ++i)
    keys.push_back(keyOf(i));
  std::shuffle(keys.begin(), keys.end(), std::mt19937(5));
  return keys;
}

template <class Query>
void searchOutward(benchmark::State& state, Query query) {
  const std::vector<int> keys = outwardKeys();
  if (std::count_if(keys.begin(), keys.end(), query) !=
      kNesting * kNamesPerScope)
    return state.SkipWithError("wrong result");
  for (auto _ : state)
    for (int key : keys) benchmark::DoNotOptimize(query(key));
  state.SetItemsProcessed(state.iterations() *
                          static_cast<std::int64_t>(keys.size()));
}

void BM_NameSpace_Outward(benchmark::State& state) {
  HxCXStringIdServer ids;
  HxCNameSpace handle(&ids);
  HxCNameSpace::Scope* const root = handle.newEnv();
  for (int i = 0; i < kNesting * kNamesPerScope; ++i) {
    if (i != 0 && i % kNamesPerScope == 0) {
      HxCNameSpace::Scope* const around = handle.getScope();
      handle.setScope(nullptr);
      handle.newScope(around);
    }
    handle.defineIdn(keyOf(i));
  }
  searchOutward(state, [&](int key) { return handle.keyInEnv(key); });
  delete root;
}

void BM_UnorderedMap_Outward(benchmark::State& state) {
  std::vector<std::unordered_map<int, void*>> scopes(kNesting);
  for (int i = 0; i < kNesting * kNamesPerScope; ++i)
    scopes[static_cast<std::size_t>(i / kNamesPerScope)].emplace(keyOf(i),
                                                                 nullptr);
  searchOutward(state, [&](int key) {
    return std::any_of(scopes.rbegin(), scopes.rend(),
                       [key](const auto& s) { return s.find(key) != s.end(); });
  });
}

#ifdef HX_HAVE_LLVM
void BM_ScopedHashTable_Outward(benchmark::State& state) {
  using Table = llvm::ScopedHashTable<int, int>;
  Table table;
  std::vector<std::unique_ptr<Table::ScopeTy>> scopes;
  for (int i = 0; i < kNesting * kNamesPerScope; ++i) {
    if (i % kNamesPerScope == 0)
      scopes.push_back(std::make_unique<Table::ScopeTy>(table));
    table.insert(keyOf(i), 1);
  }
  searchOutward(state, [&](int key) { return table.count(key) != 0; });
  while (!scopes.empty()) scopes.pop_back();
}
#else
HX_MISSING_PEER(BM_ScopedHashTable_Outward, "llvm-14-dev")
#endif

BENCHMARK(BM_NameSpace_MissFromRoot)->Arg(1000)->Arg(10000);
BENCHMARK(BM_FlatHashMap_MissFromRoot)->Arg(1000)->Arg(10000);
BENCHMARK(BM_NameSpace_Outward);
BENCHMARK(BM_UnorderedMap_Outward);
BENCHMARK(BM_ScopedHashTable_Outward);

}  // namespace
