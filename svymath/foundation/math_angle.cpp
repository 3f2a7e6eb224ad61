#include "svymath/foundation/math_angle.h"

#include <cmath>

#include "svymath/foundation/angle_functions.h"
#include "svymath/foundation/constants.h"

namespace {

namespace units = svy_math::units;
namespace tol = svy_math::tol;

bool withinZero(double x) { return -tol::kZero < x && x < tol::kZero; }

}  // namespace

CMathAngle::CMathAngle()
    : m_rad(0.0), m_sin(svy_math::undefinedValue()), m_cos(svy_math::undefinedValue()) {}

CMathAngle::CMathAngle(double degrees) : CMathAngle() { setDeg(degrees); }

void CMathAngle::store(double rad) {
  m_rad = toRange(rad, -units::kPi, units::kPi);
  m_sin = svy_math::undefinedValue();
  m_cos = svy_math::undefinedValue();
}

void CMathAngle::fillCaches() const {
  const double r = getRad();
  m_sin = std::sin(r);
  m_cos = std::cos(r);
}

double CMathAngle::getDeg() const { return getRad() * units::kRadToDeg; }
double CMathAngle::get0To2PI() const { return toRange(getRad(), 0.0, units::kTwoPi); }
double CMathAngle::get0To360() const { return toRange(getDeg(), 0.0, units::kFullCircleDeg); }

double CMathAngle::getTg() const {
  const double c = getCos();
  return withinZero(c) ? 0.0 : getSin() / c;
}

double CMathAngle::getCtg() const {
  const double s = getSin();
  return withinZero(s) ? 0.0 : getCos() / s;
}

void CMathAngle::getDMS(int& d, int& m, double& s) const {
  const double x = getDeg();
  const bool negative = x < 0.0;
  const double a = std::fmod(std::fabs(x), units::kFullCircleDeg);
  d = static_cast<int>(std::floor(a));
  const double f = (a - d) * units::kArcMinutesPerDegree;
  m = static_cast<int>(std::floor(f));
  s = (f - m) * units::kArcMinutesPerDegree;
  if (withinZero(s - units::kArcMinutesPerDegree)) {
    m += 1;
    s = 0.0;
  }
  if (m > 59) {
    d += 1;
    m = 0;
  }
  if (d > 359) d -= 360;
  if (negative) d = -d;
}

void CMathAngle::getDir(C2dPos& dir) const { dir = C2dPos(getCos(), getSin()); }
C2dPos CMathAngle::getDir() const { return C2dPos(getCos(), getSin()); }

void CMathAngle::getPosAlong(double dist, double n0, double e0, double& n, double& e) const {
  n = n0 + dist * getCos();
  e = e0 + dist * getSin();
}

void CMathAngle::getPosAlong(double dist, const C2dPos& from, C2dPos& to) const {
  getPosAlong(dist, from.north(), from.east(), to.north(), to.east());
}

void CMathAngle::getPosAcross(double dist, double n0, double e0, double& n, double& e) const {
  n = n0 - dist * getSin();
  e = e0 + dist * getCos();
}

void CMathAngle::getPosAcross(double dist, const C2dPos& from, C2dPos& to) const {
  getPosAcross(dist, from.north(), from.east(), to.north(), to.east());
}

void CMathAngle::getRotated(double& n, double& e) const {
  const double rn = getRotatedNorth(n, e);
  e = getRotatedEast(n, e);
  n = rn;
}

void CMathAngle::getRotatedBack(double& n, double& e) const {
  const double rn = getRotatedBackNorth(n, e);
  e = getRotatedBackEast(n, e);
  n = rn;
}

void CMathAngle::getRotatedPoint(const C2dPos& centre, const C2dPos& p, C2dPos& result) const {
  const double dn = p.north() - centre.north();
  const double de = p.east() - centre.east();
  result = C2dPos(centre.north() + getRotatedNorth(dn, de), centre.east() + getRotatedEast(dn, de));
}

TQuadrant CMathAngle::getQuadrant() const {
  const double a = toRange(getRad(), 0.0, units::kTwoPi);
  const int q = 1 + static_cast<int>(std::floor(2.0 * a / units::kPi));
  TQuadrant quadrant;
  quadrant.northward = q == 1 || q == 4;
  quadrant.eastward = q == 1 || q == 2;
  return quadrant;
}

bool CMathAngle::isEqual(const CMathAngle& other, double tol) const {
  double d = std::fabs(get0To2PI() - other.get0To2PI());
  if (d > units::kPi) d -= units::kTwoPi;
  return -tol < d && d < tol;
}

bool CMathAngle::operator==(const CMathAngle& other) const {
  return std::fabs(getRad() - other.getRad()) < tol::kZero;
}

bool CMathAngle::isSameAsAzimuth(const C2dPos& p1, const C2dPos& p2) const {
  const double length = (p2 - p1).Module();
  C2dPos reached;
  getPosAlong(length, p1, reached);
  return withinZero(reached.north() - p2.north()) && withinZero(reached.east() - p2.east());
}

bool CMathAngle::isSharp() const {
  const double r = getRad();
  return -units::kHalfPi < r && r < units::kHalfPi;
}

void CMathAngle::reset() {
  m_rad = svy_math::undefinedValue();
  m_sin = svy_math::undefinedValue();
  m_cos = svy_math::undefinedValue();
}

void CMathAngle::setRad(double rad) { store(rad); }
void CMathAngle::setDeg(double deg) { store(deg * units::kDegToRad); }

void CMathAngle::setDMS(double d, double m, double s) {
  const double minutes = m / units::kArcMinutesPerDegree;
  const double seconds = s / units::kArcSecondsPerDegree;
  setDeg(d >= 0.0 ? d + minutes + seconds : d - minutes - seconds);
}

bool CMathAngle::setTg(double y, double x) {
  if (std::isnan(y) || std::isnan(x)) return false;
  store(withinZero(x) && withinZero(y) ? 0.0 : std::atan2(y, x));
  return true;
}

bool CMathAngle::setAz(const C2dPos& from, const C2dPos& to) {
  return setTg(to.east() - from.east(), to.north() - from.north());
}
bool CMathAngle::setAz(const C2dPos& dir) { return setTg(dir.east(), dir.north()); }
bool CMathAngle::setAz(double dN, double dE) { return setTg(dE, dN); }
bool CMathAngle::setAz(double n1, double e1, double n2, double e2) { return setTg(e2 - e1, n2 - n1); }

bool CMathAngle::setAngle(const C2dPos& p1, const C2dPos& vertex, const C2dPos& p3) {
  const C2dPos ray1 = p1 - vertex;
  const C2dPos ray3 = p3 - vertex;
  const auto hasDirection = [](const C2dPos& ray) {
    return !std::isnan(ray.north()) && !std::isnan(ray.east()) &&
           !(withinZero(ray.north()) && withinZero(ray.east()));
  };
  if (!hasDirection(ray1) || !hasDirection(ray3)) return false;
  store(std::atan2(ray3.east(), ray3.north()) - std::atan2(ray1.east(), ray1.north()));
  return true;
}

void CMathAngle::setChordAndR(double chord, double radius) {
  const double halfChord = chord / 2.0;
  store(2.0 * std::atan2(std::sqrt(radius * radius - halfChord * halfChord), halfChord));
}

bool CMathAngle::setBulge(double bulge) {
  if (!setTg(bulge, 1.0)) return false;
  *this *= 4.0;
  return true;
}

void CMathAngle::setComplimentary() {
  if (isNan()) return;
  m_rad = toRange(units::kHalfPi - m_rad, -units::kPi, units::kPi);
  const double s = m_sin;
  m_sin = m_cos;
  m_cos = s;
}

void CMathAngle::setSupplementary() {
  if (isNan()) return;
  m_rad = toRange(units::kPi - m_rad, -units::kPi, units::kPi);
  m_cos = -m_cos;
}

void CMathAngle::changeSign() {
  if (isNan()) return;
  m_rad = -m_rad;
  m_sin = -m_sin;
}

CMathAngle CMathAngle::operator+(const CMathAngle& other) const {
  CMathAngle r;
  if (isok()) r.store(m_rad + other.getRad());
  return r;
}

CMathAngle CMathAngle::operator-(const CMathAngle& other) const {
  CMathAngle r;
  if (isok()) r.store(m_rad - other.getRad());
  return r;
}

CMathAngle CMathAngle::operator*(double k) const {
  CMathAngle r;
  if (isok()) r.store(m_rad * k);
  return r;
}

CMathAngle CMathAngle::operator/(double k) const {
  CMathAngle r;
  if (isok() && !withinZero(k)) r.store(m_rad / k);
  return r;
}

CMathAngle& CMathAngle::operator+=(const CMathAngle& other) {
  if (isok()) store(m_rad + other.getRad());
  return *this;
}

CMathAngle& CMathAngle::operator-=(const CMathAngle& other) {
  if (isok()) store(m_rad - other.getRad());
  return *this;
}

CMathAngle& CMathAngle::operator*=(double k) {
  if (isok()) store(m_rad * k);
  return *this;
}

CMathAngle& CMathAngle::operator/=(double k) {
  if (!isok()) return *this;
  if (withinZero(k)) {
    reset();
  } else {
    store(m_rad / k);
  }
  return *this;
}
