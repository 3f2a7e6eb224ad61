// Point to chainage on horizontal alignments of 10, 100 and 1000 elements of every kind (tangents, arcs,
// clothoid and cubic transitions, intersection-point groups), for points scattered within 50 m of the centre
// line: the batch query and the single-point query, both through the spatial index, and the single-point
// query projecting every element (index switched off).
#include <benchmark/benchmark.h>

#include <random>
#include <vector>

#include "svymath/alignments/alignment_h.h"
#include "svymath/alignments/horz_element_arc.h"
#include "svymath/alignments/horz_element_ip.h"
#include "svymath/alignments/horz_element_segment.h"
#include "svymath/alignments/horz_element_spiral.h"

namespace {

constexpr double kNorth0 = 5000000.0;
constexpr double kEast0 = 500000.0;

// One element of the repeating ten-element pattern: tangent, clothoid-arc-clothoid to the right, tangent,
// cubic-arc-cubic to the left, and two intersection points 500 m apart turning 30 degrees, to the right and
// to the left in turn.
void appendPatternElement(CAlntH& alignment, int k) {
  const int slot = k % 10;
  const bool right = slot < 4;
  const AlntMathSpiralType law = slot < 4 ? eMathSpiralEuler : eMathSpiralCubic;
  if (slot == 0 || slot == 4) {
    CAlntHeSegment tangent;
    tangent.setStartAndFinal(C2dPos(0.0, 0.0), C2dPos(80.0, 0.0));
    alignment.appendElement(tangent);
  } else if (slot == 1 || slot == 3 || slot == 5 || slot == 7) {
    CCurveDataSpiral data(law);
    data.setLenAndR(60.0, 600.0, right, slot == 1 || slot == 5);
    alignment.appendElement(CAlntHeSpiral(CCurveSpiral(0.0, 0.0, CMathAngle(0.0), data)));
  } else if (slot == 2 || slot == 6) {
    CCurveDataArc data;
    data.SetElement(120.0, 600.0, right);
    CAlntHeArc arc;
    arc.set_data(CCurveArc(0.0, 0.0, CMathAngle(0.0), data));
    alignment.appendElement(arc);
  } else {
    C2dPos end;
    CMathAngle heading;
    alignment.getFinalPosNe(end.north(), end.east());
    alignment.getLastHe()->getFinalAzimut(heading);
    // Alternate turns keep the road running one way instead of winding round a circle.
    if (slot == 9) heading += CMathAngle((k / 10) % 2 == 0 ? 30.0 : -30.0);
    CAlntHeIp ip;
    ip.setIp(end.north() + 500.0 * heading.getCos(), end.east() + 500.0 * heading.getSin(), 400.0, 40.0, 40.0);
    alignment.appendElement(ip);
  }
}

struct TCase {
  CAlntH alignment;
  std::vector<double> north;
  std::vector<double> east;
};

TCase makeCase(int elements) {
  TCase c;
  c.alignment.setStartPos(kNorth0, kEast0, 0.0);
  // Appended one by one, so that each intersection point is placed from the chain laid out so far.
  for (int k = 0; k < elements; ++k) appendPatternElement(c.alignment, k);
  double length = 0.0;
  c.alignment.getHLengthInM(length);
  std::mt19937 rng(7);
  std::uniform_real_distribution<double> along(0.0, length), across(-50.0, 50.0);
  for (int i = 0; i < 1000; ++i) {
    double n = 0.0, e = 0.0;
    c.alignment.getPosNeAtChainAndOffsetExtr(along(rng), across(rng), n, e);
    c.north.push_back(n);
    c.east.push_back(e);
  }
  return c;
}

void BM_AlignmentBatchStation(benchmark::State& state) {
  const TCase c = makeCase(static_cast<int>(state.range(0)));
  std::vector<TAlntStationResult> results(c.north.size());
  for (auto _ : state) {
    benchmark::DoNotOptimize(
        c.alignment.FindChainagesAndOffsets(c.north.data(), c.east.data(), c.north.size(), results.data(), true));
  }
  state.SetItemsProcessed(state.iterations() * static_cast<long>(c.north.size()));
}

void findOneByOne(benchmark::State& state, bool useIndex) {
  TCase c = makeCase(static_cast<int>(state.range(0)));
  c.alignment.setUseSearchIndex(useIndex);
  std::size_t i = 0;
  for (auto _ : state) {
    double chainage = 0.0, offset = 0.0;
    bool extrapolated = false;
    benchmark::DoNotOptimize(c.alignment.FindChainageAndOffset(c.north[i], c.east[i], chainage, offset, extrapolated));
    i = (i + 1) % c.north.size();
  }
  state.SetItemsProcessed(state.iterations());
}

void BM_AlignmentFindChainageAndOffset(benchmark::State& state) { findOneByOne(state, true); }
void BM_AlignmentFindChainageAndOffsetScan(benchmark::State& state) { findOneByOne(state, false); }

}  // namespace

BENCHMARK(BM_AlignmentBatchStation)->Arg(10)->Arg(100)->Arg(1000);
BENCHMARK(BM_AlignmentFindChainageAndOffset)->Arg(10)->Arg(100)->Arg(1000);
BENCHMARK(BM_AlignmentFindChainageAndOffsetScan)->Arg(10)->Arg(100)->Arg(1000);
