// Station text both ways: called once per listed station when reports and stake-out sheets are built.
#include <benchmark/benchmark.h>

#include "svymath/formats/station_text.h"

namespace {

void BM_StnToString(benchmark::State& state) {
  double station = 1234.567;
  for (auto _ : state) {
    benchmark::DoNotOptimize(StnToString(station, 1000.0));
    station += 0.731;
  }
}
BENCHMARK(BM_StnToString);

void BM_StnFromString(benchmark::State& state) {
  const svy_text::CSvyString texts[] = {L"1+234.57", L"-1+-234.50", L"12+5,30", L"1234.567"};
  std::size_t i = 0;
  double station = 0.0;
  for (auto _ : state) {
    benchmark::DoNotOptimize(StnFromString(texts[i++ % 4], station, 1000.0));
    benchmark::DoNotOptimize(station);
  }
}
BENCHMARK(BM_StnFromString);

}  // namespace
