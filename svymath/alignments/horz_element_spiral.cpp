#include "svymath/alignments/horz_element_spiral.h"

#include "svymath/alignments/horz_element_visitor.h"

SVY_RTTI_DEFINE(CAlntHeSpiral, CAlntHe)

CAlntHeSpiral::~CAlntHeSpiral() = default;

CAlntHe* CAlntHeSpiral::clone() const { return new CAlntHeSpiral(*this); }

void CAlntHeSpiral::Accept(CAlntHeVisitor_const& visitor) const { visitor.Visit(*this); }

void CAlntHeSpiral::Accept(CAlntHeVisitor& visitor) { visitor.Visit(*this); }

bool CAlntHeSpiral::isEqual(const CAlntHe* other) const {
  const CAlntHeSpiral* spiral = cast(other);
  if (spiral == nullptr || !isEqualBase(*spiral)) return false;
  const CCurveDataSpiral& mine = m_curve.getCurve();
  const CCurveDataSpiral& theirs = spiral->m_curve.getCurve();
  return mine.getSpiralMathType() == theirs.getSpiralMathType() &&
         std::fabs(mine.getStartRadius() - theirs.getStartRadius()) <= svy_math::tol::kElementEqual &&
         std::fabs(mine.getFinalRadius() - theirs.getFinalRadius()) <= svy_math::tol::kElementEqual;
}
