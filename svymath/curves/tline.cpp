#include "svymath/curves/tline.h"

#include <cmath>

#include "svymath/foundation/constants.h"

namespace svy_math {

SVY_RTTI_DEFINE(TLine, CGenericLine)

TLine::TLine()
    : CGenericLine(eIntersectOnSegment),
      m_startNorth(undefinedValue()),
      m_startEast(undefinedValue()),
      m_endNorth(undefinedValue()),
      m_endEast(undefinedValue()) {}

TLine::TLine(const C2dPos& start, const C2dPos& end) : TLine() { initialize(start, end); }

TLine::TLine(const C2dPos& start, const TAngle& azimuth, double length) : TLine() {
  initialize(start, azimuth, length);
}

TLine::TLine(const TLine& other) = default;
TLine& TLine::operator=(const TLine& other) = default;
TLine::~TLine() = default;

void TLine::initialize(const C2dPos& start, const C2dPos& end) {
  m_startNorth = start.north();
  m_startEast = start.east();
  m_endNorth = end.north();
  m_endEast = end.east();
}

void TLine::initialize(const C2dPos& start, const TAngle& azimuth, double length) {
  C2dPos end;
  azimuth.getPosAlong(length, start, end);
  initialize(start, end);
}

TAngle TLine::getAzimuth() const {
  TAngle azimuth;
  azimuth.setAz(m_startNorth, m_startEast, m_endNorth, m_endEast);
  return azimuth;
}

bool TLine::isok() const {
  return std::isfinite(m_startNorth) && std::isfinite(m_startEast) && std::isfinite(m_endNorth) &&
         std::isfinite(m_endEast);
}

double TLine::getStartNorthing() const { return m_startNorth; }
double TLine::getStartEasting() const { return m_startEast; }
double TLine::getEndNorthing() const { return m_endNorth; }
double TLine::getEndEasting() const { return m_endEast; }

}  // namespace svy_math
