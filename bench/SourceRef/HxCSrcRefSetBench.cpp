// Sets of references beside vectors that skip references already present.
//
// An item is a set: made empty, filled with the given number of different
// references, walked once, and destroyed. The last group measures the cost of a
// reference of the server by the number of references: an item is a reference.

#include <benchmark/benchmark.h>

#include <algorithm>
#include <cstdint>
#include <memory>
#include <vector>

#include "SourceRef/HxCInternalSrcRef.h"
#include "SourceRef/HxCSrcRefServer.h"
#include "SourceRef/HxCSrcRefSet.h"

#if __has_include("absl/container/inlined_vector.h")
#include "absl/container/inlined_vector.h"
#define HX_HAS_INLINED_VECTOR 1
#endif

namespace {

template <class Vector>
class VectorSet {
 public:
  void addSrcRef(const HxCSrcRef* ref) {
    if (std::find(m_Refs.begin(), m_Refs.end(), ref) == m_Refs.end())
      m_Refs.push_back(ref);
  }
  template <class Visit>
  void forEach(Visit visit) const {
    for (const HxCSrcRef* ref : m_Refs) visit(ref);
  }

 private:
  Vector m_Refs;
};

template <class Set>
void walk(const Set& set, std::uintptr_t& sum) {
  set.forEach([&](const HxCSrcRef* ref) {
    sum += reinterpret_cast<std::uintptr_t>(ref);
  });
}

// The same through an iterator, as callers of the library walk a set.
struct IteratedSet : HxCSrcRefSet {};
void walk(const IteratedSet& set, std::uintptr_t& sum) {
  const std::unique_ptr<HX_Iterator<const HxCSrcRef*>> it(set.createIterator());
  for (; !it->isDone(); it->next())
    sum += reinterpret_cast<std::uintptr_t>(it->currentItem());
}

template <class Set>
void buildAndWalk(benchmark::State& state) {
  const std::vector<HxCSrcRef> refs(static_cast<std::size_t>(state.range(0)));
  std::uintptr_t expected = 0;
  for (const HxCSrcRef& ref : refs)
    expected += reinterpret_cast<std::uintptr_t>(&ref);
  std::uintptr_t sum = 0;
  for (auto _ : state) {
    Set set;
    for (const HxCSrcRef& ref : refs) {
      set.addSrcRef(&ref);
      benchmark::DoNotOptimize(set);
    }
    sum = 0;
    walk(set, sum);
    benchmark::DoNotOptimize(sum);
  }
  if (sum != expected) state.SkipWithError("the set lost a reference");
  state.SetItemsProcessed(state.iterations());
}

void BM_SrcRefSet_BuildAndWalk(benchmark::State& state) {
  buildAndWalk<HxCSrcRefSet>(state);
}
void BM_SrcRefSet_BuildAndIterate(benchmark::State& state) {
  buildAndWalk<IteratedSet>(state);
}
void BM_StdVector_BuildAndWalk(benchmark::State& state) {
  buildAndWalk<VectorSet<std::vector<const HxCSrcRef*>>>(state);
}
void BM_InlinedVector_BuildAndWalk(benchmark::State& state) {
#ifdef HX_HAS_INLINED_VECTOR
  buildAndWalk<VectorSet<absl::InlinedVector<const HxCSrcRef*, 1>>>(state);
#else
  state.SkipWithError("peer not installed: libabsl-dev");
#endif
}

void BM_SrcRefServer_GetSrcRef(benchmark::State& state) {
  for (auto _ : state) {
    HxCSrcRefServer server;
    for (std::int64_t count = 0; count < state.range(0); ++count)
      benchmark::DoNotOptimize(server.getSrcRef());
  }
  state.SetItemsProcessed(state.iterations() * state.range(0));
}

#define HX_SIZES Arg(0)->Arg(1)->Arg(2)->Arg(8)->Arg(64)
BENCHMARK(BM_SrcRefSet_BuildAndWalk)->HX_SIZES;
BENCHMARK(BM_SrcRefSet_BuildAndIterate)->HX_SIZES;
BENCHMARK(BM_StdVector_BuildAndWalk)->HX_SIZES;
BENCHMARK(BM_InlinedVector_BuildAndWalk)->HX_SIZES;
// Few references, so that the C heap keeps the pages between rounds.
BENCHMARK(BM_SrcRefServer_GetSrcRef)->Arg(64)->Arg(512);

}  // namespace
