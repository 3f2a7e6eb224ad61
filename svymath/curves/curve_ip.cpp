#include "svymath/curves/curve_ip.h"

#include <cmath>

#include "svymath/curves/generic_segment_visitor.h"
#include "svymath/curves/spiral_length_range.h"
#include "svymath/foundation/angle_functions.h"
#include "svymath/foundation/constants.h"

SVY_RTTI_DEFINE(CCurveIp, CRttiBase)

namespace {

using svy_math::tol::kSnap;
using svy_math::tol::kZero;

// A full TS-to-SC spiral turning right, reduced to what places the arc beside its tangent: its end point
// (x along the tangent, y to the right), its spiral angle t, the shift p of the arc's circle off the tangent
// and the distance k along the tangent from the tangent point to the foot of the circle's centre.
struct TSpiralFit {
  double x = 0.0;
  double y = 0.0;
  double angle = 0.0;
  double shift = 0.0;
  double k = 0.0;
};

// False when the law cannot reach the radius within the length (a cubic parabola too sharp for it).
bool fitSpiral(AlntMathSpiralType type, double length, double radius, TSpiralFit& fit) {
  fit = TSpiralFit();
  if (length <= 0.0) return true;
  CCurveDataSpiral1R spiral(type);
  if (!spiral.setLenAndR(length, radius, true, true)) return false;
  fit.x = spiral.getFinalNorthing();
  fit.y = spiral.getFinalEasting();
  fit.angle = spiral.getFinalAzimutInRad();
  // 1 - cos t as 2 sin^2(t/2): the shift of a flat spiral is a small difference of nearly equal values.
  const double halfSin = std::sin(0.5 * fit.angle);
  fit.shift = fit.y - 2.0 * radius * halfSin * halfSin;
  fit.k = fit.x - radius * std::sin(fit.angle);
  return std::isfinite(fit.shift) && std::isfinite(fit.k) && std::isfinite(fit.angle);
}

// The direction of an azimuth and its right-hand normal, as (north, east) components.
C2dPos along(const CMathAngle& azimuth) { return C2dPos(azimuth.getCos(), azimuth.getSin()); }
C2dPos rightOf(const CMathAngle& azimuth) { return C2dPos(-azimuth.getSin(), azimuth.getCos()); }

C2dPos scaled(double a, const C2dPos& u) { return C2dPos(a * u.north(), a * u.east()); }
C2dPos combine(double a, const C2dPos& u, double b, const C2dPos& v) {
  return C2dPos(a * u.north() + b * v.north(), a * u.east() + b * v.east());
}

C2dPos offsetFrom(const C2dPos& origin, const C2dPos& delta) {
  return C2dPos(origin.north() + delta.north(), origin.east() + delta.east());
}

bool isFinite(const C2dPos& p) { return std::isfinite(p.north()) && std::isfinite(p.east()); }

bool sameValue(double a, double b) { return a == b || (std::isnan(a) && std::isnan(b)); }

bool samePos(const C2dPos& a, const C2dPos& b) {
  return sameValue(a.north(), b.north()) && sameValue(a.east(), b.east());
}

// Distance from (north, east) to the box (0 inside it).
double boxDistance(const C2dMinMax& box, double north, double east) {
  const double dN = std::fmax(std::fmax(box.minNorth - north, north - box.maxNorth), 0.0);
  const double dE = std::fmax(std::fmax(box.minEast - east, east - box.maxEast), 0.0);
  return std::hypot(dN, dE);
}

// Asks query(segment, length, value) of each part in order and keeps the answer with the smallest |value|;
// a later part within tie of the best replaces it. length is the group length (the part's start added).
//
// The part nearest to the point by its box is asked first. Its |value| bounds the answer: with at most three
// parts the tie rule lets the answer drift at most two ties above the smallest |value|, so a part whose box
// lies farther than that (plus slack for answers a part gives beyond its ends) cannot hold it and is not
// asked. The result is the same as asking every part.
template <class Part, class Query>
bool nearestOverParts(const Part* parts, int count, double tie, double slack, double north, double east,
                      const Query& query, double& length, double& value) {
  double gaps[3] = {0.0, 0.0, 0.0};
  int first = 0;
  for (int i = 0; i < count; ++i) {
    gaps[i] = boxDistance(*parts[i].box, north, east);
    if (gaps[i] < gaps[first]) first = i;
  }
  double firstLength = 0.0;
  double firstValue = 0.0;
  const bool firstFound = count > 0 && query(*parts[first].segment, firstLength, firstValue);
  const double reach = firstFound ? std::fabs(firstValue) + 2.0 * tie + slack : HUGE_VAL;
  bool found = false;
  for (int i = 0; i < count; ++i) {
    double s = firstLength;
    double v = firstValue;
    const bool has = i == first ? firstFound : gaps[i] <= reach && query(*parts[i].segment, s, v);
    if (has && (!found || std::fabs(v) <= std::fabs(value) + tie)) {
      length = parts[i].start + s;
      value = v;
      found = true;
    }
  }
  return found;
}

CMathAngle angleRad(double rad) {
  CMathAngle angle;
  angle.setRad(rad);
  return angle;
}

}  // namespace

CCurveIp::CCurveIp()
    : m_ip(svy_math::undefinedValue(), svy_math::undefinedValue()),
      m_previous(m_ip),
      m_next(m_ip),
      m_radius(0.0),
      m_lenIn(0.0),
      m_lenOut(0.0),
      m_spiralType(eMathSpiralEuler),
      m_neighboursSet(false),
      m_ok(false) {
  clearComputed();
}

CCurveIp::CCurveIp(const CCurveIp& other) = default;
CCurveIp& CCurveIp::operator=(const CCurveIp& other) = default;
CCurveIp::~CCurveIp() = default;

// ---- definition ----

bool CCurveIp::setIp(double ipNorth, double ipEast, double radius, double lenIn, double lenOut) {
  if (!std::isfinite(ipNorth) || !std::isfinite(ipEast) || !std::isfinite(radius) || !std::isfinite(lenIn) ||
      !std::isfinite(lenOut) || lenIn < 0.0 || lenOut < 0.0) {
    return false;
  }
  const bool noCurve = std::fabs(radius) < svy_math::tol::kCurveRadiusZero;
  if (noCurve && (lenIn > 0.0 || lenOut > 0.0)) return false;
  m_ip = C2dPos(ipNorth, ipEast);
  m_radius = noCurve ? 0.0 : std::fabs(radius);
  m_lenIn = lenIn;
  m_lenOut = lenOut;
  rebuild();
  return true;
}

void CCurveIp::setSimplePoint() {
  m_radius = 0.0;
  m_lenIn = 0.0;
  m_lenOut = 0.0;
  rebuild();
}

bool CCurveIp::isSimplePoint() const { return m_radius == 0.0; }

void CCurveIp::setSpiralType(AlntMathSpiralType type) {
  m_spiralType = type == eMathSpiralCubic ? eMathSpiralCubic : eMathSpiralEuler;
  rebuild();
}

AlntMathSpiralType CCurveIp::getSpiralType() const { return m_spiralType; }

bool CCurveIp::setNeighbours(const C2dPos& previous, const C2dPos& next) {
  m_previous = previous;
  m_next = next;
  m_neighboursSet = true;
  return rebuild();
}

bool CCurveIp::isok() const { return m_ok; }

ECurveIpStatus CCurveIp::getStatus() const { return m_status; }

bool CCurveIp::isEqual(const CCurveIp& other) const {
  return samePos(m_ip, other.m_ip) && m_radius == other.m_radius && m_lenIn == other.m_lenIn &&
         m_lenOut == other.m_lenOut && m_spiralType == other.m_spiralType && m_neighboursSet == other.m_neighboursSet &&
         (!m_neighboursSet || (samePos(m_previous, other.m_previous) && samePos(m_next, other.m_next)));
}

void CCurveIp::clearComputed() {
  const double nan = svy_math::undefinedValue();
  m_ok = false;
  m_status = eCurveIpUndefined;
  m_deflection = nan;
  m_azIn.reset();
  m_azOut.reset();
  m_tangentIn = nan;
  m_tangentOut = nan;
  m_shiftIn = nan;
  m_shiftOut = nan;
  m_arcLength = nan;
  m_ts = m_sc = m_cs = m_st = C2dPos(nan, nan);
  m_spiralIn = CCurveSpiral();
  m_arc = CCurveArc();
  m_spiralOut = CCurveSpiral();
  m_boxIn = m_boxArc = m_boxOut = C2dMinMax();
}

bool CCurveIp::rebuild() {
  clearComputed();
  if (!m_neighboursSet || !isFinite(m_ip) || !isFinite(m_previous) || !isFinite(m_next)) return false;
  // Everything below is relative to the IP.
  const double inN = m_ip.north() - m_previous.north(), inE = m_ip.east() - m_previous.east();
  const double outN = m_next.north() - m_ip.north(), outE = m_next.east() - m_ip.east();
  if (std::hypot(inN, inE) < svy_math::tol::kSamePoint || std::hypot(outN, outE) < svy_math::tol::kSamePoint ||
      !m_azIn.setAz(inN, inE) || !m_azOut.setAz(outN, outE)) {
    m_azIn.reset();
    m_azOut.reset();
    m_status = eCurveIpNoTangent;
    return false;
  }
  const double deflection = NormalizeNegPiToPi(m_azOut.getRad() - m_azIn.getRad());
  const double turn = std::fabs(deflection);
  m_deflection = deflection;
  if (isSimplePoint()) {
    m_tangentIn = m_tangentOut = m_shiftIn = m_shiftOut = m_arcLength = 0.0;
    m_ts = m_sc = m_cs = m_st = m_ip;
    m_ok = true;
    m_status = eCurveIpOk;
    return true;
  }
  const double halfTurnTol = svy_math::tol::kHalfTurnDeg * svy_math::units::kDegToRad;
  if (turn < kZero || svy_math::units::kPi - turn < halfTurnTol) {
    m_status = turn < kZero ? eCurveIpCollinear : eCurveIpReversal;
    return false;
  }
  TSpiralFit in;
  TSpiralFit out;
  if (!fitSpiral(m_spiralType, m_lenIn, m_radius, in) || !fitSpiral(m_spiralType, m_lenOut, m_radius, out)) {
    m_status = eCurveIpSpiralUnreachable;
    return false;
  }
  double arcAngle = turn - in.angle - out.angle;
  if (arcAngle <= -kZero) {
    m_status = eCurveIpSpiralsTooLong;
    return false;
  }
  if (arcAngle < kZero) arcAngle = 0.0;  // spirals that fill the turn meet at one point of radius R

  const double R = m_radius;
  const double side = deflection > 0.0 ? 1.0 : -1.0;  // +1 turning right
  const bool right = side > 0.0;
  const double tanHalf = std::tan(0.5 * turn);
  const double asymmetry = (in.shift - out.shift) / std::sin(turn);
  m_tangentIn = (R + in.shift) * tanHalf + in.k - asymmetry;
  m_tangentOut = (R + out.shift) * tanHalf + out.k + asymmetry;
  m_shiftIn = in.shift;
  m_shiftOut = out.shift;
  m_arcLength = R * arcAngle;

  // The points relative to the IP: the centre lies k1 on from TS and R + p1 to the inside of the entry
  // tangent; SC is the entry spiral's end seen from TS; CS lies R from the centre square to the direction
  // in which the exit spiral starts.
  const C2dPos uIn = along(m_azIn), nIn = rightOf(m_azIn), uOut = along(m_azOut);
  const C2dPos ts = scaled(-m_tangentIn, uIn);
  const C2dPos centre = combine(in.k - m_tangentIn, uIn, side * (R + in.shift), nIn);
  const C2dPos sc = offsetFrom(ts, combine(in.x, uIn, side * in.y, nIn));
  const CMathAngle azSc = angleRad(m_azIn.getRad() + side * in.angle);
  const CMathAngle azCs = angleRad(m_azOut.getRad() - side * out.angle);
  const C2dPos cs = offsetFrom(centre, scaled(-side * R, rightOf(azCs)));
  const C2dPos st = scaled(m_tangentOut, uOut);
  m_ts = offsetFrom(m_ip, ts);
  m_sc = offsetFrom(m_ip, sc);
  m_cs = offsetFrom(m_ip, cs);
  m_st = offsetFrom(m_ip, st);
  if (!isFinite(m_ts) || !isFinite(m_sc) || !isFinite(m_cs) || !isFinite(m_st)) {
    clearComputed();  // absurd input (1e300): no finite group
    return false;
  }

  CCurveDataSpiral spiral(m_spiralType);
  if (m_lenIn > 0.0) {
    spiral.setLenAndR(m_lenIn, R, right, true);
    m_spiralIn = CCurveSpiral(m_ts.north(), m_ts.east(), m_azIn, spiral);
  }
  if (m_arcLength > 0.0) {
    CCurveDataArc arc;
    arc.SetElement(m_arcLength, R, right);
    m_arc = CCurveArc(m_sc.north(), m_sc.east(), azSc, arc);
  }
  if (m_lenOut > 0.0) {
    spiral.setLenAndR(m_lenOut, R, right, false);
    m_spiralOut = CCurveSpiral(m_cs.north(), m_cs.east(), azCs, spiral);
  }
  m_boxIn = m_spiralIn.getBoundary();
  m_boxArc = m_arc.getBoundary();
  m_boxOut = m_spiralOut.getBoundary();
  m_ok = true;
  m_status = eCurveIpOk;
  return true;
}

// ---- read back ----

C2dPos CCurveIp::getIp() const { return m_ip; }
double CCurveIp::getRadius() const { return m_deflection < 0.0 ? -m_radius : m_radius; }
double CCurveIp::getLenIn() const { return m_lenIn; }
double CCurveIp::getLenOut() const { return m_lenOut; }
double CCurveIp::getDeflection() const { return m_deflection; }
double CCurveIp::getTangentIn() const { return m_tangentIn; }
double CCurveIp::getTangentOut() const { return m_tangentOut; }
double CCurveIp::getShiftIn() const { return m_shiftIn; }
double CCurveIp::getShiftOut() const { return m_shiftOut; }
C2dPos CCurveIp::getTS() const { return m_ts; }
C2dPos CCurveIp::getSC() const { return m_sc; }
C2dPos CCurveIp::getCS() const { return m_cs; }
C2dPos CCurveIp::getST() const { return m_st; }

double CCurveIp::getTotalLength() const { return m_ok ? m_lenIn + m_arcLength + m_lenOut : svy_math::undefinedValue(); }

const CCurveSpiral* CCurveIp::getSpiralIn() const { return m_ok && m_lenIn > 0.0 ? &m_spiralIn : nullptr; }
const CCurveArc* CCurveIp::getArc() const { return m_ok && m_arcLength > 0.0 ? &m_arc : nullptr; }
const CCurveSpiral* CCurveIp::getSpiralOut() const { return m_ok && m_lenOut > 0.0 ? &m_spiralOut : nullptr; }

// ---- parts ----

int CCurveIp::parts(TPart (&out)[3]) const {
  int count = 0;
  if (const CCurveSpiral* in = getSpiralIn()) out[count++] = {in, 0.0, &m_boxIn};
  if (const CCurveArc* arc = getArc()) out[count++] = {arc, m_lenIn, &m_boxArc};
  if (const CCurveSpiral* exit = getSpiralOut()) out[count++] = {exit, m_lenIn + m_arcLength, &m_boxOut};
  return count;
}

const CGenericSegment* CCurveIp::partAt(double s, double& partLength) const {
  TPart list[3];
  const int count = parts(list);
  for (int i = 0; i < count; ++i) {
    const bool last = i + 1 == count;
    if (last || s < list[i + 1].start) {
      partLength = s - list[i].start;
      return list[i].segment;
    }
  }
  return nullptr;
}

double CCurveIp::simplePointOffset(double north, double east) const {
  const double dN = north - m_ip.north(), dE = east - m_ip.east();
  const double offIn = -dN * m_azIn.getSin() + dE * m_azIn.getCos();
  const double offOut = -dN * m_azOut.getSin() + dE * m_azOut.getCos();
  const double distance = std::hypot(dN, dE);
  return offIn + offOut < 0.0 ? -distance : distance;
}

// ---- queries ----

bool CCurveIp::getStartAzimut(CMathAngle& azimuth) const {
  if (!m_ok) return false;
  azimuth = m_azIn;
  return true;
}

bool CCurveIp::getEndAzimut(CMathAngle& azimuth) const {
  if (!m_ok) return false;
  azimuth = m_azOut;
  return true;
}

bool CCurveIp::getPosAtLength(double length, double& north, double& east) const {
  if (!m_ok) return false;
  if (isSimplePoint()) {
    if (!svy_math::snapToRange(length, 0.0, 0.0)) return false;
    north = m_ip.north();
    east = m_ip.east();
    return true;
  }
  double s = 0.0;
  const CGenericSegment* part = partAt(length, s);
  return part != nullptr && part->getPosAtLength(s, north, east);
}

bool CCurveIp::getAzimuthAtLength(double length, CMathAngle& azimuth) const {
  if (!m_ok) return false;
  if (isSimplePoint()) {
    // The point has no length: it points the way one leaves it.
    if (!svy_math::snapToRange(length, 0.0, 0.0)) return false;
    azimuth = m_azOut;
    return true;
  }
  double s = 0.0;
  const CGenericSegment* part = partAt(length, s);
  return part != nullptr && svy_math::snapToRange(s, 0.0, part->getTotalLength()) &&
         part->getAzimuthAtLength(s, azimuth);
}

double CCurveIp::getCurvatureAtLength(double length) const {
  double s = 0.0;
  const CGenericSegment* part = m_ok ? partAt(length, s) : nullptr;
  // The parts' curvature laws run on beyond their ends; off the group there is no curve.
  return part != nullptr && svy_math::snapToRange(s, 0.0, part->getTotalLength()) ? part->getCurvatureAtLength(s)
                                                                                  : 0.0;
}

bool CCurveIp::getLengthAndOffset(double north, double east, double& length, double& offset) const {
  if (!m_ok || !std::isfinite(north) || !std::isfinite(east)) return false;
  if (isSimplePoint()) {
    // Only the wedge outside the angle, past the end of the entry tangent and before the start of the
    // exit tangent, has its foot at the point.
    const double dN = north - m_ip.north(), dE = east - m_ip.east();
    const double pastIn = dN * m_azIn.getCos() + dE * m_azIn.getSin();
    const double beforeOut = dN * m_azOut.getCos() + dE * m_azOut.getSin();
    if (pastIn < -kZero || beforeOut > kZero) return false;
    length = 0.0;
    offset = simplePointOffset(north, east);
    return true;
  }
  TPart list[3];
  const int count = parts(list);
  // A later part within the tie distance of the best takes over: a joint belongs to the later part. A part
  // answers up to the snap beyond its ends, where its foot may lie that far outside its box.
  return nearestOverParts(
      list, count, kSnap, kSnap, north, east,
      [&](const CGenericSegment& part, double& s, double& off) { return part.getLengthAndOffset(north, east, s, off); },
      length, offset);
}

bool CCurveIp::getShortestDistAndCurveLen(double north, double east, double& dist, double& len) const {
  if (!m_ok || !std::isfinite(north) || !std::isfinite(east)) return false;
  if (isSimplePoint()) {
    dist = simplePointOffset(north, east);
    len = 0.0;
    return true;
  }
  TPart list[3];
  const int count = parts(list);
  const auto nearest = [&](const CGenericSegment& part, double& s, double& d) {
    const CCurveSpiral* spiral = CCurveSpiral::cast(&part);
    const CCurveArc* arc = CCurveArc::cast(&part);
    return spiral != nullptr ? spiral->getShortestDistAndCurveLen(north, east, d, s)
                             : arc != nullptr && arc->getShortestDistAndCurveLen(north, east, d, s);
  };
  return nearestOverParts(list, count, 0.0, 0.0, north, east, nearest, len, dist);
}

bool CCurveIp::getShortestDistanceToPoint(double north, double east, double& distance) const {
  double dist = 0.0;
  double len = 0.0;
  if (!getShortestDistAndCurveLen(north, east, dist, len)) return false;
  distance = std::fabs(dist);
  return true;
}

double CCurveIp::getStepForDeviation(double length, double deviation) const {
  double s = 0.0;
  const CGenericSegment* part = m_ok ? partAt(length, s) : nullptr;
  return part != nullptr ? part->getStepForDeviation(s, deviation) : 0.0;
}

C2dMinMax CCurveIp::getBoundary() const {
  C2dMinMax box;
  if (!m_ok) return box;
  if (isSimplePoint()) {
    box.include(m_ip);
    return box;
  }
  TPart list[3];
  const int count = parts(list);
  for (int i = 0; i < count; ++i) box.include(*list[i].box);
  return box;
}

void CCurveIp::ForEachSegment(CGenericSegmentVisitor_const& visitor) const {
  TPart list[3];
  const int count = m_ok ? parts(list) : 0;
  for (int i = 0; i < count; ++i) list[i].segment->Accept(visitor);
}
