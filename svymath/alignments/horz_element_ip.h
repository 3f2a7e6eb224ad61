#pragma once
// The intersection-point element: the stretch of an alignment that an intersection point (IP) with its
// curve group (entry spiral, arc, exit spiral: CCurveIp) lays out.
//
// Layout. The element starts at its chained start point (the predecessor's end; for the first element the
// alignment's start point) and runs along the tangent towards its IP up to TS (the lead-in tangent), then
// through the curve group to ST. The group's tangents come from its neighbours: the previous intersection
// point is the previous element's IP when that element is an intersection-point element, otherwise this
// element's own start point; the next intersection point is the next element's IP when that element is an
// intersection-point element. Without one the group acts as a simple point: the element ends at its IP,
// heading along the lead-in tangent. The start azimuth is always the direction towards the IP (a fixed or
// inherited azimuth does not apply), so an IP element after a tangent in another direction makes a kink.
//
// Re-anchoring recomputes the group from the current neighbours (the alignment redoes the element before
// every change, so moving an IP updates the groups on both sides). The element is undefined, and its length
// query fails, when the group does not fit (spirals longer than the deflection allows, collinear tangents,
// a neighbour at the IP) or when the previous element's ST lies beyond this element's TS (their tangent
// lengths overlap).
//
// Lengths run from the start point (0) through TS (the lead-in length) to ST (getHLengthInM).
#include "svymath/alignments/horz_element.h"
#include "svymath/curves/curve_ip.h"
#include "svymath/curves/curve_segment.h"

class SVYMATH_API CAlntHeIp : public CAlntHe {
  SVY_RTTI_DECLARE(CAlntHeIp)

 public:
  SVY_CLASS_NEW_DELETE

  CAlntHeIp();
  CAlntHeIp(const CAlntHeIp& other);
  CAlntHeIp& operator=(const CAlntHeIp& other);
  ~CAlntHeIp() override;

  void copy(const CAlntHeIp& other) { *this = other; }

  // The IP (northing, easting), the arc radius (metres, sign ignored: the turn comes from the tangents)
  // and the entry and exit spiral lengths (metres): CCurveIp::setIp's five values in that order.
  bool setIp(double ipNorth, double ipEast, double radius, double lenIn, double lenOut);
  // The definition of a group (its IP, radius, spiral lengths and law); its neighbours come from the
  // alignment.
  void set_data(const CCurveIp& group) { m_group = group; }
  const CCurveIp& get_data() const { return m_group; }
  // A bare angle point at the IP: no curve.
  void setSimplePoint() { m_group.setSimplePoint(); }
  C2dPos getIp() const { return m_group.getIp(); }
  // Whether the curve group is laid out (there is a next intersection point); false: the element ends at its IP.
  bool hasCurveGroup() const { return m_hasGroup; }
  // Length of the lead-in tangent from the start point to TS (metres); NaN while undefined.
  double getLeadInLength() const { return m_leadIn.getTotalLength(); }

  // Placed and laid out (the group fits between its tangents).
  bool isok() const override;
  int getType() const override { return eAlntHeIp; }
  bool getHLengthInM(double& length) const override;
  bool getStartPosNe(double& north, double& east) const override;
  bool getFinalPosNe(double& north, double& east) const override;
  bool getStartAzimut(CMathAngle& azimuth) const override;
  bool getFinalAzimut(CMathAngle& azimuth) const override;
  bool getPosNeAtLength(double length, double& north, double& east) const override;
  bool getAzimuthAtLength(double length, double& azimuthDeg) const override;
  double getStepForDeviation(double length, double deviation) const override;
  bool getShortestDistAndCurveLen(double north, double east, double& distance, double& length) const override;
  // The lead-in or the group, whichever has the point's foot with the smaller |offset| (the group, being
  // later, within tol::kSnap).
  bool getLengthAndOffset(double north, double east, double& length, double& offset) const override;
  bool getShortestDistanceToPoint(double north, double east, double& distance) const override;
  bool getPosAtLengthAndOffset(double length, double offset, double& north, double& east) const override;
  bool getCurvatureAtLength(double length, double& curvature) const override;
  void ForEachSegment(CGenericSegmentVisitor_const& visitor) const override;
  bool getIpPos(double& north, double& east) const override;

  CAlntHe* clone() const override;
  void Accept(CAlntHeVisitor_const& visitor) const override;
  void Accept(CAlntHeVisitor& visitor) override;
  // The same IP, radius, spiral lengths and law.
  bool isEqual(const CAlntHe* other) const override;

 protected:
  void onSetIndex(const CHorzAlntBase& alignment, int index) override;
  // The IP is given.
  bool isShapeOk() const override;

 private:
  // Whether the element is laid out (lead-in and, where used, the group).
  bool isLaidOut() const;
  // Makes the layout undefined.
  void clearLayout();
  // One part's answer to a point: its length along the part and a distance value.
  struct TPartAnswer {
    bool found = false;
    double length = 0.0;
    double value = 0.0;
  };
  // The lead-in's answer or the group's (its length then counted from the start), whichever has the
  // smaller |value|; with groupWithinSnap the later group also wins when farther by up to tol::kSnap.
  // False when neither part answered.
  bool choosePart(const TPartAnswer& leadIn, const TPartAnswer& group, bool groupWithinSnap, double& length,
                  double& value) const;

  CCurveIp m_group;
  CCurveSegment m_leadIn;
  bool m_hasGroup;
};
