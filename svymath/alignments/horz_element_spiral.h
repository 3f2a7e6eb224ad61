#pragma once
// The transition spiral element (a full or partial clothoid or cubic spiral, entering or leaving a curve).
#include "svymath/alignments/horz_element_t.h"
#include "svymath/curves/curve_spiral.h"

class SVYMATH_API CAlntHeSpiral : public CAlntHeT<CCurveSpiral> {
  SVY_RTTI_DECLARE(CAlntHeSpiral)

 public:
  SVY_CLASS_NEW_DELETE

  CAlntHeSpiral() = default;
  explicit CAlntHeSpiral(const CCurveSpiral& spiral) { set_data(spiral); }
  ~CAlntHeSpiral() override;

  int getType() const override { return eAlntHeSpiral; }
  CAlntHe* clone() const override;
  void Accept(CAlntHeVisitor_const& visitor) const override;
  void Accept(CAlntHeVisitor& visitor) override;
  // Also the law, the start and end radii.
  bool isEqual(const CAlntHe* other) const override;
};
