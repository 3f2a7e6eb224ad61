// Decimal rounding and number text: round_prec runs inside every DMS and feet-inch conversion.
#include <benchmark/benchmark.h>

#include "svyutils/round_prec.h"
#include "svyutils/svy_number_text.h"

namespace {

void BM_RoundPrec(benchmark::State& state) {
  double value = 2.675;
  for (auto _ : state) {
    benchmark::DoNotOptimize(svy::math::round_prec(value, 2));
    value += 0.0137;
  }
}
BENCHMARK(BM_RoundPrec);

void BM_DoubleToString(benchmark::State& state) {
  double value = 5012345.6789;
  for (auto _ : state) {
    benchmark::DoNotOptimize(svy_formats::DoubleToString(value, 3));
    value += 0.0137;
  }
}
BENCHMARK(BM_DoubleToString);

void BM_StringToDouble(benchmark::State& state) {
  const svy_text::CSvyString text(L" 5012345.6789 ");
  double value = 0.0;
  for (auto _ : state) {
    benchmark::DoNotOptimize(svy_formats::StringToDouble(text, value));
    benchmark::DoNotOptimize(value);
  }
}
BENCHMARK(BM_StringToDouble);

}  // namespace
