#include "svymath/alignments/vertical_ls_with_arc.h"

#include <cmath>

#include "svymath/alignments/vertical_visitor.h"
#include "svymath/foundation/constants.h"

using svy_math::isUndefined;
using svy_math::tol::kSnap;
using svy_math::tol::kZero;
using svy_math::units::kPercent;

SVY_RTTI_DEFINE(CAlntVeLsWithArc, CAlntVeTwoPart)

CAlntVeLsWithArc::CAlntVeLsWithArc()
    : m_ipChainage(svy_math::undefinedValue()),
      m_ipHeight(svy_math::undefinedValue()),
      m_radius(0.0),
      m_fromChainage(svy_math::undefinedValue()),
      m_fromHeight(svy_math::undefinedValue()),
      m_startChainage(svy_math::undefinedValue()),
      m_startHeight(svy_math::undefinedValue()),
      m_nextGrade(svy_math::undefinedValue()),
      m_gradeIn(svy_math::undefinedValue()),
      m_gradeOut(svy_math::undefinedValue()) {}

CAlntVeLsWithArc::~CAlntVeLsWithArc() = default;

void CAlntVeLsWithArc::setIpAndR(const C2dPos& ip, double radius) { setIpAndR(ip[0], ip[1], radius); }

void CAlntVeLsWithArc::setIpAndR(double chainage, double height, double radius) {
  m_ipChainage = chainage;
  m_ipHeight = height;
  m_radius = radius;
  setUpData();
}

bool CAlntVeLsWithArc::getIpStaAndHt(double& chainage, double& height) const {
  if (isUndefined(m_ipChainage) || isUndefined(m_ipHeight)) return false;
  chainage = m_ipChainage;
  height = m_ipHeight;
  return true;
}

void CAlntVeLsWithArc::setRadius(double radius) {
  m_radius = radius;
  setUpData();
}

bool CAlntVeLsWithArc::setUpData() {
  m_valid = false;
  if (isUndefined(m_ipChainage) || isUndefined(m_ipHeight) || isUndefined(m_radius)) return false;
  const double run = m_ipChainage - m_fromChainage;
  double gradeIn = run >= kZero ? (m_ipHeight - m_fromHeight) / run * kPercent : svy_math::undefinedValue();
  double gradeOut = m_nextGrade;
  // A missing side continues the other one; a lone point is level.
  if (isUndefined(gradeIn)) gradeIn = isUndefined(gradeOut) ? 0.0 : gradeOut;
  if (isUndefined(gradeOut)) gradeOut = gradeIn;
  m_gradeIn = gradeIn;
  m_gradeOut = gradeOut;
  m_arc.setGradesAndR(gradeIn, gradeOut, m_radius);
  // The arc leaves the incoming line |R tan(dtheta / 2)| before the point, measured along the line.
  CLsInfo shape;
  m_arc.setStartHtAndChain(0.0, 0.0);
  if (!m_arc.getAsLs(shape)) return false;
  const double arcStart = m_ipChainage - shape.ipChainage;
  const double arcStartHeight = m_ipHeight - shape.ipHeight;
  m_arc.setStartHtAndChain(arcStartHeight, arcStart);
  // Without a previous element the element starts with its arc.
  const bool hasStart = !isUndefined(m_startChainage) && !isUndefined(m_startHeight);
  const double start = hasStart ? m_startChainage : arcStart;
  const double straight = arcStart - start;
  if (straight < -kSnap) return false;
  m_straight.setStraight(start, hasStart ? m_startHeight : arcStartHeight, std::fmax(straight, 0.0), gradeIn);
  onStartChainageUpdate(start);
  m_valid = true;
  return true;
}

bool CAlntVeLsWithArc::getAsLs(CLsInfo& info) const {
  double chainage = 0.0;
  double height = 0.0;
  if (!getIpStaAndHt(chainage, height)) return false;
  double arcStart = chainage;
  m_arc.getStartChainageInM(arcStart);
  info = CLsInfo(chainage, height, m_valid ? m_arc.getLen() : 0.0, arcStart, m_radius);
  return true;
}

void CAlntVeLsWithArc::setStartHtAndChain(double height, double chainage) {
  m_ipChainage = chainage;
  m_ipHeight = height;
  setUpData();
}

void CAlntVeLsWithArc::onNeighbourUpdate(const CAlntVe* previous, const CAlntVe* next) {
  m_fromChainage = m_fromHeight = m_startChainage = m_startHeight = svy_math::undefinedValue();
  if (previousEnd(previous, m_startHeight, m_startChainage)) {
    const CAlntVeLsWithArc* before = cast(previous);
    if (before == nullptr || !before->getIpStaAndHt(m_fromChainage, m_fromHeight)) {
      m_fromChainage = m_startChainage;
      m_fromHeight = m_startHeight;
    }
  }
  m_nextGrade = svy_math::undefinedValue();
  const CAlntVeLsWithArc* after = cast(next);
  double nextChainage = 0.0;
  double nextHeight = 0.0;
  if (after != nullptr && after->getIpStaAndHt(nextChainage, nextHeight)) {
    const double run = nextChainage - m_ipChainage;
    if (run >= kZero) m_nextGrade = (nextHeight - m_ipHeight) / run * kPercent;
  } else if (next != nullptr) {
    m_nextGrade = next->getStartGrade();
  }
  setUpData();
}

CAlntVe* CAlntVeLsWithArc::clone() const { return new CAlntVeLsWithArc(*this); }

bool CAlntVeLsWithArc::isEqual(const CAlntVe* other) const {
  const CAlntVeLsWithArc* o = cast(other);
  return o != nullptr && sameStart(*o) && sameValue(m_ipChainage, o->m_ipChainage) &&
         sameValue(m_ipHeight, o->m_ipHeight) && sameValue(m_radius, o->m_radius) &&
         sameValue(m_gradeIn, o->m_gradeIn) && sameValue(m_gradeOut, o->m_gradeOut);
}

void CAlntVeLsWithArc::Accept(CAlntVeVisitor& visitor) { visitor.Visit(*this); }

void CAlntVeLsWithArc::Accept(CAlntVeVisitor_const& visitor) const { visitor.Visit(*this); }
