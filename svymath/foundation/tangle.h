#pragma once
// svy_math::TAngle: the namespace twin of CMathAngle, with the same radians, caches and rules. Its one
// difference is deliberate: TAngle(double) takes radians, whereas CMathAngle(double) takes degrees.
#include "svymath/foundation/export.h"
#include "svymath/foundation/math_angle.h"

namespace svy_math {

class SVYMATH_API TAngle : public CMathAngle {
 public:
  // Zero.
  TAngle() = default;
  // Radians, stored reduced to [-pi, pi].
  explicit TAngle(double rad) { setRad(rad); }
  TAngle(const CMathAngle& angle) : CMathAngle(angle) {}  // NOLINT: results of the shared arithmetic

  // Radians, 0 when unset.
  double getDouble() const { return getRad(); }
  // (-pi, pi]: -pi is returned as pi.
  double getNegPIToPI() const;

  TAngle operator+(const CMathAngle& other) const { return CMathAngle::operator+(other); }
  TAngle operator-(const CMathAngle& other) const { return CMathAngle::operator-(other); }
  TAngle operator*(double k) const { return CMathAngle::operator*(k); }
  TAngle operator/(double k) const { return CMathAngle::operator/(k); }
  TAngle& operator+=(const CMathAngle& other) {
    CMathAngle::operator+=(other);
    return *this;
  }
  TAngle& operator-=(const CMathAngle& other) {
    CMathAngle::operator-=(other);
    return *this;
  }
  TAngle& operator*=(double k) {
    CMathAngle::operator*=(k);
    return *this;
  }
  TAngle& operator/=(double k) {
    CMathAngle::operator/=(k);
    return *this;
  }
};

// The angle without its sign.
SVYMATH_API TAngle absoluteAngle(const TAngle& angle);

}  // namespace svy_math
