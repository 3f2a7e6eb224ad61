#pragma once
// A stretch of a profile defined by vertical intersection points (VIPs): from the end of the curve about
// the current point, the grade line towards the next point, then the symmetric parabola about the next
// point. A profile of points P0 .. Pn is the chain of elements (P0, P1), (P1, P2), ..., (Pn-1, Pn); the first
// point's curve length is 0 (it is the profile's start), and so is the last one's.
//
// The parabola about the next point needs the grade that leaves it: the start grade of the following
// element, which the alignment hands over in onNeighbourUpdate. Without a following element the grade
// goes on unchanged (the curve degenerates to a grade line of the curve's length).
//
// Chaining by the vertical alignment (onNeighbourUpdate):
// - a following element of this kind gives its current point as this element's next point, so that an
//   edit of one point re-shapes both elements that meet there;
// - a previous element of another kind gives its end point as this element's current point (curve length
//   0): the grade line starts where that element ends.
#include "svymath/alignments/vertical_two_part.h"

class SVYMATH_API CVerticalLSElement : public CAlntVeTwoPart {
  SVY_RTTI_DECLARE(CVerticalLSElement)

 public:
  SVY_CLASS_NEW_DELETE

  CVerticalLSElement();
  // The two points; the parts are built at once.
  CVerticalLSElement(const CLsInfo& current, const CLsInfo& next);
  ~CVerticalLSElement() override;

  // The points use the intersection chainage, height and curve length of CLsInfo (the other values are
  // derived and ignored on input). Each setter rebuilds the parts.
  void setCurrLSElement(const CLsInfo& info);
  void setNextLSElement(const CLsInfo& info);
  const CLsInfo& getCurrLSElement() const { return m_current; }
  const CLsInfo& getNextLSElement() const { return m_next; }
  // Builds the grade line and the parabola from the two points. False (the element not valid) when a point
  // is undefined, the next point does not lie after the current one, or the two curves overlap (by more
  // than the end snap).
  bool setUpData();
  const CVerticalElement& getParabola() const { return m_parabola; }

  // ---- CAlntVe ----
  int getType() const override { return eAlntVeLs; }
  // The grade of the line from the current to the next point (known before the parts are built).
  double getStartGrade() const override;
  double getEndGrade() const override;
  // The current point: chainage, height, its curve length and curve start, 0.
  bool getAsLs(CLsInfo& info) const override;
  // Moves the current point to (chainage, height), keeping its curve length.
  void setStartHtAndChain(double height, double chainage) override;
  void onNeighbourUpdate(const CAlntVe* previous, const CAlntVe* next) override;
  CAlntVe* clone() const override;
  bool isEqual(const CAlntVe* other) const override;
  void Accept(CAlntVeVisitor& visitor) override;
  void Accept(CAlntVeVisitor_const& visitor) const override;

 protected:
  const CAlntVe& curvePart() const override { return m_parabola; }

 private:
  CLsInfo m_current;
  CLsInfo m_next;
  double m_gradeAfterNext;  // percent; NaN without a following element
  CVerticalElement m_parabola;
};
