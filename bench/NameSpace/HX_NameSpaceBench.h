// Shared by the name space benchmarks: peers and made-up names.

#ifndef NAMESPACE_HX_NAMESPACEBENCH_H
#define NAMESPACE_HX_NAMESPACEBENCH_H

#include <benchmark/benchmark.h>

#include <random>
#include <string>
#include <vector>

// Defines the benchmark `name` for a peer that is not installed.
#define HX_MISSING_PEER(name, package)                   \
  void name(benchmark::State& state) {                   \
    state.SkipWithError("peer not installed: " package); \
  }

/// Distinct names of 8 to 45 characters, of words as a generator joins them.
inline std::vector<std::string> makeNames(std::size_t count, unsigned seed) {
  static const char* const kWords[] = {"gain",  "Sa1",    "engine", "speed",
                                       "x",     "filter", "Out",    "torque",
                                       "State", "lookup", "err",    "Sum"};
  std::mt19937 random(seed);
  std::vector<std::string> names;
  for (std::size_t i = 0; i < count; ++i) {
    std::string name = std::to_string(i) + "_";
    name.insert(name.begin(), static_cast<char>('a' + random() % 26));
    const std::size_t length = 8 + random() % 38;
    while (name.size() < length) {
      name += kWords[random() % 12];
      name += '_';
    }
    name.resize(length < 8 ? 8 : length, 'z');
    names.push_back(name);
  }
  return names;
}

#endif  // NAMESPACE_HX_NAMESPACEBENCH_H
