#include "svymath/geodesy/helmert.h"

#include <cmath>

#include "svymath/foundation/constants.h"

namespace svy_math {
namespace {

using Vec3 = TAbstractPoint3<double>;

// The vector turned by `angle` about one axis (0 X, 1 Y, 2 Z), anticlockwise seen from that axis.
Vec3 turnAbout(int axis, double angle, const Vec3& v) {
  const int i = (axis + 1) % 3, j = (axis + 2) % 3;
  const double c = std::cos(angle), s = std::sin(angle);
  Vec3 out = v;
  out[i] = c * v[i] - s * v[j];
  out[j] = s * v[i] + c * v[j];
  return out;
}

// R v, or R^-1 v, for the chosen form of R.
Vec3 rotate(const THelmertParams& p, EHelmertRotation form, bool inverse, const Vec3& v) {
  const Vec3 r(p.rx, p.ry, p.rz);
  if (form == eHelmertRigorous) {
    if (!inverse) return turnAbout(2, p.rz, turnAbout(1, p.ry, turnAbout(0, p.rx, v)));
    return turnAbout(0, -p.rx, turnAbout(1, -p.ry, turnAbout(2, -p.rz, v)));
  }
  // I + [r]x is v + r x v; its inverse is (v - r x v + r (r . v)) / (1 + r . r).
  if (!inverse) return v + r.VectorProduct(v);
  return (v - r.VectorProduct(v) + r * (r * v)) / (1.0 + r * r);
}

}  // namespace

bool ECRFCorrections(const Coord& in, const THelmertParams& p, EHelmertRotation form, bool inverse, Coord& out) {
  const double values[] = {in.x(), in.y(), in.z(), p.tx, p.ty, p.tz, p.rx, p.ry, p.rz, p.scalePpm};
  for (double v : values)
    if (!std::isfinite(v)) return false;
  const double scale = 1.0 + p.scalePpm * units::kPartsPerMillion;
  if (!(scale > 0.0)) return false;
  const Vec3 t(p.tx, p.ty, p.tz);
  out = inverse ? Coord(rotate(p, form, true, (in - t) / scale)) : Coord(t + rotate(p, form, false, in) * scale);
  return true;
}

bool firstOrderGaussMarkov(double mean, double variance, double correlationTime, double step,
                           double steadyStateVariance, double& nextMean, double& nextVariance) {
  if (!std::isfinite(mean) || !std::isfinite(variance) || !std::isfinite(step) ||
      !std::isfinite(steadyStateVariance) || !(correlationTime > 0.0) || step < 0.0 || variance < 0.0 ||
      steadyStateVariance < 0.0)
    return false;
  const double phi = std::exp(-step / correlationTime);
  nextMean = phi * mean;
  // 1 - phi^2 through expm1 keeps its digits for steps far shorter than tau.
  nextVariance = phi * phi * variance - steadyStateVariance * std::expm1(-2.0 * step / correlationTime);
  return true;
}

}  // namespace svy_math
