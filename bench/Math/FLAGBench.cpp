// Counting and testing flags. One item is one word of a table of random words.

#include "FLAG.h"

#include <benchmark/benchmark.h>

#include <bit>
#include <random>
#include <vector>

namespace {

std::vector<unsigned int> randomWords() {
  std::mt19937 random(20260722);
  std::vector<unsigned int> words(4096);
  for (unsigned int& word : words) word = static_cast<unsigned int>(random());
  return words;
}

template <class Count>
void countAll(benchmark::State& state, Count count) {
  std::vector<unsigned int> words = randomWords();
  for (auto _ : state) {
    int total = 0;
    for (unsigned int& word : words) total += count(word);
    benchmark::DoNotOptimize(total);
  }
  state.SetItemsProcessed(state.iterations() *
                          static_cast<std::int64_t>(words.size()));
}

void BM_FLAG_Count(benchmark::State& state) {
  countAll(state, [](unsigned int& word) {
    return FLAG_GetNumberOfFlagsInField(&word);
  });
}
BENCHMARK(BM_FLAG_Count);

void BM_Std_Popcount(benchmark::State& state) {
  countAll(state, [](unsigned int& word) { return std::popcount(word); });
}
BENCHMARK(BM_Std_Popcount);

void BM_FLAG_GetFlag(benchmark::State& state) {
  countAll(state,
           [](unsigned int& word) { return int{FLAG_GetFlag(&word, 0x10)}; });
}
BENCHMARK(BM_FLAG_GetFlag);

void BM_Plain_BitTest(benchmark::State& state) {
  countAll(state, [](unsigned int& word) { return int{(word & 0x10) != 0}; });
}
BENCHMARK(BM_Plain_BitTest);

}  // namespace
