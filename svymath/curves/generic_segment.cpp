#include "svymath/curves/generic_segment.h"

#include <cmath>

#include "svymath/curves/generic_arc.h"
#include "svymath/curves/generic_line.h"
#include "svymath/curves/generic_segment_visitor.h"
#include "svymath/curves/generic_spiral.h"
#include "svymath/foundation/constants.h"

SVY_RTTI_DEFINE(CGenericSegment, CRttiBase)

// Second step of the double dispatch: the visited segment's kind selects the overload of the asking segment.
class CGenericSegment::CIntersectionDispatch : public CGenericSegmentVisitor_const {
 public:
  CIntersectionDispatch(const CGenericSegment& self, svy_vector<C2dPos>& out) : m_self(self), m_out(out) {}

  void Visit(const CGenericLine& line) override { m_found = m_self.doCalcIntersections(line, m_out); }
  void Visit(const CGenericArc& arc) override { m_found = m_self.doCalcIntersections(arc, m_out); }
  void Visit(const CGenericSpiral& spiral) override { m_found = m_self.doCalcIntersections(spiral, m_out); }

  bool found() const { return m_found; }

 private:
  const CGenericSegment& m_self;
  svy_vector<C2dPos>& m_out;
  bool m_found = false;
};

CGenericSegment::CGenericSegment(EIntersectionType type) : m_intersectionType(type) {}

CGenericSegment::CGenericSegment(const CGenericSegment& other)
    : CRttiBase(other), m_intersectionType(other.m_intersectionType) {}

CGenericSegment& CGenericSegment::operator=(const CGenericSegment& other) {
  m_intersectionType = other.m_intersectionType;
  return *this;
}

CGenericSegment::~CGenericSegment() = default;

C2dPos CGenericSegment::getStartPos() const { return C2dPos(getStartNorthing(), getStartEasting()); }

C2dPos CGenericSegment::getEndPos() const { return C2dPos(getEndNorthing(), getEndEasting()); }

double CGenericSegment::getNextPosForDeviation(double length, double deviation, C2dPos& pos) const {
  return getNextPosForDeviation(length, deviation, pos.north(), pos.east());
}

double CGenericSegment::getNextPosForDeviation(double length, double deviation, double& north,
                                               double& east) const {
  const double next = length + getStepForDeviation(length, deviation);
  getPosAtLength(next, north, east);
  return next;
}

bool CGenericSegment::getPosAtLength(double length, C2dPos& pos) const {
  return getPosAtLength(length, pos.north(), pos.east());
}

bool CGenericSegment::getPosAtLengthAndOffset(double length, double offset, C2dPos& pos) const {
  return getPosAtLengthAndOffset(length, offset, pos.north(), pos.east());
}

bool CGenericSegment::getLengthAndOffset(const C2dPos& pos, double& length, double& offset) const {
  return getLengthAndOffset(pos.north(), pos.east(), length, offset);
}

bool CGenericSegment::getShortestDistanceToPoint(const C2dPos& pos, double& distance) const {
  return getShortestDistanceToPoint(pos.north(), pos.east(), distance);
}

bool CGenericSegment::calcIntersections(const CGenericSegment& other, svy_vector<C2dPos>& out) const {
  return doCalcIntersections(other, out);
}

bool CGenericSegment::calcIntersections(const CGenericLine& other, svy_vector<C2dPos>& out) const {
  return doCalcIntersections(static_cast<const CGenericSegment&>(other), out);
}

bool CGenericSegment::calcIntersections(const CGenericArc& other, svy_vector<C2dPos>& out) const {
  return doCalcIntersections(static_cast<const CGenericSegment&>(other), out);
}

bool CGenericSegment::calcIntersections(const CGenericSpiral& other, svy_vector<C2dPos>& out) const {
  return doCalcIntersections(static_cast<const CGenericSegment&>(other), out);
}

bool CGenericSegment::doCalcIntersections(const CGenericSegment& other, svy_vector<C2dPos>& out) const {
  CIntersectionDispatch dispatch(*this, out);
  other.Accept(dispatch);
  return dispatch.found();
}

bool CGenericSegment::checkDistanceAlongIsOnLine(double length) const {
  switch (m_intersectionType) {
    case eIntersectUnbounded:
      return true;
    case eIntersectOnSegmentTol: {
      const double total = getTotalLength();
      return (length > 0.0 && length < total) || std::fabs(length) < svy_math::tol::kSnap ||
             std::fabs(length - total) < svy_math::tol::kSnap;
    }
    case eIntersectOnSegment:
    default:
      return length >= 0.0 && length <= getTotalLength();
  }
}
