#include "svymath/curves/generic_line_impl.h"

SVY_RTTI_DEFINE(CGenericLineImpl, CGenericLine)

CGenericLineImpl::CGenericLineImpl() : CGenericLine(eIntersectOnSegment) {}

CGenericLineImpl::CGenericLineImpl(const C2dPos& start, const C2dPos& end, EIntersectionType type)
    : CGenericLine(type),
      m_startNorth(start.north()),
      m_startEast(start.east()),
      m_endNorth(end.north()),
      m_endEast(end.east()) {
  m_azimuth.setAz(start, end);
}

CGenericLineImpl::CGenericLineImpl(const C2dPos& start, const CMathAngle& azimuth)
    : CGenericLineImpl(start, azimuth, kDefaultLength, eIntersectUnbounded) {}

CGenericLineImpl::CGenericLineImpl(const C2dPos& start, const CMathAngle& azimuth, double length,
                                   EIntersectionType type)
    : CGenericLine(type), m_startNorth(start.north()), m_startEast(start.east()), m_azimuth(azimuth) {
  C2dPos end;
  m_azimuth.getPosAlong(length, start, end);
  m_endNorth = end.north();
  m_endEast = end.east();
}

CGenericLineImpl::CGenericLineImpl(const CGenericLineImpl& other) = default;
CGenericLineImpl& CGenericLineImpl::operator=(const CGenericLineImpl& other) = default;
CGenericLineImpl::~CGenericLineImpl() = default;

bool CGenericLineImpl::isok() const { return true; }
double CGenericLineImpl::getStartNorthing() const { return m_startNorth; }
double CGenericLineImpl::getStartEasting() const { return m_startEast; }
double CGenericLineImpl::getEndNorthing() const { return m_endNorth; }
double CGenericLineImpl::getEndEasting() const { return m_endEast; }

bool CGenericLineImpl::getStartAzimut(CMathAngle& azimuth) const {
  azimuth = m_azimuth;
  return m_azimuth.isok();
}
