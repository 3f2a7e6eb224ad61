#include "svymath/cogo/localization_2d.h"

#include <cmath>
#include <limits>

#include "svymath/foundation/constants.h"

SVY_RTTI_DEFINE(CLocalizationOn2dPlane, CRttiBase)

CLocalizationOn2dPlane::~CLocalizationOn2dPlane() = default;

namespace {

C2dPos centroid(const svy_vector<C2dPos>& points) {
  double n = 0.0, e = 0.0;
  for (const C2dPos& p : points) n += p.north(), e += p.east();
  const double count = static_cast<double>(points.size());
  return C2dPos(n / count, e / count);
}

// Sum of squared distances from the centre.
double spread(const svy_vector<C2dPos>& points, const C2dPos& centre) {
  double sum = 0.0;
  for (const C2dPos& p : points) {
    const double dn = p.north() - centre.north(), de = p.east() - centre.east();
    sum += dn * dn + de * de;
  }
  return sum;
}

}  // namespace

bool CLocalizationOn2dPlane::addPoint(const C2dPos& from, const C2dPos& to) {
  if (!std::isfinite(from.north()) || !std::isfinite(from.east()) || !std::isfinite(to.north()) ||
      !std::isfinite(to.east()))
    return false;
  m_from.push_back(from);
  m_to.push_back(to);
  m_status = eLocNotSolved;
  return true;
}

void CLocalizationOn2dPlane::reset() {
  m_from.clear();
  m_to.clear();
  m_residuals.clear();
  m_transform = svy_math::TSimilarity2d();
  m_status = eLocNotSolved;
}

ELocalizationStatus CLocalizationOn2dPlane::solve(bool rigid) {
  m_residuals.clear();
  m_transform = svy_math::TSimilarity2d();
  const int m = count();
  if (m < 2) return m_status = eLocTooFewPoints;
  const C2dPos fromCentre = centroid(m_from), toCentre = centroid(m_to);
  const double minSpread = m * svy_math::tol::kControlSpread * svy_math::tol::kControlSpread;
  const double s = spread(m_from, fromCentre);
  if (s < minSpread || spread(m_to, toCentre) < minSpread) return m_status = eLocCoincident;
  double sumCos = 0.0, sumSin = 0.0;
  for (int i = 0; i < m; ++i) {
    const C2dPos f = m_from[i] - fromCentre, t = m_to[i] - toCentre;
    sumCos += f.north() * t.north() + f.east() * t.east();
    sumSin += f.north() * t.east() - f.east() * t.north();
  }
  m_transform.rotation = std::atan2(sumSin, sumCos);
  m_transform.scale = rigid ? 1.0 : std::hypot(sumCos, sumSin) / s;
  // The shift carries the `from` centroid onto the `to` centroid.
  m_transform.shift = toCentre - m_transform.forward(fromCentre);

  // Residuals, and each point's share of the redundancy, r_i = 1 - h_i: the shifts take 1/m of every
  // residual component, the rotation (and scale) (n^2 + e^2) / S about the centroid (half that when the
  // rotation is the only one of the two).
  double sumSq = 0.0;
  svy_vector<double> redundancy;
  for (int i = 0; i < m; ++i) {
    const C2dPos v = m_to[i] - m_transform.forward(m_from[i]);
    TLocalizationResidual r;
    r.dNorth = v.north();
    r.dEast = v.east();
    r.length = std::hypot(v.north(), v.east());
    m_residuals.push_back(r);
    sumSq += r.length * r.length;
    const C2dPos f = m_from[i] - fromCentre;
    redundancy.push_back(1.0 - (f.north() * f.north() + f.east() * f.east()) / s * (rigid ? 0.5 : 1.0) - 1.0 / m);
  }
  const int degreesOfFreedom = 2 * m - (rigid ? 3 : 4);
  m_rms = std::sqrt(sumSq / m);
  m_sigma0 = degreesOfFreedom > 0 ? std::sqrt(sumSq / degreesOfFreedom) : std::numeric_limits<double>::quiet_NaN();
  // Two components of the residual leave the sum when a point is left out.
  constexpr int kFlagDegrees = 3;
  if (degreesOfFreedom >= kFlagDegrees) {
    for (int i = 0; i < m; ++i) {
      TLocalizationResidual& r = m_residuals[i];
      if (redundancy[i] <= 0.0) continue;  // a point that fixes the fit alone cannot be judged
      const double others = (sumSq - r.length * r.length / redundancy[i]) / (degreesOfFreedom - 2);
      const double limit = svy_math::tol::kOutlierFactor * std::sqrt(std::fmax(others, 0.0) * redundancy[i]);
      r.outlier = r.length > limit && r.length > svy_math::tol::kResidualZero;
    }
  }
  return m_status = eLocOk;
}

bool CLocalizationOn2dPlane::getResidual(int i, TLocalizationResidual& out) const {
  if (m_status != eLocOk || i < 0 || i >= static_cast<int>(m_residuals.size())) return false;
  out = m_residuals[i];
  return true;
}

bool CLocalizationOn2dPlane::toTarget(const C2dPos& from, C2dPos& to) const {
  if (m_status != eLocOk) return false;
  to = m_transform.forward(from);
  return true;
}

bool CLocalizationOn2dPlane::toSource(const C2dPos& to, C2dPos& from) const {
  return m_status == eLocOk && m_transform.inverse(to, from);
}
