// Interning beside the hash maps of the standard library and of two peers. Item
// of work: a string or an id.

#include "NameSpace/HxCXStringIdServer.h"

#include <algorithm>
#include <cstdint>
#include <memory>
#include <unordered_map>

#include "HX_NameSpaceBench.h"
#include "platform/strings/KyCXString.h"

#ifdef HX_HAVE_ABSL
#include <absl/container/flat_hash_map.h>
#endif
#ifdef HX_HAVE_LLVM
#include <llvm/ADT/StringMap.h>
#endif

namespace {

// Interface of an interner: intern(Text), with Text made by text().
class Ours {
 public:
  using Text = KyCXString;
  Ours() { m_Ids.boot(); }
  Ours(const Ours&) = delete;
  Ours& operator=(const Ours&) = delete;
  ~Ours() { m_Ids.shutdown(); }
  static Text text(const std::string& name) { return name.c_str(); }
  int intern(const Text& name) { return m_Ids.getId(name); }
  const char* getString(int id) { return m_Ids.getString(id); }

 private:
  HxCXStringIdServer m_Ids;
};

// A map from strings to numbers.
template <class Map>
class Numbering {
 public:
  using Text = std::string;
  static Text text(const std::string& name) { return name; }
  int intern(const Text& name) {
    const int next = static_cast<int>(m_Map.size());
    return m_Map.try_emplace(name, next).first->second;
  }

 private:
  Map m_Map;
};

template <class Interner>
std::vector<typename Interner::Text> textsOf(
    const std::vector<std::string>& names) {
  std::vector<typename Interner::Text> texts;
  texts.reserve(names.size());
  for (const std::string& name : names) texts.push_back(Interner::text(name));
  return texts;
}

template <class Interner>
void internNew(benchmark::State& state, const std::vector<std::string>& names) {
  const auto texts = textsOf<Interner>(names);
  for (auto _ : state) {
    auto interner = std::make_unique<Interner>();
    int sum = 0;
    for (const auto& text : texts) sum += interner->intern(text);
    benchmark::DoNotOptimize(sum);
    state.PauseTiming();
    interner.reset();
    state.ResumeTiming();
  }
  state.SetItemsProcessed(state.iterations() * state.range(0));
}

template <class Interner>
void internNew(benchmark::State& state) {
  internNew<Interner>(state,
                      makeNames(static_cast<std::size_t>(state.range(0)), 1));
}

template <class Interner>
void internAgain(benchmark::State& state) {
  auto names = makeNames(static_cast<std::size_t>(state.range(0)), 1);
  Interner interner;
  for (const auto& text : textsOf<Interner>(names)) interner.intern(text);
  std::shuffle(names.begin(), names.end(), std::mt19937(2));
  const auto texts = textsOf<Interner>(names);
  if (interner.intern(texts[0]) != interner.intern(texts[0]))
    return state.SkipWithError("two ids for one string");
  for (auto _ : state) {
    int sum = 0;
    for (const auto& text : texts) sum += interner.intern(text);
    benchmark::DoNotOptimize(sum);
  }
  state.SetItemsProcessed(state.iterations() * state.range(0));
}

// Distinct names whose second half mirrors the first: all have one sum.
std::vector<std::string> namesOfOneSum(std::size_t count) {
  std::mt19937 random(3);
  std::vector<std::string> names;
  for (std::size_t i = 0; i < count; ++i) {
    std::string name;
    for (std::size_t rest = i, k = 0; k < 8; ++k, rest /= 26)
      name += static_cast<char>('a' + (k < 5 ? rest : random()) % 26);
    for (std::size_t k = 0; k < 8; ++k)
      name += static_cast<char>('a' + 'z' - name[k]);
    names.push_back(name);
  }
  return names;
}

void BM_StringIdServer_New(benchmark::State& state) { internNew<Ours>(state); }
void BM_StringIdServer_Again(benchmark::State& state) {
  internAgain<Ours>(state);
}
void BM_StringIdServer_OneSum(benchmark::State& state) {
  internNew<Ours>(state,
                  namesOfOneSum(static_cast<std::size_t>(state.range(0))));
}

// The sum of the addresses makes the compiler read every address.
template <class Read>
void readTexts(benchmark::State& state, const std::vector<int>& ids,
               Read read) {
  for (auto _ : state) {
    std::uintptr_t sum = 0;
    for (int id : ids) sum += reinterpret_cast<std::uintptr_t>(read(id));
    benchmark::DoNotOptimize(sum);
  }
}

void BM_StringIdServer_Text(benchmark::State& state) {
  Ours ours;
  std::vector<int> ids;
  for (const std::string& name :
       makeNames(static_cast<std::size_t>(state.range(0)), 1))
    ids.push_back(ours.intern(name.c_str()));
  std::shuffle(ids.begin(), ids.end(), std::mt19937(2));
  readTexts(state, ids, [&](int id) { return ours.getString(id); });
  state.SetItemsProcessed(state.iterations() * state.range(0));
}

void BM_Vector_Text(benchmark::State& state) {
  const auto names = makeNames(static_cast<std::size_t>(state.range(0)), 1);
  std::vector<const char*> texts;
  std::vector<int> ids;
  for (const std::string& name : names) {
    ids.push_back(static_cast<int>(texts.size()));
    texts.push_back(name.c_str());
  }
  std::shuffle(ids.begin(), ids.end(), std::mt19937(2));
  readTexts(state, ids,
            [&](int id) { return texts[static_cast<std::size_t>(id)]; });
  state.SetItemsProcessed(state.iterations() * state.range(0));
}

using StdMap = Numbering<std::unordered_map<std::string, int>>;
void BM_UnorderedMap_New(benchmark::State& state) { internNew<StdMap>(state); }
void BM_UnorderedMap_Again(benchmark::State& state) {
  internAgain<StdMap>(state);
}

#ifdef HX_HAVE_ABSL
using FlatMap = Numbering<absl::flat_hash_map<std::string, int>>;
void BM_FlatHashMap_New(benchmark::State& state) { internNew<FlatMap>(state); }
void BM_FlatHashMap_Again(benchmark::State& state) {
  internAgain<FlatMap>(state);
}
#else
HX_MISSING_PEER(BM_FlatHashMap_New, "libabsl-dev")
HX_MISSING_PEER(BM_FlatHashMap_Again, "libabsl-dev")
#endif

#ifdef HX_HAVE_LLVM
using StringMap = Numbering<llvm::StringMap<int>>;
void BM_StringMap_New(benchmark::State& state) { internNew<StringMap>(state); }
void BM_StringMap_Again(benchmark::State& state) {
  internAgain<StringMap>(state);
}
#else
HX_MISSING_PEER(BM_StringMap_New, "llvm-14-dev")
HX_MISSING_PEER(BM_StringMap_Again, "llvm-14-dev")
#endif

void sizes(benchmark::internal::Benchmark* benchmark) {
  benchmark->Arg(10000)->Arg(100000)->Arg(1000000);
}

BENCHMARK(BM_StringIdServer_New)->Apply(sizes);
BENCHMARK(BM_StringMap_New)->Apply(sizes);
BENCHMARK(BM_UnorderedMap_New)->Apply(sizes);
BENCHMARK(BM_FlatHashMap_New)->Apply(sizes);
BENCHMARK(BM_StringIdServer_Again)->Apply(sizes);
BENCHMARK(BM_StringMap_Again)->Apply(sizes);
BENCHMARK(BM_UnorderedMap_Again)->Apply(sizes);
BENCHMARK(BM_FlatHashMap_Again)->Apply(sizes);
BENCHMARK(BM_StringIdServer_OneSum)->Apply(sizes);
BENCHMARK(BM_StringIdServer_Text)->Apply(sizes);
BENCHMARK(BM_Vector_Text)->Apply(sizes);

}  // namespace
