// Hot paths of the vertical alignment: the height at a chainage on profiles of 10, 100 and 1,000 elements
// (grade lines and parabolas in turn), queried at chainages spread over the whole profile.
#include <benchmark/benchmark.h>

#include "svymath/alignments/alnt_v.h"
#include "svymath/alignments/vertical_element.h"

namespace {

CAlntV benchProfile(int elements) {
  CAlntV profile;
  profile.setStartChainageInM(12000.0);
  profile.setStartHeight(350.0);
  profile.onBulkUpdateStarted();
  CVerticalElement e;
  for (int i = 0; i < elements; ++i) {
    if (i % 2 == 0) {
      e.setStraight(80.0, (i % 4 == 0) ? 2.0 : -1.5);
    } else {
      e.setParabola(60.0, (i % 4 == 1) ? 2.0 : -1.5, (i % 4 == 1) ? -1.5 : 2.0);
    }
    profile.appendElement(e);
  }
  profile.onBulkUpdateFinished();
  return profile;
}

void BM_VerticalHeightAtChain(benchmark::State& state) {
  const CAlntV profile = benchProfile(static_cast<int>(state.range(0)));
  double final = 0.0;
  profile.getFinalChainageInM(final);
  double chainages[64];
  for (int i = 0; i < 64; ++i) chainages[i] = 12000.0 + (final - 12000.0) * ((i * 37) % 64) / 63.0;
  int i = 0;
  for (auto _ : state) {
    double height = 0.0;
    benchmark::DoNotOptimize(profile.getHeightAtChain(chainages[i++ & 63], height));
    benchmark::DoNotOptimize(height);
  }
}
BENCHMARK(BM_VerticalHeightAtChain)->Arg(10)->Arg(100)->Arg(1000);

}  // namespace
