#pragma once
// Builders and oracles shared by the tests of the segment primitives and curve elements.
#include <cmath>
#include <limits>

#include "svymath/curves/curve_arc.h"
#include "svymath/curves/curve_segment.h"
#include "svymath/curves/curve_spiral.h"
#include "svymath/foundation/constants.h"
#include "svymath/foundation/math_angle.h"

namespace curve_test {

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();
constexpr double kInf = std::numeric_limits<double>::infinity();

inline CMathAngle azimuthDeg(double degrees) { return CMathAngle(degrees); }

// An arc element starting at (north, east) heading azimuthDeg, of the given length and radius magnitude.
inline CCurveArc makeArc(double north, double east, double azDeg, double length, double radius, bool toTheRight) {
  CCurveDataArc data;
  data.SetElement(length, radius, toTheRight);
  return CCurveArc(north, east, azimuthDeg(azDeg), data);
}

inline CCurveSegment makeSegment(double north, double east, double azDeg, double length) {
  CCurveDataSegment data;
  data.setLen(length);
  data.setAzDeg(0.0);
  return CCurveSegment(north, east, azimuthDeg(azDeg), data);
}

// A full spiral element of length L to radius R.
inline CCurveSpiral makeSpiral(double north, double east, double azDeg, double length, double radius,
                               bool toTheRight, bool isTSSC, AlntMathSpiralType law = eMathSpiralEuler) {
  CCurveDataSpiral data(law);
  data.setLenAndR(length, radius, toTheRight, isTSSC);
  return CCurveSpiral(north, east, azimuthDeg(azDeg), data);
}

// A partial spiral element of length L between the radii r1 and r2.
inline CCurveSpiral makePartialSpiral(double north, double east, double azDeg, double length, double r1, double r2,
                                      bool toTheRight, bool isTSSC) {
  CCurveDataSpiral data(eMathSpiralEuler);
  data.setLenAndTwoR(length, r1, r2, toTheRight, isTSSC);
  return CCurveSpiral(north, east, azimuthDeg(azDeg), data);
}

// Smallest distance from p to the segment over a dense sampling of its length (an independent oracle for
// projections), with the sampled length of the nearest sample.
inline double sampledDistance(const CGenericSegment& segment, const C2dPos& p, int samples, double* atLength = nullptr) {
  double best = std::numeric_limits<double>::infinity();
  const double total = segment.getTotalLength();
  for (int i = 0; i <= samples; ++i) {
    const double s = total * i / samples;
    C2dPos q;
    if (!segment.getPosAtLength(s, q)) continue;
    const double d = std::hypot(q.north() - p.north(), q.east() - p.east());
    if (d < best) {
      best = d;
      if (atLength != nullptr) *atLength = s;
    }
  }
  return best;
}

}  // namespace curve_test
