#pragma once
// An angle in radians, reduced to [-pi, pi] on every store (both ends possible), with its sine and cosine
// computed at most once per stored value.
//
// Azimuths are measured clockwise from north: azimuth = atan2(dE, dN), unit direction (N = cos, E = sin).
// A positive rotation turns clockwise on the map. NaN in the radians means "unset"; every value query reads
// an unset angle as 0.
//
// The caches are filled inside const queries, so one angle object must not be read by two threads at once.
#include "svymath/foundation/class_new.h"
#include "svymath/foundation/export.h"
#include "svymath/foundation/positions.h"

// The quadrant of a direction: whether its northing, respectively easting, component is positive.
struct TQuadrant {
  bool northward = true;
  bool eastward = true;
};

class SVYMATH_API CMathAngle {
 public:
  SVY_CLASS_NEW_DELETE

  // Zero, caches unknown.
  CMathAngle();
  // Decimal degrees (this is setDeg; svy_math::TAngle(double) takes radians instead).
  explicit CMathAngle(double degrees);

  // ---- value queries (unset reads as 0) ----
  double getRad() const { return m_rad == m_rad ? m_rad : 0.0; }
  double getDeg() const;
  // [0, 2pi] and [0, 360], both ends included.
  double get0To2PI() const;
  double get0To360() const;
  double getSin() const {
    if (m_sin != m_sin) fillCaches();
    return m_sin;
  }
  double getCos() const {
    if (m_cos != m_cos) fillCaches();
    return m_cos;
  }
  // Tangent and cotangent; 0 (not infinity) where the divisor is within the zero tolerance.
  double getTg() const;
  double getCtg() const;
  // Degrees, minutes, seconds of the angle reduced to [0, 360) in magnitude; the sign rides on the degrees
  // alone, so it is lost between -1 and 0 degrees.
  void getDMS(int& d, int& m, double& s) const;

  // Unit direction vector (N = cos, E = sin).
  void getDir(C2dPos& dir) const;
  C2dPos getDir() const;
  // The point dist along the direction from (n0, e0).
  void getPosAlong(double dist, double n0, double e0, double& n, double& e) const;
  void getPosAlong(double dist, const C2dPos& from, C2dPos& to) const;
  // The point dist across the direction from (n0, e0), positive to the right.
  void getPosAcross(double dist, double n0, double e0, double& n, double& e) const;
  void getPosAcross(double dist, const C2dPos& from, C2dPos& to) const;

  // Rotation clockwise on the map by this angle, and its inverse.
  double getRotatedNorth(double n, double e) const { return n * getCos() - e * getSin(); }
  double getRotatedEast(double n, double e) const { return e * getCos() + n * getSin(); }
  void getRotated(double& n, double& e) const;
  double getRotatedBackNorth(double n, double e) const { return n * getCos() + e * getSin(); }
  double getRotatedBackEast(double n, double e) const { return e * getCos() - n * getSin(); }
  void getRotatedBack(double& n, double& e) const;
  // p rotated about centre.
  void getRotatedPoint(const C2dPos& centre, const C2dPos& p, C2dPos& result) const;

  // From q = 1 + floor(2a/pi) with a in [0, 2pi]; an angle that reduces to exactly 2pi gives (false, false).
  TQuadrant getQuadrant() const;

  // Equality with wrap-around: |a - b| reduced across 2pi strictly within tol.
  bool isEqual(const CMathAngle& other, double tol) const;
  // Stored radians within 1e-12, without wrap-around (pi and -pi differ here).
  bool operator==(const CMathAngle& other) const;
  bool operator!=(const CMathAngle& other) const { return !(*this == other); }
  bool operator<(const CMathAngle& other) const { return getRad() < other.getRad(); }
  bool operator<=(const CMathAngle& other) const { return getRad() <= other.getRad(); }
  bool operator>(const CMathAngle& other) const { return getRad() > other.getRad(); }
  bool operator>=(const CMathAngle& other) const { return getRad() >= other.getRad(); }

  // Whether p1 moved |p2 - p1| along this direction lands on p2 within 1e-12 per component.
  bool isSameAsAzimuth(const C2dPos& p1, const C2dPos& p2) const;
  // -pi/2 < angle < pi/2.
  bool isSharp() const;
  bool isNan() const { return m_rad != m_rad; }
  bool isok() const { return m_rad == m_rad; }

  // ---- setters: store reduced to [-pi, pi] and clear the caches ----
  void reset();
  void setRad(double rad);
  void setDeg(double deg);
  // The sign is taken from the degrees alone: d - m/60 - s/3600 when d < 0.
  void setDMS(double d, double m, double s);
  // atan2(y, x); 0 when both are within the zero tolerance; false (angle unchanged) when either is NaN.
  bool setTg(double y, double x);
  // Azimuth from one position to another, of a direction vector, of (dN, dE), of (N1, E1) to (N2, E2).
  bool setAz(const C2dPos& from, const C2dPos& to);
  bool setAz(const C2dPos& dir);
  bool setAz(double dN, double dE);
  bool setAz(double n1, double e1, double n2, double e2);
  // The angle from the ray vertex->p1 to the ray vertex->p3 (clockwise positive); false when either ray
  // has no direction.
  bool setAngle(const C2dPos& p1, const C2dPos& vertex, const C2dPos& p3);
  // 2 atan2(sqrt(R^2 - (c/2)^2), c/2): twice the angle between a chord c and the radius R at either of its
  // ends, which is pi minus the angle the chord subtends at the centre. Unset when the chord exceeds the
  // diameter.
  void setChordAndR(double chord, double radius);
  // The included angle of a polyline bulge: 4 atan(b), reduced. False only when b is NaN.
  bool setBulge(double bulge);
  // Azimuth between two geodetic positions (latitudes and longitudes in radians) on the reference
  // ellipsoid; defined with the geodesy functions. False when the positions give no direction.
  bool setAzFromLatLon(double lat1, double lon1, double lat2, double lon2);

  // pi/2 - angle; the caches are swapped.
  void setComplimentary();
  void set90MinusThis() { setComplimentary(); }
  // pi - angle, reduced; the sine is kept and a known cosine negated.
  void setSupplementary();
  void set180MinusThis() { setSupplementary(); }
  // -angle; the sine is negated and the cosine kept.
  void changeSign();

  void copy(const CMathAngle& other) { *this = other; }

  // ---- arithmetic, results reduced to [-pi, pi] ----
  // An unset right operand counts as 0; an unset left operand gives a zero result.
  CMathAngle operator+(const CMathAngle& other) const;
  CMathAngle operator-(const CMathAngle& other) const;
  // An unset angle gives zero; division by a divisor within the zero tolerance gives zero.
  CMathAngle operator*(double k) const;
  CMathAngle operator/(double k) const;
  // Leave an unset angle unchanged; /= by a divisor within the zero tolerance makes the angle unset.
  CMathAngle& operator+=(const CMathAngle& other);
  CMathAngle& operator-=(const CMathAngle& other);
  CMathAngle& operator*=(double k);
  CMathAngle& operator/=(double k);

 protected:
  void store(double rad);
  void fillCaches() const;

  double m_rad;
  mutable double m_sin;
  mutable double m_cos;
};

static_assert(sizeof(CMathAngle) == 3 * sizeof(double), "an angle is its radians, sine and cosine");
