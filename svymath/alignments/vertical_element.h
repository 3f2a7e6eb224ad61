#pragma once
// A grade line or a symmetric parabolic vertical curve given directly by its length and grades, and the
// zero-length height step.
//
// Along the element (length s in horizontal metres from its start) the height is A s^2 + B s + C with
// A = (g2 - g1) / (200 L), B = g1 / 100, C = the start height (grades g1, g2 in percent, L the length): a
// grade line when g1 = g2. An element of zero length is a vertical step: its height is the start height
// plus the stored jump.
#include "svymath/alignments/vertical_element_base.h"

class SVYMATH_API CVerticalElement : public CAlntVe {
  SVY_RTTI_DECLARE(CVerticalElement)

 public:
  SVY_CLASS_NEW_DELETE

  // Undefined (every value NaN, jump 0).
  CVerticalElement();
  // A grade line, and a parabola, with their start chainage and height.
  CVerticalElement(double startChainage, double startHeight, double length, double grade);
  CVerticalElement(double startChainage, double startHeight, double length, double startGrade, double endGrade);
  ~CVerticalElement() override;

  // ---- definition (grades in percent, lengths in metres) ----
  void setStraight(double length, double grade);
  void setStraight(double startChainage, double startHeight, double length, double grade);
  void setParabola(double length, double startGrade, double endGrade);
  // From the rise C of the tangents' intersection above the start (at L/2) and the middle ordinate F (the
  // curve's distance below that intersection, positive for a crest): g1 = 200 C / L, g2 = g1 - 800 F / L.
  void setParabolaByCF(double length, double rise, double middleOrdinate);
  // From C and the vertex radius R (positive for a crest): g1 = 200 C / L, g2 = g1 - 100 L / R.
  void setParabolaByCR(double length, double rise, double vertexRadius);
  // A height step at one chainage: zero length, flat on both sides, height + jump after it.
  void setVerticalGap(double jump);
  void setStartHtAndChain(double height, double chainage) override;

  bool isStraight() const { return m_startGrade == m_endGrade; }
  bool isParabola() const { return !isStraight(); }
  bool isVerticalGAP() const;
  double getJump() const { return m_jump; }
  double getFinalChain() const;

  // ---- parabola coefficients: height = A s^2 + B s + C at length s ----
  double getParabolaCoefficientA() const;
  double getParabolaCoefficientB() const;
  double getParabolaCoefficientC() const;
  // Ds = -2 L A, the grade change as a ratio with the sign of a crest positive.
  double getParabolaCoefficientDs() const;
  // Kv = 1 / (2A), the vertex radius (metres; negative for a crest); NaN on a grade line.
  double getParabolaCoefficientKv() const;
  // The high point (isMax) or low point of the parabola where it lies on the element (within the end snap);
  // false on a grade line or when the vertex lies outside the element.
  bool getParabolaExtremum(double& chainage, double& height, bool& isMax) const;

  // ---- CAlntVe ----
  int getType() const override;
  bool isok() const override;
  int getHtAtLen(double length, double& height) const override;
  bool getGradeAtLength(double length, double& grade) const override;
  double getLen() const override { return m_length; }
  double getStartHt() const override { return m_startHeight; }
  double getFinalHt() const override;
  double getStartGrade() const override { return m_startGrade; }
  double getEndGrade() const override { return m_endGrade; }
  bool getAsLs(CLsInfo& info) const override;
  double getStepForDeviation(double length, double deviation) const override;
  CAlntVe* clone() const override;
  bool isEqual(const CAlntVe* other) const override;
  void Accept(CAlntVeVisitor& visitor) override;
  void Accept(CAlntVeVisitor_const& visitor) const override;

 private:
  bool isZeroLength() const;

  double m_startHeight;
  double m_length;
  double m_startGrade;
  double m_endGrade;
  double m_jump;
};
