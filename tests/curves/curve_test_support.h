#pragma once
// Builders and oracles shared by the curve tests: element builders, dense sampling, numeric CSV tables and
// an adaptive Simpson quadrature (the independent oracle for Fresnel integrals and spiral positions).
#include <gtest/gtest.h>

#include <cmath>
#include <fstream>
#include <functional>
#include <limits>
#include <sstream>
#include <string>
#include <vector>

#include "support/geometry.h"
#include "svymath/curves/curve_arc.h"
#include "svymath/curves/curve_segment.h"
#include "svymath/curves/curve_spiral.h"
#include "svymath/foundation/constants.h"
#include "svymath/foundation/math_angle.h"

namespace curve_test {

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();
constexpr double kInf = std::numeric_limits<double>::infinity();

inline void expectPosNear(const C2dPos& actual, double north, double east, double tol) {
  EXPECT_TRUE(std::fabs(actual.north() - north) <= tol && std::fabs(actual.east() - east) <= tol)
      << actual.north() << " " << actual.east() << " vs " << north << " " << east;
}

// The position at length s of a segment (NaN when it has none, which fails any comparison).
inline C2dPos posAt(const CGenericSegment& segment, double s) {
  C2dPos pos(kNaN, kNaN);
  if (!segment.getPosAtLength(s, pos)) ADD_FAILURE() << "no position at " << s;
  return pos;
}

using svy_test::dist;

// An arc element starting at (north, east) heading azDeg degrees, of the given length and radius magnitude.
inline CCurveArc makeArc(double north, double east, double azDeg, double length, double radius, bool toTheRight) {
  CCurveDataArc data;
  data.SetElement(length, radius, toTheRight);
  return CCurveArc(north, east, CMathAngle(azDeg), data);
}

inline CCurveSegment makeSegment(double north, double east, double azDeg, double length) {
  CCurveDataSegment data;
  data.setLen(length);
  data.setAzDeg(0.0);
  return CCurveSegment(north, east, CMathAngle(azDeg), data);
}

// A full spiral element of length L to radius R.
inline CCurveSpiral makeSpiral(double north, double east, double azDeg, double length, double radius, bool toTheRight,
                               bool isTSSC, AlntMathSpiralType law = eMathSpiralEuler) {
  CCurveDataSpiral data(law);
  data.setLenAndR(length, radius, toTheRight, isTSSC);
  return CCurveSpiral(north, east, CMathAngle(azDeg), data);
}

// Smallest distance from p to the segment over a dense sampling of its length (an independent oracle for
// projections).
inline double sampledDistance(const CGenericSegment& segment, const C2dPos& p, int samples) {
  double best = kInf;
  C2dPos q;
  for (int i = 0; i <= samples; ++i) {
    if (segment.getPosAtLength(segment.getTotalLength() * i / samples, q)) best = std::fmin(best, dist(p, q));
  }
  return best;
}

// The boundary box holds a dense sampling of the segment and is within tight of it on every side.
inline void expectBoxHoldsSamples(const CGenericSegment& segment, int samples, double tight) {
  const C2dMinMax box = segment.getBoundary();
  C2dMinMax in;
  for (int i = 0; i <= samples; ++i) in.include(posAt(segment, segment.getTotalLength() * i / samples));
  for (const double gap : {in.minNorth - box.minNorth, in.minEast - box.minEast, box.maxNorth - in.maxNorth,
                           box.maxEast - in.maxEast}) {
    EXPECT_TRUE(gap >= -1e-9 && gap <= tight) << gap;
  }
}

// Walking the segment by deviation steps reaches its end point; no point of the segment strays from the chord
// of its step by more than the deviation (1e-9 m left for rounding at grid coordinates).
inline void expectStepsWithinDeviation(const CGenericSegment& segment, double deviation) {
  const double total = segment.getTotalLength();
  double s = 0.0;
  int steps = 0;
  C2dPos from = segment.getStartPos(), to;
  for (; s < total && steps < 10000; ++steps) {
    const double next = segment.getNextPosForDeviation(s, deviation, to);
    ASSERT_TRUE(next > s && next <= total + 1e-9) << s;
    double worst = 0.0;
    for (int i = 1; i < 16; ++i) {
      const C2dPos p = posAt(segment, s + (next - s) * i / 16.0);
      worst = std::fmax(worst, std::fabs((to.north() - from.north()) * (p.east() - from.east()) -
                                         (to.east() - from.east()) * (p.north() - from.north())) /
                                   dist(from, to));
    }
    EXPECT_LE(worst, deviation + 1e-9) << s;
    s = next;
    from = to;
  }
  EXPECT_GT(steps, 1);
  EXPECT_NEAR(s, total, 1e-9);
  EXPECT_EQ(from, segment.getEndPos());
}

// Rows of numbers of a CSV file after its header lines; any blank, comma, tab or CR separates fields.
inline std::vector<std::vector<double>> readNumericTable(const std::string& path, int headerLines = 1) {
  std::vector<std::vector<double>> rows;
  std::ifstream in(path);
  std::string line;
  for (int i = 0; i < headerLines && std::getline(in, line);) ++i;
  while (std::getline(in, line)) {
    for (char& c : line) c = (c == ',' || c == '\t' || c == '\r') ? ' ' : c;
    std::istringstream fields(line);
    std::vector<double> row;
    for (double value = 0.0; fields >> value;) row.push_back(value);
    if (!row.empty()) rows.push_back(row);
  }
  return rows;
}

inline double simpsonStep(const std::function<double(double)>& f, double a, double b, double fa, double fm, double fb,
                          double whole, double tol, int depth) {
  const double m = 0.5 * (a + b), flm = f(0.5 * (a + m)), frm = f(0.5 * (m + b));
  const double left = (m - a) / 6.0 * (fa + 4.0 * flm + fm), right = (b - m) / 6.0 * (fm + 4.0 * frm + fb);
  const double delta = left + right - whole;
  if (depth <= 0 || std::fabs(delta) <= 15.0 * tol) return left + right + delta / 15.0;
  return simpsonStep(f, a, m, fa, flm, fm, left, 0.5 * tol, depth - 1) +
         simpsonStep(f, m, b, fm, frm, fb, right, 0.5 * tol, depth - 1);
}

// Integral of f over [a, b] by adaptive Simpson to the absolute tolerance tol, on pieces first so that
// oscillating integrands are sampled before the error test is trusted.
inline double integrate(const std::function<double(double)>& f, double a, double b, double tol, int pieces = 64) {
  double sum = 0.0;
  const double h = (b - a) / pieces;
  for (int i = 0; i < pieces; ++i) {
    const double lo = a + i * h, hi = lo + h, flo = f(lo), fhi = f(hi), fm = f(0.5 * (lo + hi));
    sum += simpsonStep(f, lo, hi, flo, fm, fhi, h / 6.0 * (flo + 4.0 * fm + fhi), tol / pieces, 40);
  }
  return sum;
}

// The point reached after length s from the origin heading north, for a heading (radians, clockwise from
// north) given as a function of length.
inline void integrateHeading(const std::function<double(double)>& heading, double s, double tol, double& north,
                             double& east) {
  north = integrate([&](double u) { return std::cos(heading(u)); }, 0.0, s, tol, 16);
  east = integrate([&](double u) { return std::sin(heading(u)); }, 0.0, s, tol, 16);
}

}  // namespace curve_test
