// Hot paths of the vertical alignment and the pair: the height at a chainage on profiles of 10, 100 and 1,000
// elements (grade lines and parabolas in turn), and the 3-D position at a chainage and offset on a pair of
// 10 and 100 horizontal elements (tangent, spirals, arc in turn) over a profile of as many, queried at
// chainages spread over the whole length.
#include <benchmark/benchmark.h>

#include "svymath/alignments/alnt_pair.h"
#include "svymath/alignments/horz_element_arc.h"
#include "svymath/alignments/horz_element_segment.h"
#include "svymath/alignments/horz_element_spiral.h"
#include "svymath/alignments/vertical_element.h"

namespace {

void fillProfile(CAlntV& profile, int elements) {
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
}

CAlntV benchProfile(int elements) {
  CAlntV profile;
  profile.setStartChainageInM(12000.0);
  profile.setStartHeight(350.0);
  fillProfile(profile, elements);
  return profile;
}

// Tangent, entry clothoid, arc, exit clothoid in turn, at survey coordinates.
CHorzAndVertAlnt benchPair(int elements) {
  CHorzAndVertAlnt pair;
  pair.setStartPos(5000000.0, 500000.0, 350.0);
  pair.setStartChainageInM(12000.0);
  pair.onBulkUpdateStarted();
  for (int i = 0; i < elements; ++i) {
    const bool right = (i / 4) % 2 == 0;
    if (i % 4 == 0) {
      CAlntHeSegment tangent;
      tangent.setStartAndFinal(C2dPos(0.0, 0.0), C2dPos(80.0, 0.0));
      pair.appendElement(tangent);
    } else if (i % 2 == 1) {
      CCurveDataSpiral data(eMathSpiralEuler);
      data.setLenAndR(60.0, 600.0, right, i % 4 == 1);
      pair.appendElement(CAlntHeSpiral(CCurveSpiral(0.0, 0.0, CMathAngle(0.0), data)));
    } else {
      CCurveDataArc data;
      data.SetElement(60.0, 600.0, right);
      CAlntHeArc arc;
      arc.set_data(CCurveArc(0.0, 0.0, CMathAngle(0.0), data));
      pair.appendElement(arc);
    }
  }
  pair.onBulkUpdateFinished();
  fillProfile(pair.getAlntVes(), elements);
  return pair;
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

void BM_PairPosAtChainAndOffset(benchmark::State& state) {
  const CHorzAndVertAlnt pair = benchPair(static_cast<int>(state.range(0)));
  double final = 0.0;
  pair.getFinalChainageInM(final);
  double chainages[64];
  for (int i = 0; i < 64; ++i) chainages[i] = 12000.0 + (final - 12000.0) * ((i * 37) % 64) / 63.0;
  int i = 0;
  for (auto _ : state) {
    TCoords position;
    const int k = i++ & 63;
    benchmark::DoNotOptimize(pair.getPosAtChainAndOffset(chainages[k], (k % 7) - 3.0, position));
    benchmark::DoNotOptimize(position);
  }
}
BENCHMARK(BM_PairPosAtChainAndOffset)->Arg(10)->Arg(100);

}  // namespace
