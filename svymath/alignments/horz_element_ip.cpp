#include "svymath/alignments/horz_element_ip.h"

#include <cmath>

#include "svymath/alignments/horz_alignment_base.h"
#include "svymath/alignments/horz_element_visitor.h"
#include "svymath/cogo/inverse_radiate.h"
#include "svymath/foundation/constants.h"

using svy_math::tol::kSnap;

SVY_RTTI_DEFINE(CAlntHeIp, CAlntHe)

namespace {

// Element i of the alignment when it is an intersection-point element, else null.
const CAlntHeIp* ipElementAt(const CHorzAlntBase& alignment, int index) {
  const CHorzAlntElemBase* element = alignment.getHe(index);
  if (element == nullptr || element->getType() != eAlntHeIp) return nullptr;
  return static_cast<const CAlntHeIp*>(static_cast<const CAlntHe*>(element));
}

}  // namespace

CAlntHeIp::CAlntHeIp() : m_hasGroup(false) {}

CAlntHeIp::CAlntHeIp(const CAlntHeIp& other) = default;

CAlntHeIp& CAlntHeIp::operator=(const CAlntHeIp& other) = default;

CAlntHeIp::~CAlntHeIp() = default;

bool CAlntHeIp::setIp(double ipNorth, double ipEast, double radius, double lenIn, double lenOut) {
  return m_group.setIp(ipNorth, ipEast, radius, lenIn, lenOut);
}

bool CAlntHeIp::isShapeOk() const { return std::isfinite(getIp().north()) && std::isfinite(getIp().east()); }

bool CAlntHeIp::isok() const { return CAlntHe::isok() && isLaidOut(); }

bool CAlntHeIp::isLaidOut() const { return m_leadIn.isok() && (!m_hasGroup || m_group.isok()); }

void CAlntHeIp::clearLayout() {
  m_leadIn = CCurveSegment();
  m_hasGroup = false;
}

// The lead-in runs from the start point along the tangent from the previous intersection point to the IP,
// as far as TS; its length is the start point's distance from TS measured along that tangent, so that a
// start point beyond TS (overlapping tangent lengths) gives a negative length and leaves the element
// undefined.
void CAlntHeIp::onSetIndex(const CHorzAlntBase& alignment, int index) {
  double chainage = 0.0;
  C2dPos start;
  CMathAngle inheritedAzimuth;
  getAnchor(alignment, index, chainage, start, inheritedAzimuth);
  onStartChainageUpdate(chainage);
  clearLayout();
  const C2dPos ip = getIp();
  const CAlntHeIp* previous = ipElementAt(alignment, index - 1);
  const CAlntHeIp* next = ipElementAt(alignment, index + 1);
  const C2dPos previousIp = previous != nullptr ? previous->getIp() : start;
  CMathAngle tangent;
  if (!isShapeOk() || !std::isfinite(start.north()) || !std::isfinite(start.east()) || !tangent.setAz(previousIp, ip)) return;
  C2dPos ts = ip;
  if (next != nullptr) {
    if (!m_group.setNeighbours(previousIp, next->getIp())) return;
    ts = m_group.getTS();
  }
  const double leadIn =
      (ts.north() - start.north()) * tangent.getCos() + (ts.east() - start.east()) * tangent.getSin();
  if (!(leadIn >= -svy_math::tol::kIpTangentOverlap)) return;
  CCurveDataSegment data;
  data.setLen(std::fmax(leadIn, 0.0));
  data.setAzRad(0.0);
  m_leadIn = CCurveSegment(start.north(), start.east(), tangent, data);
  m_hasGroup = next != nullptr;
}

bool CAlntHeIp::getHLengthInM(double& length) const {
  if (!isLaidOut()) return false;
  length = getLeadInLength() + (m_hasGroup ? m_group.getTotalLength() : 0.0);
  return true;
}

bool CAlntHeIp::getStartPosNe(double& north, double& east) const {
  return isLaidOut() && m_leadIn.getPosAtLength(0.0, north, east);
}

bool CAlntHeIp::getFinalPosNe(double& north, double& east) const {
  double length = 0.0;
  return getHLengthInM(length) && getPosNeAtLength(length, north, east);
}

bool CAlntHeIp::getStartAzimut(CMathAngle& azimuth) const {
  return isLaidOut() && m_leadIn.getStartAzimut(azimuth);
}

bool CAlntHeIp::getFinalAzimut(CMathAngle& azimuth) const {
  if (!isLaidOut()) return false;
  return m_hasGroup ? m_group.getEndAzimut(azimuth) : m_leadIn.getEndAzimut(azimuth);
}

bool CAlntHeIp::getPosNeAtLength(double length, double& north, double& east) const {
  double total = 0.0;
  if (!getHLengthInM(total) || length < -kSnap || length > total + kSnap) return false;
  const double leadIn = getLeadInLength();
  if (m_hasGroup && length >= leadIn) return m_group.getPosAtLength(length - leadIn, north, east);
  return m_leadIn.getPosAtLength(length, north, east);
}

bool CAlntHeIp::getAzimuthAtLength(double length, double& azimuthDeg) const {
  double total = 0.0;
  if (!getHLengthInM(total) || length < -kSnap || length > total + kSnap) return false;
  const double leadIn = getLeadInLength();
  CMathAngle azimuth;
  const bool ok = m_hasGroup && length >= leadIn ? m_group.getAzimuthAtLength(length - leadIn, azimuth)
                                                 : m_leadIn.getAzimuthAtLength(length, azimuth);
  if (!ok) return false;
  azimuthDeg = azimuth.getDeg();
  return true;
}

double CAlntHeIp::getStepForDeviation(double length, double deviation) const {
  if (!isLaidOut()) return 0.0;
  const double leadIn = getLeadInLength();
  if (m_hasGroup && length >= leadIn) return m_group.getStepForDeviation(length - leadIn, deviation);
  return leadIn - length;
}

bool CAlntHeIp::getShortestDistAndCurveLen(double north, double east, double& distance, double& length) const {
  if (!isLaidOut()) return false;
  TPartAnswer leadIn, group;
  leadIn.found = m_leadIn.getShortestDistAndCurveLen(north, east, leadIn.value, leadIn.length);
  group.found = m_hasGroup && m_group.getShortestDistAndCurveLen(north, east, group.value, group.length);
  return choosePart(leadIn, group, false, length, distance);
}

bool CAlntHeIp::getLengthAndOffset(double north, double east, double& length, double& offset) const {
  if (!isLaidOut()) return false;
  TPartAnswer leadIn, group;
  leadIn.found = m_leadIn.getLengthAndOffset(north, east, leadIn.length, leadIn.value);
  group.found = m_hasGroup && m_group.getLengthAndOffset(north, east, group.length, group.value);
  // For the foot the tie-break between elements applies between the parts too.
  return choosePart(leadIn, group, true, length, offset);
}

bool CAlntHeIp::choosePart(const TPartAnswer& leadIn, const TPartAnswer& group, bool groupWithinSnap, double& length,
                           double& value) const {
  const double groupValue = std::fabs(group.value);
  const double leadInValue = std::fabs(leadIn.value);
  const bool groupWins = group.found && (!leadIn.found || (groupWithinSnap ? groupValue <= leadInValue + kSnap
                                                                           : groupValue < leadInValue));
  if (!groupWins && !leadIn.found) return false;
  length = groupWins ? getLeadInLength() + group.length : leadIn.length;
  value = groupWins ? group.value : leadIn.value;
  return true;
}

// The lower of the lead-in's bound (the distance to its prolonged line) and the group's distance.
bool CAlntHeIp::getShortestDistanceToPoint(double north, double east, double& distance) const {
  double leadIn = 0.0;
  if (!isLaidOut() || !m_leadIn.getShortestDistanceToPoint(north, east, leadIn)) return false;
  double group = 0.0;
  distance = m_hasGroup && m_group.getShortestDistanceToPoint(north, east, group) ? std::fmin(leadIn, group) : leadIn;
  return true;
}

bool CAlntHeIp::getPosAtLengthAndOffset(double length, double offset, double& north, double& east) const {
  double onNorth = 0.0;
  double onEast = 0.0;
  double azimuthDeg = 0.0;
  if (!getPosNeAtLength(length, onNorth, onEast) || !getAzimuthAtLength(length, azimuthDeg)) return false;
  Compute2DPoint(onEast, onNorth, std::fabs(offset), azimuthDeg,
                 offset >= 0.0 ? svy_math::units::kRightAngleDeg : -svy_math::units::kRightAngleDeg, east, north);
  return true;
}

bool CAlntHeIp::getCurvatureAtLength(double length, double& curvature) const {
  double total = 0.0;
  if (!getHLengthInM(total) || length < -kSnap || length > total + kSnap) return false;
  const double leadIn = getLeadInLength();
  curvature = m_hasGroup && length >= leadIn ? m_group.getCurvatureAtLength(length - leadIn) : 0.0;
  return true;
}

void CAlntHeIp::ForEachSegment(CGenericSegmentVisitor_const& visitor) const {
  if (!isLaidOut()) return;
  if (getLeadInLength() > 0.0) m_leadIn.Accept(visitor);
  if (m_hasGroup) m_group.ForEachSegment(visitor);
}

bool CAlntHeIp::getIpPos(double& north, double& east) const {
  if (!isShapeOk()) return false;
  north = getIp().north();
  east = getIp().east();
  return true;
}

CAlntHe* CAlntHeIp::clone() const { return new CAlntHeIp(*this); }

void CAlntHeIp::Accept(CAlntHeVisitor_const& visitor) const { visitor.Visit(*this); }

void CAlntHeIp::Accept(CAlntHeVisitor& visitor) { visitor.Visit(*this); }

bool CAlntHeIp::isEqual(const CAlntHe* other) const {
  const CAlntHeIp* ipElement = cast(other);
  if (ipElement == nullptr) return false;
  const CCurveIp& theirs = ipElement->m_group;
  const double tolerance = svy_math::tol::kElementEqual;
  return std::fabs(getIp().north() - theirs.getIp().north()) <= tolerance &&
         std::fabs(getIp().east() - theirs.getIp().east()) <= tolerance &&
         std::fabs(std::fabs(m_group.getRadius()) - std::fabs(theirs.getRadius())) <= tolerance &&
         std::fabs(m_group.getLenIn() - theirs.getLenIn()) <= tolerance &&
         std::fabs(m_group.getLenOut() - theirs.getLenOut()) <= tolerance &&
         m_group.getSpiralType() == theirs.getSpiralType();
}
