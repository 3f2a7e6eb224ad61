#pragma once
// The plan offset of one horizontal element: the curve traced by the point at a constant offset (metres,
// positive right) from the element, as for a lane edge or a kerb line. The parallel of a tangent is a tangent
// and that of an arc an arc (see LineOffset), but the parallel of a spiral is no spiral: this class answers
// the segment queries of the offset curve itself, from the element's own queries and exact relations:
//
// - the offset curve's point at element length s is the element's point at (s, offset), and its direction is
//   the element's direction there (the two curves share their normals);
// - its length from the start to element length s is s - offset * turn(s), turn(s) being the element's change
//   of azimuth in radians (positive turning right), because an arc of the offset curve is (1 - offset * k)
//   times the element's arc, k the curvature;
// - a point's offset from the offset curve is its offset from the element less the offset, at the same foot.
//
// Lengths, positions (northing, easting) and offsets are metres, azimuths decimal degrees clockwise from north.
// The offset curve exists only while the offset stays on the near side of every centre of curvature
// (1 - offset * k > 0 along the element: on the inside of a curve the offset must be smaller than the radius);
// isok() says whether it does, and every query returns false, leaving its outputs unchanged, when it does not.
// The element is read, not owned: the caller keeps it alive and placed.
#include "svymath/foundation/class_new.h"
#include "svymath/foundation/export.h"
#include "svymath/foundation/rtti.h"

class CHorzAlntElemBase;

class SVYMATH_API PlaneOffset : public virtual CRttiBase {
  SVY_RTTI_DECLARE(PlaneOffset)

 public:
  SVY_CLASS_NEW_DELETE

  PlaneOffset(const CHorzAlntElemBase& element, double offset);
  ~PlaneOffset() override;

  // The element is placed with a length, the offset is finite and clears every centre of curvature.
  bool isok() const { return m_ok; }
  double getOffset() const { return m_offset; }
  // The offset curve's whole length.
  bool getLength(double& length) const;

  // Offset-curve length at an element length, and back (the latter by Newton's method on the monotone map).
  bool getLengthAtElementLength(double elementLength, double& length) const;
  bool getElementLengthAtLength(double length, double& elementLength) const;

  // ---- queries by length along the offset curve ----
  bool getPosNeAtLength(double length, double& north, double& east) const;
  bool getAzimuthAtLength(double length, double& azimuthDeg) const;
  // The point's foot on the offset curve (its length) and its offset from the offset curve; false when the
  // point has no foot on the element.
  bool getLengthAndOffset(double north, double east, double& length, double& offset) const;

  // Whether offsets that vary along the element (offsetAtStart at its start, linearly to offsetAtEnd at its
  // end) clear every centre of curvature: 1 - offset * k > 0 at the element's ends and at its chord steps.
  static bool boClearsCentres(const CHorzAlntElemBase& element, double offsetAtStart, double offsetAtEnd);

 private:
  // The element's turn from its start to element length s (radians, positive right).
  bool turnAt(double elementLength, double& turn) const;

  const CHorzAlntElemBase* m_element;
  double m_offset;
  double m_elementLength;
  bool m_ok;
};
