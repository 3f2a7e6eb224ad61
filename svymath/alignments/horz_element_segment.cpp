#include "svymath/alignments/horz_element_segment.h"

#include "svymath/alignments/horz_element_visitor.h"

SVY_RTTI_DEFINE(CAlntHeSegment, CAlntHe)

CAlntHeSegment::CAlntHeSegment(const TCoords& start, const TCoords& end) { setStartAndFinal(start.pos(), end.pos()); }

CAlntHeSegment::~CAlntHeSegment() = default;

void CAlntHeSegment::setStartAndFinal(const C2dPos& start, const C2dPos& end) {
  CMathAngle azimuth;
  CCurveDataSegment data;
  if (azimuth.setAz(start, end)) {
    data.setLen(std::hypot(end.north() - start.north(), end.east() - start.east()));
    data.setAzRad(0.0);
  }
  m_curve.setCurve(data);
  m_curve.setOrgAz(start.north(), start.east(), azimuth);
}

CAlntHe* CAlntHeSegment::clone() const { return new CAlntHeSegment(*this); }

void CAlntHeSegment::Accept(CAlntHeVisitor_const& visitor) const { visitor.Visit(*this); }

void CAlntHeSegment::Accept(CAlntHeVisitor& visitor) { visitor.Visit(*this); }

bool CAlntHeSegment::isEqual(const CAlntHe* other) const {
  const CAlntHeSegment* segment = cast(other);
  return segment != nullptr && isEqualBase(*segment);
}
