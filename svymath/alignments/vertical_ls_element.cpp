#include "svymath/alignments/vertical_ls_element.h"

#include <cmath>

#include "svymath/alignments/vertical_visitor.h"
#include "svymath/foundation/constants.h"

using svy_math::isUndefined;
using svy_math::tol::kSnap;
using svy_math::tol::kZero;
using svy_math::units::kPercent;

SVY_RTTI_DEFINE(CVerticalLSElement, CAlntVeTwoPart)

namespace {

// A point's curve length, an undefined one counting as no curve.
double curveLengthOf(const CLsInfo& info) { return isUndefined(info.curveLength) ? 0.0 : info.curveLength; }

}  // namespace

CVerticalLSElement::CVerticalLSElement() : m_gradeAfterNext(svy_math::undefinedValue()) {}

CVerticalLSElement::CVerticalLSElement(const CLsInfo& current, const CLsInfo& next)
    : m_current(current), m_next(next), m_gradeAfterNext(svy_math::undefinedValue()) {
  setUpData();
}

CVerticalLSElement::~CVerticalLSElement() = default;

void CVerticalLSElement::setCurrLSElement(const CLsInfo& info) {
  m_current = info;
  setUpData();
}

void CVerticalLSElement::setNextLSElement(const CLsInfo& info) {
  m_next = info;
  setUpData();
}

double CVerticalLSElement::getStartGrade() const {
  const double run = m_next.ipChainage - m_current.ipChainage;
  if (!m_current.isok() || !m_next.isok() || !(run >= kZero)) return svy_math::undefinedValue();
  return (m_next.ipHeight - m_current.ipHeight) / run * kPercent;
}

double CVerticalLSElement::getEndGrade() const {
  return isUndefined(m_gradeAfterNext) ? getStartGrade() : m_gradeAfterNext;
}

bool CVerticalLSElement::setUpData() {
  m_valid = false;
  const double grade = getStartGrade();
  if (isUndefined(grade)) return false;
  const double currentCurve = curveLengthOf(m_current);
  const double nextCurve = curveLengthOf(m_next);
  // The element starts where the curve about the current point ends, on the line towards the next point.
  const double startChainage = m_current.ipChainage + 0.5 * currentCurve;
  const double curveStart = m_next.ipChainage - 0.5 * nextCurve;
  const double straight = curveStart - startChainage;
  if (straight < -kSnap || currentCurve < 0.0 || nextCurve < 0.0) return false;
  m_straight.setStraight(startChainage, m_current.ipHeight + grade * 0.5 * currentCurve / kPercent,
                         std::fmax(straight, 0.0), grade);
  m_parabola.setParabola(nextCurve, grade, getEndGrade());
  m_parabola.setStartHtAndChain(m_next.ipHeight - grade * 0.5 * nextCurve / kPercent,
                                startChainage + m_straight.getLen());
  onStartChainageUpdate(startChainage);
  m_valid = true;
  return true;
}

bool CVerticalLSElement::getAsLs(CLsInfo& info) const {
  if (!m_current.isok()) return false;
  const double curve = curveLengthOf(m_current);
  info = CLsInfo(m_current.ipChainage, m_current.ipHeight, curve, m_current.ipChainage - 0.5 * curve, 0.0);
  return true;
}

void CVerticalLSElement::setStartHtAndChain(double height, double chainage) {
  m_current.ipChainage = chainage;
  m_current.ipHeight = height;
  setUpData();
}

void CVerticalLSElement::onNeighbourUpdate(const CAlntVe* previous, const CAlntVe* next) {
  const CVerticalLSElement* following = cast(next);
  if (following != nullptr && following->m_current.isok()) m_next = following->m_current;
  m_gradeAfterNext = next != nullptr ? next->getStartGrade() : svy_math::undefinedValue();
  double height = 0.0;
  double chainage = 0.0;
  if (cast(previous) == nullptr && previousEnd(previous, height, chainage)) {
    m_current = CLsInfo(chainage, height, 0.0, chainage, 0.0);
  }
  setUpData();
}

CAlntVe* CVerticalLSElement::clone() const { return new CVerticalLSElement(*this); }

bool CVerticalLSElement::isEqual(const CAlntVe* other) const {
  const CVerticalLSElement* o = cast(other);
  const auto samePoint = [](const CLsInfo& a, const CLsInfo& b) {
    return sameValue(a.ipChainage, b.ipChainage) && sameValue(a.ipHeight, b.ipHeight) &&
           sameValue(curveLengthOf(a), curveLengthOf(b));
  };
  return o != nullptr && samePoint(m_current, o->m_current) && samePoint(m_next, o->m_next) &&
         sameValue(m_gradeAfterNext, o->m_gradeAfterNext);
}

void CVerticalLSElement::Accept(CAlntVeVisitor& visitor) { visitor.Visit(*this); }

void CVerticalLSElement::Accept(CAlntVeVisitor_const& visitor) const { visitor.Visit(*this); }
