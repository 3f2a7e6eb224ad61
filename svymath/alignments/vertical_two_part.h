#pragma once
// The common shape of the elements defined by intersection points: a grade line (the start segment) followed
// by the vertical curve about an intersection point. The kinds build both parts from their points
// (setUpData); this class answers the length queries on the parts.
#include "svymath/alignments/vertical_element.h"

class SVYMATH_API CAlntVeTwoPart : public CAlntVe {
  SVY_RTTI_DECLARE(CAlntVeTwoPart)

 public:
  SVY_CLASS_NEW_DELETE

  ~CAlntVeTwoPart() override;

  // The grade line from the element's start to the start of its curve.
  const CVerticalElement& getStartSegment() const { return m_straight; }
  // Whether the parts are built (the defining points are known and consistent).
  bool isValid() const { return m_valid; }

  bool isok() const override;
  int getHtAtLen(double length, double& height) const override;
  bool getGradeAtLength(double length, double& grade) const override;
  double getLen() const override;
  double getStartHt() const override;
  double getFinalHt() const override;
  // Steps on the grade line end at the curve's start; on the curve they follow its chord rule.
  double getStepForDeviation(double length, double deviation) const override;

 protected:
  CAlntVeTwoPart();
  CAlntVeTwoPart(const CAlntVeTwoPart&) = default;
  CAlntVeTwoPart& operator=(const CAlntVeTwoPart&) = default;

  // The curve after the start segment.
  virtual const CAlntVe& curvePart() const = 0;
  // Length s snapped to the whole element; false outside it (code: before start or after end).
  int snapToElement(double& s) const;

  CVerticalElement m_straight;
  bool m_valid;
};
