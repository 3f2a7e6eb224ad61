#pragma once
// The tangent element: a straight line of given length. Built from its start and end points, it keeps
// their distance as its length and their direction as its start azimuth; in an alignment it starts at the
// predecessor's end and (unless its start azimuth is fixed) runs on along the predecessor's final tangent.
#include "svymath/alignments/horz_element_t.h"
#include "svymath/curves/curve_segment.h"

class SVYMATH_API CAlntHeSegment : public CAlntHeT<CCurveSegment> {
  SVY_RTTI_DECLARE(CAlntHeSegment)

 public:
  SVY_CLASS_NEW_DELETE

  CAlntHeSegment() = default;
  CAlntHeSegment(const TCoords& start, const TCoords& end);
  ~CAlntHeSegment() override;

  // The tangent from start to end (undefined when they coincide).
  void setStartAndFinal(const C2dPos& start, const C2dPos& end);

  int getType() const override { return eAlntHeSegment; }
  CAlntHe* clone() const override;
  void Accept(CAlntHeVisitor_const& visitor) const override;
  void Accept(CAlntHeVisitor& visitor) override;
  bool isEqual(const CAlntHe* other) const override;
};
