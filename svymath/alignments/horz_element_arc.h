#pragma once
// The circular arc element. Its radius is signed: positive turning right (clockwise).
#include "svymath/alignments/horz_element_t.h"
#include "svymath/curves/curve_arc.h"
#include "svymath/foundation/arc.h"

class SVYMATH_API CAlntHeArc : public CAlntHeT<CCurveArc> {
  SVY_RTTI_DECLARE(CAlntHeArc)

 public:
  SVY_CLASS_NEW_DELETE

  CAlntHeArc() = default;
  explicit CAlntHeArc(const CArc& arc);
  ~CAlntHeArc() override;

  // The arc's start, start tangent, radius, sweep and direction (a whole circle is refused: false).
  bool setArc(const CArc& arc);
  // The element as an arc record (false when it is not defined).
  bool getArc(CArc& arc) const;

  int getType() const override { return eAlntHeArc; }
  CAlntHe* clone() const override;
  void Accept(CAlntHeVisitor_const& visitor) const override;
  void Accept(CAlntHeVisitor& visitor) override;
  bool isEqual(const CAlntHe* other) const override;
};
