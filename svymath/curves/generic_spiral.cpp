#include "svymath/curves/generic_spiral.h"

#include <cmath>

#include "svymath/curves/curve_arc.h"
#include "svymath/curves/generic_line.h"
#include "svymath/curves/generic_intersections.h"
#include "svymath/curves/generic_segment_visitor.h"
#include "svymath/foundation/constants.h"
#include "svymath/foundation/math_angle.h"

SVY_RTTI_DEFINE(CGenericSpiral, CGenericSegment)

namespace {

// Positions sampled for the boundary. A spiral turns by far less than a quarter turn between samples, so
// each axis has at most one extreme inside a sample interval.
constexpr int kBoundarySamples = 32;
// Halvings of a sample interval when locating an extreme: 2^-60 of the interval is below any length unit.
constexpr int kExtremeBisections = 60;

// Locates by bisection the length in [lo, hi] where component(azimuth) changes sign, and includes the
// position there. component is the cosine (a northing extreme) or the sine (an easting extreme).
template <class Component>
void includeExtreme(const CGenericSpiral& spiral, double lo, double hi, Component component, C2dMinMax& box) {
  CMathAngle azimuth;
  spiral.getAzimuthAtLength(lo, azimuth);
  const bool loPositive = component(azimuth) > 0.0;
  for (int i = 0; i < kExtremeBisections && hi - lo > 0.0; ++i) {
    const double mid = 0.5 * (lo + hi);
    spiral.getAzimuthAtLength(mid, azimuth);
    if ((component(azimuth) > 0.0) == loPositive) {
      lo = mid;
    } else {
      hi = mid;
    }
  }
  C2dPos pos;
  if (spiral.getPosAtLength(0.5 * (lo + hi), pos)) box.include(pos);
}

}  // namespace

CGenericSpiral::CGenericSpiral(EIntersectionType type) : CGenericSegment(type) {}
CGenericSpiral::CGenericSpiral(const CGenericSpiral& other) = default;
CGenericSpiral& CGenericSpiral::operator=(const CGenericSpiral& other) = default;
CGenericSpiral::~CGenericSpiral() = default;

bool CGenericSpiral::isToTheRight() const {
  const double startRadius = getStartRadius();
  if (!std::isnan(startRadius) && std::fabs(startRadius) >= svy_math::tol::kZero) return startRadius > 0.0;
  return getEndRadius() > 0.0;
}

C2dMinMax CGenericSpiral::getBoundary() const {
  C2dMinMax box;
  const double length = getTotalLength();
  C2dPos pos;
  CMathAngle previousAz;
  if (!getPosAtLength(0.0, pos) || !getAzimuthAtLength(0.0, previousAz)) return box;
  box.include(pos);
  if (!(length > 0.0) || !std::isfinite(length)) return box;
  const auto cosine = [](const CMathAngle& a) { return a.getCos(); };
  const auto sine = [](const CMathAngle& a) { return a.getSin(); };
  double previous = 0.0;
  for (int i = 1; i <= kBoundarySamples; ++i) {
    const double s = length * i / kBoundarySamples;
    CMathAngle azimuth;
    if (!getPosAtLength(s, pos) || !getAzimuthAtLength(s, azimuth)) break;
    box.include(pos);
    if ((cosine(previousAz) > 0.0) != (cosine(azimuth) > 0.0)) includeExtreme(*this, previous, s, cosine, box);
    if ((sine(previousAz) > 0.0) != (sine(azimuth) > 0.0)) includeExtreme(*this, previous, s, sine, box);
    previous = s;
    previousAz = azimuth;
  }
  return box;
}

bool CGenericSpiral::createCache(svy_vector<CCurveArc>& arcs) const {
  arcs.clear();
  const double length = getTotalLength();
  if (!(length > 0.0) || !std::isfinite(length)) return false;
  const double h = length / (2 * kCacheArcs);
  const EIntersectionType type =
      getIntersectionType() == eIntersectUnbounded ? eIntersectOnSegmentTol : getIntersectionType();
  C2dPos first;
  if (!getPosAtLength(0.0, first)) return false;
  arcs.reserve(kCacheArcs);
  for (int k = 0; k < kCacheArcs; ++k) {
    C2dPos middle;
    C2dPos last;
    if (!getPosAtLength((2 * k + 1) * h, middle) || !getPosAtLength((2 * k + 2) * h, last)) break;
    CCurveArc arc(first, middle, last);
    if (arc.isok()) {
      arc.setIntersectionType(type);
      arcs.push_back(arc);
    }
    first = last;
  }
  return !arcs.empty();
}

void CGenericSpiral::Accept(CGenericSegmentVisitor_const& visitor) const { visitor.Visit(*this); }
void CGenericSpiral::Accept(CGenericSegmentVisitor& visitor) { visitor.Visit(*this); }

bool CGenericSpiral::doCalcIntersections(const CGenericSpiral& other, svy_vector<C2dPos>& out) const {
  return svy_math::detail::intersectSpirals(*this, other, out);
}

bool CGenericSpiral::doCalcIntersections(const CGenericArc& other, svy_vector<C2dPos>& out) const {
  return svy_math::detail::intersectSpiralWith(*this, other, out);
}

bool CGenericSpiral::doCalcIntersections(const CGenericLine& other, svy_vector<C2dPos>& out) const {
  return svy_math::detail::intersectSpiralWith(*this, other, out);
}
