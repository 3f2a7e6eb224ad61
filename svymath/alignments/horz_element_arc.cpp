#include "svymath/alignments/horz_element_arc.h"

#include "svymath/alignments/horz_element_visitor.h"

SVY_RTTI_DEFINE(CAlntHeArc, CAlntHe)

CAlntHeArc::CAlntHeArc(const CArc& arc) { setArc(arc); }

CAlntHeArc::~CAlntHeArc() = default;

bool CAlntHeArc::setArc(const CArc& arc) {
  CMathAngle startTangent;
  if (!arc.isok() || arc.fullCircle || !arc.get_start_tgdir(startTangent)) return false;
  CCurveDataArc data;
  if (!data.SetElement(arc.getLength(), arc.getRadius(), arc.clockwise)) return false;
  m_curve.setCurve(data);
  m_curve.setOrgAz(arc.start.north(), arc.start.east(), startTangent);
  return true;
}

bool CAlntHeArc::getArc(CArc& arc) const {
  CMathAngle startTangent;
  if (!m_curve.isok() || !m_curve.getStartAzimut(startTangent)) return false;
  const double radius = m_curve.getRadius();
  return arc.set_start_r_length(m_curve.getStartPos(), startTangent, std::fabs(radius), m_curve.getTotalLength(),
                                radius > 0.0);
}

CAlntHe* CAlntHeArc::clone() const { return new CAlntHeArc(*this); }

void CAlntHeArc::Accept(CAlntHeVisitor_const& visitor) const { visitor.Visit(*this); }

void CAlntHeArc::Accept(CAlntHeVisitor& visitor) { visitor.Visit(*this); }

bool CAlntHeArc::isEqual(const CAlntHe* other) const {
  const CAlntHeArc* arc = cast(other);
  return arc != nullptr && isEqualBase(*arc) &&
         std::fabs(m_curve.getRadius() - arc->m_curve.getRadius()) <= svy_math::tol::kElementEqual;
}
