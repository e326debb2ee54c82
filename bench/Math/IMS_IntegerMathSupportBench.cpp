// Divisors, multiples, logarithms and conversions to and from big integers,
// beside the operations of other libraries. An item is an operand or a pair.

#include "Math/IMS_IntegerMathSupport.h"

#include <benchmark/benchmark.h>

#include <bit>
#include <climits>
#include <numeric>
#include <random>
#include <utility>
#include <vector>

#include "LedaIntegerSupport.h"

#if __has_include(<boost/multiprecision/cpp_int.hpp>)
#include <boost/integer/common_factor_rt.hpp>
#include <boost/multiprecision/cpp_int.hpp>
#define HX_HAS_BOOST 1
#endif
#if __has_include(<gmp.h>)
#include <gmp.h>
#define HX_HAS_GMP 1
#endif

namespace {

using Pair = std::pair<long long, long long>;

enum Inputs { eMixed, eFibonacci, eSampleRates, e63Bits };

std::vector<Pair> pairsOf(std::int64_t inputs) {
  const long long rates[] = {8000,  11025, 16000, 22050, 32000,
                             44100, 48000, 96000, 192000};
  std::vector<long long> fibonacci = {1, 1};
  while (fibonacci.size() < 91) {
    fibonacci.push_back(fibonacci.back() + fibonacci[fibonacci.size() - 2]);
  }
  std::mt19937_64 random(20260722);
  const auto positive = [&random](unsigned long long bits) {
    return static_cast<long long>(random() >> (64 - bits)) | 1LL << (bits - 1);
  };
  std::vector<Pair> pairs(1024);
  for (auto& [a, b] : pairs) {
    switch (inputs) {
      case eMixed:
        a = positive(1 + random() % 63);
        b = positive(1 + random() % 63);
        break;
      case eFibonacci: {
        const std::size_t place = 1 + random() % 90;
        a = fibonacci[place];
        b = fibonacci[place - 1];
        break;
      }
      case eSampleRates:
        a = rates[random() % 9];
        b = rates[random() % 9];
        break;
      default:
        a = positive(63);
        b = positive(63);
    }
  }
  return pairs;
}

template <class Operation>
void overPairs(benchmark::State& state, std::int64_t inputs,
               Operation operation) {
  const std::vector<Pair> pairs = pairsOf(inputs);
  for (auto _ : state) {
    for (const auto& [a, b] : pairs) {
      benchmark::DoNotOptimize(operation(a, b));
    }
  }
  state.SetItemsProcessed(state.iterations() *
                          static_cast<std::int64_t>(pairs.size()));
}

void BM_IMS_Gcd(benchmark::State& state) {
  overPairs(state, state.range(0), [](long long a, long long b) {
    long long pair[] = {a, b};
    return IMS_FindGreatestCommonDivisor(pair);
  });
}
BENCHMARK(BM_IMS_Gcd)->DenseRange(eMixed, e63Bits);

void BM_Std_Gcd(benchmark::State& state) {
  overPairs(state, state.range(0),
            [](long long a, long long b) { return std::gcd(a, b); });
}
BENCHMARK(BM_Std_Gcd)->DenseRange(eMixed, e63Bits);

void BM_Boost_Gcd(benchmark::State& state) {
#if defined(HX_HAS_BOOST)
  overPairs(state, state.range(0),
            [](long long a, long long b) { return boost::integer::gcd(a, b); });
#else
  state.SkipWithError("peer not installed: libboost-dev");
#endif
}
BENCHMARK(BM_Boost_Gcd)->DenseRange(eMixed, e63Bits);

void BM_IMS_Lcm(benchmark::State& state) {
  overPairs(state, eSampleRates, [](long long a, long long b) {
    long long pair[] = {a, b};
    return IMS_FindLeastCommonMultiple(2, pair, 0x1p62);
  });
}
BENCHMARK(BM_IMS_Lcm);

void BM_Std_Lcm(benchmark::State& state) {
  overPairs(state, eSampleRates,
            [](long long a, long long b) { return std::lcm(a, b); });
}
BENCHMARK(BM_Std_Lcm);

void BM_IMS_Log2(benchmark::State& state) {
  overPairs(state, eMixed, [](long long a, long long) { return IMS_Log2(a); });
}
BENCHMARK(BM_IMS_Log2);

void BM_Std_BitWidth(benchmark::State& state) {
  overPairs(state, eMixed, [](long long a, long long) {
    return static_cast<int>(
               std::bit_width(static_cast<unsigned long long>(a))) -
           1;
  });
}
BENCHMARK(BM_Std_BitWidth);

void BM_Leda_ToInteger(benchmark::State& state) {
  overPairs(state, eMixed, [](long long a, long long) { return toInteger(a); });
}
BENCHMARK(BM_Leda_ToInteger);

void BM_Boost_ToInteger(benchmark::State& state) {
#if defined(HX_HAS_BOOST)
  overPairs(state, eMixed, [](long long a, long long) {
    return boost::multiprecision::cpp_int(a);
  });
#else
  state.SkipWithError("peer not installed: libboost-dev");
#endif
}
BENCHMARK(BM_Boost_ToInteger);

// Back from big integers of up to 65 bits: about one in 64 saturates.
void BM_Leda_ToInt64(benchmark::State& state) {
  LedaIntegerSupportBoot();
  std::vector<leda::integer> values;
  for (const auto& [a, b] : pairsOf(eMixed)) {
    values.push_back(toInteger(a) + toInteger(a));
  }
  for (auto _ : state) {
    for (const leda::integer& value : values) {
      benchmark::DoNotOptimize(toInt64(value));
    }
  }
  state.SetItemsProcessed(state.iterations() *
                          static_cast<std::int64_t>(values.size()));
}
BENCHMARK(BM_Leda_ToInt64);

void BM_Gmp_ToInt64(benchmark::State& state) {
#if defined(HX_HAS_GMP)
  const std::vector<Pair> pairs = pairsOf(eMixed);
  std::vector<mpz_t> values(pairs.size());
  for (std::size_t i = 0; i < pairs.size(); ++i) {
    mpz_init_set_si(values[i], pairs[i].first);
    mpz_mul_2exp(values[i], values[i], 1);
  }
  for (auto _ : state) {
    for (const mpz_t& value : values) {
      long result = 0;
      if (mpz_fits_slong_p(value) != 0) {
        result = mpz_get_si(value);
      } else {
        result = mpz_sgn(value) < 0 ? LONG_MIN : LONG_MAX;
      }
      benchmark::DoNotOptimize(result);
    }
  }
  for (mpz_t& value : values) mpz_clear(value);
  state.SetItemsProcessed(state.iterations() *
                          static_cast<std::int64_t>(values.size()));
#else
  state.SkipWithError("peer not installed: libgmp-dev");
#endif
}
BENCHMARK(BM_Gmp_ToInt64);

}  // namespace
