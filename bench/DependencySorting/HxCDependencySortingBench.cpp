// The dependency sorter beside Kahn's algorithm, a graph library and std::sort.
//
// Item of work: a node, handed over by pointer with its dependencies, given
// back at its place in an array of pointers. Every method starts from two
// arrays, of node pointers and of pairs of node pointers. The index from
// pointers to numbers is part of the measured work.

#include <benchmark/benchmark.h>

#include <algorithm>
#include <numeric>
#include <random>
#include <string>
#include <unordered_map>
#include <utility>
#include <vector>

#include "DependencySorting/HxCDepSortComp.h"
#include "DependencySorting/HxCDepSortNode.h"
#include "DependencySorting/HxCDependencySorting.h"
#include "platform/strings/KyCXString.h"

#ifdef HX_HAVE_BOOST_GRAPH
#include <boost/graph/adjacency_list.hpp>
#include <boost/graph/topological_sort.hpp>
#endif

namespace {

class Node : public HxCDepSortNode {
 public:
  Node(const std::string& name, int key) : m_Name(name.c_str()), m_Key(key) {}
  const KyCXString& getName() override { return m_Name; }
  int key() const { return m_Key; }

 private:
  KyCXString m_Name;
  int m_Key;
};

// Not inlined, because the sorter cannot inline the criterion of a caller
// either: sorter and peer pay for the call.
class ByKey : public HxCDepSortComp {
 public:
  int compare(HxCDepSortNode* a, HxCDepSortNode* b) override;
};

[[gnu::noinline]] int ByKey::compare(HxCDepSortNode* a, HxCDepSortNode* b) {
  return static_cast<Node*>(a)->key() - static_cast<Node*>(b)->key();
}

using Nodes = std::vector<HxCDepSortNode*>;

struct Input {
  std::vector<Node> store;
  Nodes nodes;
  std::vector<std::pair<HxCDepSortNode*, HxCDepSortNode*>> edges;
};

constexpr unsigned kSeed = 20070314;

std::vector<int> shuffled(int count) {
  std::vector<int> numbers(static_cast<std::size_t>(count));
  std::iota(numbers.begin(), numbers.end(), 0);
  std::shuffle(numbers.begin(), numbers.end(), std::mt19937(kSeed));
  return numbers;
}

// Nodes with these numbers as their keys and in their names.
Input nodesOf(const std::vector<int>& numbers) {
  Input input;
  input.store.reserve(numbers.size());
  for (int number : numbers)
    input.store.emplace_back("Sa1_Signal" + std::to_string(number), number);
  for (Node& node : input.store) input.nodes.push_back(&node);
  return input;
}

// A hundred layers; every node depends on three nodes of the layer before. The
// first dependency leaves no node isolated.
Input layered(int count) {
  Input input = nodesOf(shuffled(count));
  const std::size_t width = static_cast<std::size_t>(count) / 100;
  std::mt19937 random(kSeed);
  for (std::size_t i = width; i < input.nodes.size(); ++i) {
    const std::size_t before = (i / width - 1) * width;
    for (std::size_t place : {i % width, random() % width, random() % width})
      input.edges.emplace_back(input.nodes[before + place], input.nodes[i]);
  }
  return input;
}

// All nodes before the last one.
Input fanIn(int count) {
  Input input = nodesOf(shuffled(count));
  for (std::size_t i = 0; i + 1 < input.nodes.size(); ++i)
    input.edges.emplace_back(input.nodes[i], input.nodes.back());
  return input;
}

Input isolatedRandom(int count) { return nodesOf(shuffled(count)); }

Input isolatedSorted(int count) {
  std::vector<int> numbers(static_cast<std::size_t>(count));
  std::iota(numbers.begin(), numbers.end(), 0);
  return nodesOf(numbers);
}

Input isolatedReversed(int count) {
  std::vector<int> numbers(static_cast<std::size_t>(count));
  std::iota(numbers.rbegin(), numbers.rend(), 0);
  return nodesOf(numbers);
}

// Two nodes per key, rising: a Quicksort with the last element as pivot takes
// n^2 steps.
Input isolatedPairs(int count) {
  std::vector<int> numbers(static_cast<std::size_t>(count));
  for (int i = 0; i < count; ++i) numbers[static_cast<std::size_t>(i)] = i / 2;
  return nodesOf(numbers);
}

leda::array<HxCDepSortNode*> sortedByUs(const Input& input) {
  ByKey byKey;
  HxCDependencySorting sorting;
  sorting.setSortingCriteriaAndInit({&byKey});
  for (HxCDepSortNode* node : input.nodes) sorting.add(node);
  for (auto [first, second] : input.edges) sorting.addDependency(first, second);
  sorting.sort();
  return sorting.getNodes();
}

std::unordered_map<HxCDepSortNode*, int> numbersOf(const Nodes& nodes) {
  std::unordered_map<HxCDepSortNode*, int> numbers(nodes.size());
  for (HxCDepSortNode* node : nodes)
    numbers.emplace(node, static_cast<int>(numbers.size()));
  return numbers;
}

Nodes sortedByKahn(const Input& input) {
  const auto numbers = numbersOf(input.nodes);
  std::vector<std::vector<int>> successors(input.nodes.size());
  std::vector<int> waitsFor(input.nodes.size());
  for (auto [first, second] : input.edges) {
    const int target = numbers.find(second)->second;
    successors[static_cast<std::size_t>(numbers.find(first)->second)].push_back(
        target);
    ++waitsFor[static_cast<std::size_t>(target)];
  }
  std::vector<int> order;
  const auto sortFrom = [&](std::size_t batch) {
    std::sort(
        order.begin() + static_cast<std::ptrdiff_t>(batch), order.end(),
        [&](int a, int b) {
          return input.nodes[static_cast<std::size_t>(a)]
                     ->getName()
                     .compareWith(
                         input.nodes[static_cast<std::size_t>(b)]->getName()) <
                 0;
        });
  };
  for (std::size_t i = 0; i < waitsFor.size(); ++i) {
    if (waitsFor[i] == 0) order.push_back(static_cast<int>(i));
  }
  sortFrom(0);
  for (std::size_t head = 0; head < order.size(); ++head) {
    const std::size_t batch = order.size();
    for (int target : successors[static_cast<std::size_t>(order[head])]) {
      if (--waitsFor[static_cast<std::size_t>(target)] == 0)
        order.push_back(target);
    }
    sortFrom(batch);
  }
  Nodes result;
  result.reserve(order.size());
  for (int i : order)
    result.push_back(input.nodes[static_cast<std::size_t>(i)]);
  return result;
}

Nodes sortedByStd(const Input& input) {
  ByKey byKey;
  HxCDepSortComp* comp = &byKey;
  Nodes result = input.nodes;
  std::sort(result.begin(), result.end(),
            [&](HxCDepSortNode* a, HxCDepSortNode* b) {
              return comp->compare(a, b) < 0;
            });
  return result;
}

template <Input (*Make)(int), auto Sort>
void BM_Sort(benchmark::State& state) {
  const Input input = Make(static_cast<int>(state.range(0)));
  for (auto _ : state) benchmark::DoNotOptimize(Sort(input));
  state.SetItemsProcessed(state.iterations() * state.range(0));
}

// Ours, once compared with a peer that must give the same order.
template <Input (*Make)(int), auto Peer>
void BM_Ours(benchmark::State& state) {
  const Input input = Make(static_cast<int>(state.range(0)));
  const auto ours = sortedByUs(input);
  const auto peer = Peer(input);
  if (!std::equal(ours.begin(), ours.end(), peer.begin(), peer.end())) {
    state.SkipWithError("wrong order");
    return;
  }
  for (auto _ : state) benchmark::DoNotOptimize(sortedByUs(input));
  state.SetItemsProcessed(state.iterations() * state.range(0));
}

#ifdef HX_HAVE_BOOST_GRAPH
Nodes sortedByBoost(const Input& input) {
  using Graph =
      boost::adjacency_list<boost::vecS, boost::vecS, boost::directedS>;
  const auto numbers = numbersOf(input.nodes);
  Graph graph(input.nodes.size());
  for (auto [first, second] : input.edges) {
    boost::add_edge(static_cast<std::size_t>(numbers.find(first)->second),
                    static_cast<std::size_t>(numbers.find(second)->second),
                    graph);
  }
  std::vector<std::size_t> order;
  boost::topological_sort(graph, std::back_inserter(order));
  Nodes result;
  result.reserve(order.size());
  for (auto i = order.rbegin(); i != order.rend(); ++i)
    result.push_back(input.nodes[*i]);
  return result;
}
#else
void BM_NoBoost(benchmark::State& state) {
  state.SkipWithError("peer not installed: libboost-graph-dev");
}
#endif

void sizes(benchmark::internal::Benchmark* bench) {
  bench->RangeMultiplier(10)
      ->Range(1000, 1'000'000)
      ->Unit(benchmark::kMillisecond);
}

#define HX_BENCH(name, ...) \
  BENCHMARK(__VA_ARGS__)->Name("BM_" name)->Apply(sizes)

HX_BENCH("DependencySorting_Layered", BM_Ours<layered, sortedByKahn>);
HX_BENCH("Kahn_Layered", BM_Sort<layered, sortedByKahn>);
#ifdef HX_HAVE_BOOST_GRAPH
HX_BENCH("Boost_Layered", BM_Sort<layered, sortedByBoost>);
#else
HX_BENCH("Boost_Layered", BM_NoBoost);
#endif
HX_BENCH("DependencySorting_FanIn", BM_Ours<fanIn, sortedByKahn>);
HX_BENCH("Kahn_FanIn", BM_Sort<fanIn, sortedByKahn>);
HX_BENCH("DependencySorting_Random", BM_Ours<isolatedRandom, sortedByStd>);
HX_BENCH("Std_Random", BM_Sort<isolatedRandom, sortedByStd>);
HX_BENCH("DependencySorting_Presorted", BM_Ours<isolatedSorted, sortedByStd>);
HX_BENCH("Std_Presorted", BM_Sort<isolatedSorted, sortedByStd>);
HX_BENCH("DependencySorting_Reversed", BM_Ours<isolatedReversed, sortedByStd>);
HX_BENCH("Std_Reversed", BM_Sort<isolatedReversed, sortedByStd>);
HX_BENCH("DependencySorting_Pairs", BM_Sort<isolatedPairs, sortedByUs>);
HX_BENCH("Std_Pairs", BM_Sort<isolatedPairs, sortedByStd>);

}  // namespace
