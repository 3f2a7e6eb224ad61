#pragma once
// A stretch of a profile defined by an intersection point with a circular vertical curve: from the end of
// the previous element, the grade line towards the point, then the circular curve of radius |R| about the
// point, tangent to the lines on both sides. A profile of points P0 .. Pn is the chain of elements P0 .. Pn
// with the radius of each; the first (the profile's start) and the last have radius 0: the first element is
// then the start point alone, of length 0.
//
// The lines on either side come from the neighbours (onNeighbourUpdate): the incoming line runs from the
// previous element's intersection point (when it is of this kind) or end point; the outgoing grade is the
// line to the next element's intersection point (this kind) or that element's start grade. Without a
// neighbour on one side the grade of the other side goes on, so there is no curve.
//
// Points of the profile plane are C2dPos holding the chainage in component 0 and the height in component 1.
#include "svymath/alignments/vertical_arc.h"
#include "svymath/alignments/vertical_two_part.h"
#include "svymath/foundation/positions.h"

class SVYMATH_API CAlntVeLsWithArc : public CAlntVeTwoPart {
  SVY_RTTI_DECLARE(CAlntVeLsWithArc)

 public:
  SVY_CLASS_NEW_DELETE

  CAlntVeLsWithArc();
  ~CAlntVeLsWithArc() override;

  // The intersection point and the radius (its sign is forced by the grades, as for CAlntVeArc).
  void setIpAndR(const C2dPos& ip, double radius);
  void setIpAndR(double chainage, double height, double radius);
  bool getIpStaAndHt(double& chainage, double& height) const;
  double getRadius() const { return m_radius; }
  void setRadius(double radius);
  bool isSimplePoint() const { return m_arc.isSimplePoint(); }
  const CAlntVeArc& getArc() const { return m_arc; }
  // Builds the grade line and the arc; false (not valid) when the point is undefined or the arc would begin
  // before the element's start (by more than the end snap).
  bool setUpData();

  // ---- CAlntVe ----
  int getType() const override { return eAlntVeLsWithArc; }
  double getStartGrade() const override { return m_gradeIn; }
  double getEndGrade() const override { return m_gradeOut; }
  // The intersection point, the arc's length and start chainage, and the radius.
  bool getAsLs(CLsInfo& info) const override;
  // Moves the intersection point to (chainage, height).
  void setStartHtAndChain(double height, double chainage) override;
  void onNeighbourUpdate(const CAlntVe* previous, const CAlntVe* next) override;
  CAlntVe* clone() const override;
  bool isEqual(const CAlntVe* other) const override;
  void Accept(CAlntVeVisitor& visitor) override;
  void Accept(CAlntVeVisitor_const& visitor) const override;

 protected:
  const CAlntVe& curvePart() const override { return m_arc; }

 private:
  double m_ipChainage;
  double m_ipHeight;
  double m_radius;      // as given
  double m_fromChainage;  // where the incoming line comes from (NaN: no previous element)
  double m_fromHeight;
  double m_startChainage;  // where the element starts: the previous element's end (NaN: none)
  double m_startHeight;
  double m_nextGrade;  // grade leaving the point, percent (NaN: no following element)
  double m_gradeIn;    // the grades actually used, percent
  double m_gradeOut;
  CAlntVeArc m_arc;
};
