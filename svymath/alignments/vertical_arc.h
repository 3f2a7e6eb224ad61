#pragma once
// A circular vertical curve: the arc of a circle in the (chainage, height) plane that leaves its start with
// grade g1 and turns, with radius |R|, to grade g2.
//
// The radius is signed: negative for a crest (convex upwards, the grade decreasing), positive for a sag
// (convex downwards, the grade increasing), 0 for a simple point (equal grades, no curve). The directions of
// the grades are the angles theta = atan(g / 100); the element's length is the arc length |R (theta2 -
// theta1)|, and it is measured along the chainage: the height at length s is the circle's height at the
// chainage start + s. The circle's own horizontal extent, R (sin theta2 - sin theta1), is a little shorter
// than the arc (2.9 cm for +3 % to -2 % at R 5000 m): past it the height follows the circle on, and the
// grade turns slightly beyond g2.
//
// Points of the profile plane are C2dPos holding the chainage in component 0 and the height in component 1.
#include "svymath/alignments/vertical_element_base.h"
#include "svymath/foundation/math_angle.h"
#include "svymath/foundation/positions.h"

class SVYMATH_API CAlntVeArc : public CAlntVe {
  SVY_RTTI_DECLARE(CAlntVeArc)

 public:
  SVY_CLASS_NEW_DELETE

  // Undefined (every value NaN).
  CAlntVeArc();
  ~CAlntVeArc() override;

  // ---- definition (grades in percent) ----
  // The sign of R is forced by the grades (see above); the length follows.
  void setGradesAndR(double startGrade, double endGrade, double radius);
  // The radius follows from the length: R = length / (theta2 - theta1); equal grades give a simple point.
  void setGradesAndLen(double startGrade, double endGrade, double length);
  // The circle about a centre (chainage, height): the start is where the circle has grade g1.
  void setCenterGradesAndR(const C2dPos& centre, double startGrade, double endGrade, double radius);
  // A new radius for the same grades.
  void setRadius(double radius);
  // The radius that turns startGrade into endGrade over the arc length `length` (signed as above).
  static double computeRadius(double startGrade, double endGrade, double length);
  // Recomputes the radius from the current grades and length; false when they are undefined.
  bool computeRadius();
  void setStartHtAndChain(double height, double chainage) override;

  double getRadius() const { return m_radius; }
  // theta2 - theta1 (radians): positive for a sag, negative for a crest.
  double getCentralAngle() const;
  // The centre of the circle, and the end point of the element; false while undefined.
  bool getCenterStaAndHt(double& chainage, double& height) const;
  bool getFinalStaAndHt(double& chainage, double& height) const;
  // The high point (crest, isMax) or low point (sag) where the grade is zero, when it lies on the element.
  bool getExtremum(double& chainage, double& height, bool& isMax) const;
  bool isConvexUpwards() const { return m_radius < 0.0; }
  bool isConvexDownwards() const { return m_radius > 0.0; }
  bool isSimplePoint() const;

  // ---- CAlntVe ----
  int getType() const override { return eAlntVeArc; }
  bool isok() const override;
  int getHtAtLen(double length, double& height) const override;
  bool getGradeAtLength(double length, double& grade) const override;
  double getLen() const override { return m_length; }
  double getStartHt() const override { return m_startHeight; }
  double getFinalHt() const override;
  double getStartGrade() const override;
  double getEndGrade() const override;
  // The intersection point of the two tangents, with the arc as its curve and the radius as fifth value.
  bool getAsLs(CLsInfo& info) const override;
  double getStepForDeviation(double length, double deviation) const override;
  CAlntVe* clone() const override;
  bool isEqual(const CAlntVe* other) const override;
  void Accept(CAlntVeVisitor& visitor) override;
  void Accept(CAlntVeVisitor_const& visitor) const override;

 private:
  // Sets the directions of both grades and forces the sign of the radius.
  void setGrades(double startGrade, double endGrade, double radius);
  // The chainage offset from the centre to the point at length s, as a fraction of R: sin theta there.
  double sinAt(double s) const;
  // Length s snapped to the element; false (logged) outside it.
  bool snapLength(double& s) const;

  double m_startHeight;
  CMathAngle m_startDir;  // angle whose tangent is the start grade / 100
  CMathAngle m_endDir;    // angle whose tangent is the end grade / 100
  double m_length;        // arc length, metres
  double m_radius;        // signed, metres
};
