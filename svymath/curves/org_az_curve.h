#pragma once
// The placement of a curve data record in the world: the record knows its shape in a local frame (start at
// the origin, start tangent along local north, local east its right-hand normal); the placement puts that
// frame at an origin (northing, easting) turned clockwise by an azimuth. Together they make a complete
// plan-view segment of the kind of Base (CGenericLine, CGenericArc or CGenericSpiral).
//
// Lengths are measured along the element from its start; azimuths returned as doubles are decimal degrees.
// Elements are bounded with the end tolerance by default (eIntersectOnSegmentTol): a point up to
// tol::kSnap beyond an end still finds its length on the element.
#include <cmath>

#include "svymath/cogo/inverse_radiate.h"
#include "svymath/curves/generic_intersections.h"
#include "svymath/foundation/constants.h"
#include "svymath/foundation/math_angle.h"

template <class Data, class Base>
class COrgAzCurveT : public Base {
 public:
  using Base::getAzimuthAtLength;
  using Base::getPosAtLength;
  using Base::getPosAtLengthAndOffset;

  // Unplaced, with an undefined data record.
  COrgAzCurveT() : Base(eIntersectOnSegmentTol) { resetOrgAz(); }
  COrgAzCurveT(double north, double east, const CMathAngle& azimuth, const Data& data)
      : Base(eIntersectOnSegmentTol), m_data(data) {
    setOrgAz(north, east, azimuth);
  }

  // ---- placement ----
  void setOrg(double north, double east) {
    m_orgNorth = north;
    m_orgEast = east;
  }
  void setAz(const CMathAngle& azimuth) { m_orgAz = azimuth; }
  void setOrgAz(double north, double east, const CMathAngle& azimuth) {
    setOrg(north, east);
    setAz(azimuth);
  }
  void setStartValues(double north, double east, const CMathAngle& azimuth) { setOrgAz(north, east, azimuth); }
  void resetOrgAz() {
    m_orgNorth = svy_math::undefinedValue();
    m_orgEast = svy_math::undefinedValue();
    m_orgAz.reset();
  }
  bool isOrgAzOk() const { return !std::isnan(m_orgNorth) && !std::isnan(m_orgEast) && m_orgAz.isok(); }

  void setCurve(const Data& data) { m_data = data; }
  const Data& getCurve() const { return m_data; }
  Data& getCurve() { return m_data; }

  // The azimuth of the local frame (the start tangent of arcs and spirals; a tangent element may run at
  // its own angle to it).
  bool getStartAzWithoutCurveTurn(CMathAngle& azimuth) const {
    azimuth = m_orgAz;
    return m_orgAz.isok();
  }

  // The intersection of the start and end tangents; false when they are parallel or undefined.
  bool getCurveIp(C2dPos& ip) const {
    CMathAngle startAz;
    CMathAngle endAz;
    if (!getStartAzimut(startAz) || !getEndAzimut(endAz)) return false;
    return svy_math::detail::intersectRays(this->getStartPos(), startAz, this->getEndPos(), endAz, ip);
  }

  // Heap copy owned by the caller.
  virtual CGenericSegment* clone() const = 0;

  // The point of the element nearest to (north, east): len its length along the element, dist its distance,
  // positive when the point lies right of the direction of travel there. False when undefined.
  virtual bool getShortestDistAndCurveLen(double north, double east, double& dist, double& len) const {
    double localNorth = 0.0;
    double localEast = 0.0;
    return toLocal(north, east, localNorth, localEast) &&
           m_data.getShortestDistAndCurveLen(localNorth, localEast, dist, len);
  }

  // ---- the segment interface ----
  bool isok() const override { return isOrgAzOk() && m_data.isok(); }
  double getStartNorthing() const override { return m_orgNorth; }
  double getStartEasting() const override { return m_orgEast; }
  double getEndNorthing() const override { return endPos().north(); }
  double getEndEasting() const override { return endPos().east(); }
  double getTotalLength() const override { return m_data.getTotalLength(); }

  // The frame azimuth plus the record's own direction at the start (undefined when the azimuth is).
  bool getStartAzimut(CMathAngle& azimuth) const override { return getAzimuthAtLength(0.0, azimuth); }
  bool getEndAzimut(CMathAngle& azimuth) const override {
    return getAzimuthAtLength(m_data.getTotalLength(), azimuth);
  }
  bool getAzimuthAtLength(double length, CMathAngle& azimuth) const override {
    if (m_orgAz.isNan()) {
      azimuth.reset();
      return false;
    }
    azimuth.setRad(m_orgAz.getRad() + m_data.GetAzimuth(length) * svy_math::units::kDegToRad);
    return true;
  }
  double getAzimuthAtLength(double length) const override {
    CMathAngle azimuth;
    return getAzimuthAtLength(length, azimuth) ? azimuth.getDeg() : 0.0;
  }
  double getCurvatureAtLength(double length) const override { return m_data.getCurvatureAtLength(length); }
  double getStepForDeviation(double length, double deviation) const override {
    return m_data.getStepForDeviation(length, deviation);
  }

  // The record's local position turned by the azimuth and moved to the origin.
  bool getPosAtLength(double length, double& north, double& east) const override {
    double localNorth = 0.0;
    double localEast = 0.0;
    if (!isOrgAzOk() || !m_data.getPosAtLength(length, localNorth, localEast)) return false;
    north = m_orgNorth + m_orgAz.getRotatedNorth(localNorth, localEast);
    east = m_orgEast + m_orgAz.getRotatedEast(localNorth, localEast);
    return true;
  }
  // The position at length, then |offset| square to the tangent there: to the right for offset >= 0.
  bool getPosAtLengthAndOffset(double length, double offset, double& north, double& east) const override {
    double onNorth = 0.0;
    double onEast = 0.0;
    if (!getPosAtLength(length, onNorth, onEast)) return false;
    const double tangentDeg = m_data.GetAzimuth(length) + m_orgAz.getRad() * svy_math::units::kRadToDeg;
    Compute2DPoint(onEast, onNorth, std::fabs(offset), tangentDeg, offset >= 0.0 ? kRightAngleDeg : -kRightAngleDeg,
                   east, north);
    return true;
  }

 protected:
  static constexpr double kRightAngleDeg = 90.0;

  // The world point in the record's local frame; false when the placement is undefined.
  bool toLocal(double north, double east, double& localNorth, double& localEast) const {
    if (!isOrgAzOk()) return false;
    localNorth = m_orgAz.getRotatedBackNorth(north - m_orgNorth, east - m_orgEast);
    localEast = m_orgAz.getRotatedBackEast(north - m_orgNorth, east - m_orgEast);
    return true;
  }
  // The end position (NaN when it cannot be computed).
  C2dPos endPos() const {
    C2dPos end(svy_math::undefinedValue(), svy_math::undefinedValue());
    if (isok()) getPosAtLength(m_data.getTotalLength(), end.north(), end.east());
    return end;
  }

  double m_orgNorth;
  double m_orgEast;
  CMathAngle m_orgAz;
  Data m_data;
};
