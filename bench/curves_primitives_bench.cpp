// Hot paths of the curve elements: the length and offset of a surveyed point against an arc and a spiral
// (what an alignment asks of every element for every point), and the crossings of a line with a spiral.
#include <benchmark/benchmark.h>

#include "svymath/curves/curve_arc.h"
#include "svymath/curves/curve_spiral.h"
#include "svymath/curves/generic_line_impl.h"

namespace {

CCurveArc benchArc() {
  CCurveDataArc data;
  data.SetElement(250.0, 400.0, true);
  return CCurveArc(5000000.0, 500000.0, CMathAngle(35.0), data);
}

CCurveSpiral benchSpiral(AlntMathSpiralType law, bool isTSSC) {
  CCurveDataSpiral data(law);
  data.setLenAndR(120.0, 400.0, true, isTSSC);
  return CCurveSpiral(5000000.0, 500000.0, CMathAngle(35.0), data);
}

// Points spread along and beside the element, so that each query takes a different path.
template <class Segment>
void lengthAndOffset(benchmark::State& state, const Segment& segment) {
  C2dPos points[16];
  for (int i = 0; i < 16; ++i) segment.getPosAtLengthAndOffset(segment.getTotalLength() * i / 15.0, (i % 5) - 2.0, points[i]);
  int i = 0;
  for (auto _ : state) {
    double length = 0.0;
    double offset = 0.0;
    benchmark::DoNotOptimize(segment.getLengthAndOffset(points[i++ & 15], length, offset));
    benchmark::DoNotOptimize(length);
    benchmark::DoNotOptimize(offset);
  }
}

void BM_ArcLengthAndOffset(benchmark::State& state) { lengthAndOffset(state, benchArc()); }
BENCHMARK(BM_ArcLengthAndOffset);

void BM_ClothoidLengthAndOffset(benchmark::State& state) {
  lengthAndOffset(state, benchSpiral(eMathSpiralEuler, true));
}
BENCHMARK(BM_ClothoidLengthAndOffset);

void BM_CubicCurveToTangentLengthAndOffset(benchmark::State& state) {
  lengthAndOffset(state, benchSpiral(eMathSpiralCubic, false));
}
BENCHMARK(BM_CubicCurveToTangentLengthAndOffset);

void BM_LineSpiralIntersection(benchmark::State& state) {
  const CCurveSpiral spiral = benchSpiral(eMathSpiralEuler, true);
  C2dPos middle;
  spiral.getPosAtLength(60.0, middle);
  const CGenericLineImpl line(C2dPos(middle.north() - 20.0, middle.east() + 20.0), CMathAngle(315.0),
                              60.0, eIntersectOnSegment);
  svy_vector<C2dPos> out;
  for (auto _ : state) {
    out.clear();
    benchmark::DoNotOptimize(spiral.calcIntersections(line, out));
  }
}
BENCHMARK(BM_LineSpiralIntersection);

}  // namespace
