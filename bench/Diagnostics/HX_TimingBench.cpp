// Cost of timing. One item is one start and one stop.

#include <benchmark/benchmark.h>

#include <chrono>
#include <memory>
#include <vector>

#include "Diagnostics/HX_StopWatch.h"
#include "Diagnostics/HxCDebugServer.h"

namespace {

// The peer: an interval between two readings of the standard clock, added up.
void BM_Std_TwoClockReads(benchmark::State& state) {
  std::chrono::steady_clock::duration total{};
  for (auto _ : state) {
    const auto start = std::chrono::steady_clock::now();
    benchmark::DoNotOptimize(start);
    total += std::chrono::steady_clock::now() - start;
    benchmark::DoNotOptimize(total);
  }
  state.SetItemsProcessed(state.iterations());
}
BENCHMARK(BM_Std_TwoClockReads);

void BM_DebugServer_Clock(benchmark::State& state) {
  HxCDebugServer server;
  server.boot();
  for (auto _ : state) {
    server.clockStart(eClockCommon1);
    server.clockStop(eClockCommon1);
  }
  state.SetItemsProcessed(state.iterations());
}
BENCHMARK(BM_DebugServer_Clock);

// The argument is the number of further registered watches; all are idle.
void BM_StopWatch_StartStop(benchmark::State& state) {
  std::vector<std::unique_ptr<HX_StopWatch>> idle;
  for (std::int64_t i = 0; i < state.range(0); ++i)
    idle.push_back(std::make_unique<HX_StopWatch>("idle"));
  HX_StopWatch watch("measured");
  for (auto _ : state) {
    watch.start();
    watch.stop();
  }
  benchmark::DoNotOptimize(watch.getTotalTime());
  state.SetItemsProcessed(state.iterations());
}
BENCHMARK(BM_StopWatch_StartStop)->Arg(0)->Arg(1000);

// The argument is the number of surrounding running watches.
void BM_StopWatch_Nested(benchmark::State& state) {
  std::vector<std::unique_ptr<HX_StopWatch>> outer;
  for (std::int64_t i = 0; i < state.range(0); ++i) {
    outer.push_back(std::make_unique<HX_StopWatch>("outer"));
    outer.back()->start();
  }
  HX_StopWatch watch("measured");
  for (auto _ : state) {
    watch.start();
    watch.stop();
  }
  state.SetItemsProcessed(state.iterations());
}
BENCHMARK(BM_StopWatch_Nested)->Arg(1)->Arg(8);

}  // namespace
