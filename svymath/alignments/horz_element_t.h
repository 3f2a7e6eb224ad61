#pragma once
// A horizontal element that owns one placed curve element (CCurveSegment, CCurveArc or CCurveSpiral):
// the curve's origin and azimuth are the element's start point and start azimuth, which the alignment sets
// in onSetIndex. Every length query is the curve's; lengths run from 0 at the start to getHLengthInM at the
// end, with the end snap tol::kSnap.
//
// Start azimuth control: by default the start azimuth follows the previous element's final azimuth
// (tangency). A fixed start azimuth is kept through re-anchoring, so the alignment keeps the kink it makes.
#include <cmath>

#include "svymath/alignments/horz_alignment_base.h"
#include "svymath/alignments/horz_element.h"
#include "svymath/foundation/constants.h"

template <class Curve>
class SVYMATH_API CAlntHeT : public CAlntHe {
 public:
  using CHorzAlntElemBase::getAzimuthAtChain;

  // Shape, placement and start azimuth control of another element of the same kind.
  void copy(const CAlntHeT& other) { *this = other; }

  // ---- shape ----
  void set_data(const Curve& curve) { m_curve = curve; }
  const Curve& get_data() const { return m_curve; }

  // ---- start azimuth control ----
  void setTangentToPrev() { m_isStartAzFixed = false; }
  void setStartAzFixed() { m_isStartAzFixed = true; }
  void setFixedStartAzInDeg(double azimuthDeg) {
    m_curve.setAz(CMathAngle(azimuthDeg));
    m_isStartAzFixed = true;
  }
  bool isStartAzFixed() const { return m_isStartAzFixed; }

  // ---- geometry ----
  bool getHLengthInM(double& length) const override {
    const double total = m_curve.getTotalLength();
    if (std::isnan(total)) return false;
    length = total;
    return true;
  }
  bool getStartPosNe(double& north, double& east) const override {
    return m_curve.isok() && m_curve.getPosAtLength(0.0, north, east);
  }
  bool getFinalPosNe(double& north, double& east) const override {
    return m_curve.isok() && m_curve.getPosAtLength(m_curve.getTotalLength(), north, east);
  }
  bool getStartAzimut(CMathAngle& azimuth) const override { return m_curve.getStartAzimut(azimuth); }
  bool getFinalAzimut(CMathAngle& azimuth) const override { return m_curve.getEndAzimut(azimuth); }
  bool getPosNeAtLength(double length, double& north, double& east) const override {
    return m_curve.isok() && isOnElement(length) && m_curve.getPosAtLength(length, north, east);
  }
  bool getAzimuthAtLength(double length, double& azimuthDeg) const override {
    CMathAngle azimuth;
    if (!m_curve.isok() || !isOnElement(length) || !m_curve.getAzimuthAtLength(length, azimuth)) return false;
    azimuthDeg = azimuth.getDeg();
    return true;
  }
  double getStepForDeviation(double length, double deviation) const override {
    return m_curve.isok() ? m_curve.getStepForDeviation(length, deviation) : 0.0;
  }
  bool getShortestDistAndCurveLen(double north, double east, double& distance, double& length) const override {
    return m_curve.getShortestDistAndCurveLen(north, east, distance, length);
  }
  bool getLengthAndOffset(double north, double east, double& length, double& offset) const override {
    return m_curve.isok() && m_curve.getLengthAndOffset(north, east, length, offset);
  }
  bool getShortestDistanceToPoint(double north, double east, double& distance) const override {
    return m_curve.isok() && m_curve.getShortestDistanceToPoint(north, east, distance);
  }
  bool getPosAtLengthAndOffset(double length, double offset, double& north, double& east) const override {
    return m_curve.isok() && isOnElement(length) && m_curve.getPosAtLengthAndOffset(length, offset, north, east);
  }
  bool getCurvatureAtLength(double length, double& curvature) const override {
    if (!m_curve.isok() || !isOnElement(length)) return false;
    curvature = m_curve.getCurvatureAtLength(length);
    return true;
  }
  void ForEachSegment(CGenericSegmentVisitor_const& visitor) const override {
    if (m_curve.isok()) m_curve.Accept(visitor);
  }

 protected:
  CAlntHeT() : m_isStartAzFixed(false) {}
  CAlntHeT(const CAlntHeT&) = default;
  CAlntHeT& operator=(const CAlntHeT&) = default;

  void onSetIndex(const CHorzAlntBase& alignment, int index) override {
    double chainage = 0.0;
    C2dPos start;
    CMathAngle azimuth;
    getAnchor(alignment, index, chainage, start, azimuth);
    onStartChainageUpdate(chainage);
    m_curve.setOrg(start.north(), start.east());
    // The first element has no predecessor to be tangent to: it keeps its own start azimuth.
    if (!m_isStartAzFixed && azimuth.isok()) m_curve.setAz(azimuth);
  }
  bool isShapeOk() const override { return m_curve.isok(); }

  // The defining values shared by every kind: the start azimuth control and the length.
  bool isEqualBase(const CAlntHeT& other) const {
    if (m_isStartAzFixed != other.m_isStartAzFixed) return false;
    CMathAngle mine;
    CMathAngle theirs;
    if (m_isStartAzFixed && (!m_curve.getStartAzimut(mine) || !other.m_curve.getStartAzimut(theirs) ||
                             !mine.isEqual(theirs, svy_math::tol::kElementEqual))) {
      return false;
    }
    return std::fabs(m_curve.getTotalLength() - other.m_curve.getTotalLength()) <= svy_math::tol::kElementEqual;
  }

  // Lengths from -tol::kSnap to the length + tol::kSnap lie on the element.
  bool isOnElement(double length) const {
    return length >= -svy_math::tol::kSnap && length <= m_curve.getTotalLength() + svy_math::tol::kSnap;
  }

  Curve m_curve;
  bool m_isStartAzFixed;
};
