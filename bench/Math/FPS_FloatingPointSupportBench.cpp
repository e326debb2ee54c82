// Floating-point operations beside the bare calls of the C run-time in them.
// An item is a call.

#include "Math/FPS_FloatingPointSupport.h"

#include <benchmark/benchmark.h>

#include <cmath>
#include <random>
#include <vector>

#include "Control/HX_SelfCheck.h"
#include "platform/messages/HX_MessageHandler.h"

namespace {

// Half of the values are integers, as many periods and limits are.
std::vector<double> values(double scale) {
  std::mt19937_64 random(20260722);
  std::vector<double> result(1024);
  for (double& x : result) {
    x = scale * std::ldexp(static_cast<double>(random() >> 11), -53);
    if (random() % 2 == 0) x = std::floor(x) + 1.0;
  }
  return result;
}

template <class Operation>
void measure(benchmark::State& state, Operation operation) {
  const std::vector<double> xs = values(1000.0);
  for (auto _ : state) {
    for (double x : xs) benchmark::DoNotOptimize(operation(x));
  }
  state.SetItemsProcessed(state.iterations() *
                          static_cast<std::int64_t>(xs.size()));
}

// A line per operation: benchmark of the operation and of the bare calls.
#define HX_BENCH(name, ours, bare)                 \
  void BM_FPS_##name(benchmark::State& state) {    \
    measure(state, [](double x) { return ours; }); \
  }                                                \
  BENCHMARK(BM_FPS_##name);                        \
  void BM_Libm_##name(benchmark::State& state) {   \
    measure(state, [](double x) { return bare; }); \
  }                                                \
  BENCHMARK(BM_Libm_##name)

double bareRoundOffBits(double x) {
  int exponent = 0;
  const double mantissa = std::frexp(x, &exponent);
  const double rounded = std::floor(std::ldexp(mantissa, 20));
  return std::ldexp(std::ldexp(rounded, -20), exponent);
}

HX_BENCH(IsIntegerValue, FPS_IsIntegerValue(x), std::floor(x));
HX_BENCH(RoundUp, FPS_RoundUp(x), std::floor(x));
HX_BENCH(RoundDown, FPS_RoundDown(x), std::floor(x));
HX_BENCH(RoundOffBits, FPS_RoundOffBits(x, 20), bareRoundOffBits(x));
HX_BENCH(RoundOffDigits, FPS_RoundOffDigits(x), std::floor(x));
HX_BENCH(Modulo, FPS_SimulinkAlikeModulo(x, 7.5), std::floor(x));
HX_BENCH(Sqrt, FPS_SimulinkAlikeSqrt(x), std::sqrt(x));
HX_BENCH(Log2, FPS_Log2(x), std::log(x));
HX_BENCH(Log2Int, FPS_Log2Int(x), std::log(x));
HX_BENCH(GetPowerOf2, FPS_GetPowerOf2(x), std::log(x));
HX_BENCH(GetGreaterPowerOf2, FPS_GetGreaterPowerOf2(x), std::log(x));
HX_BENCH(ASinh, FPS_ASinh(x), std::log(std::sqrt(x)));
HX_BENCH(ACosh, FPS_ACosh(x), std::log(std::sqrt(x)));
HX_BENCH(ATanh, FPS_ATanh(x / 2048.0), std::log(x));

// The divisor reports every step; the bare chain makes the same reports.
void BM_FPS_GreatestCommonDivisor(benchmark::State& state) {
  for (auto _ : state) {
    double pair[] = {48000.0, 44100.0};
    benchmark::DoNotOptimize(FPS_FindGreatestCommonDivisor(pair));
    HX_MessageHandler::instance().clear();
  }
  state.SetItemsProcessed(state.iterations());
}
BENCHMARK(BM_FPS_GreatestCommonDivisor);

void BM_Libm_GreatestCommonDivisor(benchmark::State& state) {
  for (auto _ : state) {
    double a = 48000.0;
    double b = 44100.0;
    HX_Assert(false, "Math/FPS_FloatingPointSupport.cpp_");
    while (b != 0.0) {
      const double rest = std::fmod(a, b);
      a = b;
      b = rest;
      HX_Assert(false, "Math/FPS_FloatingPointSupport.cpp_");
    }
    benchmark::DoNotOptimize(a);
    HX_MessageHandler::instance().clear();
  }
  state.SetItemsProcessed(state.iterations());
}
BENCHMARK(BM_Libm_GreatestCommonDivisor);

}  // namespace
