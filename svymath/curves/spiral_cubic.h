#pragma once
// The cubic parabola: east = a*x^3 with x the local northing, read by arc length. Length and x are
// converted by truncated series (five terms of the integral of sqrt(1 + 9a^2x^4) and of its reversion),
// so the law is meant for the flat branch, where the normalised length sqrt|a|*s stays at or below
// 0.3936 (the point where the radius-to-length ratio R/L is smallest, 1.4416). The coefficient a carries
// the side: negative to the left.
#include "svymath/curves/spiral_base.h"

class SVYMATH_API CCubicSpiralTStoSC : public CCurveSpiralTStoSCBase {
 public:
  SVY_CLASS_NEW_DELETE

  CCubicSpiralTStoSC();

  void reset() override;
  AlntMathSpiralType getMathSpiralType() const override { return eMathSpiralCubic; }
  double GetAzimuth(double s) const override;
  // Keeps the hosts' law: x = sqrt(0.5*tan(angle)/a), although the direction at x has tangent 3*a*x^2.
  double getLengthAtAzimuth(const CMathAngle& angle) const override;
  double getCurvatureAtLength(double s) const override;
  double getFinalNorthing() const override { return m_finalNorth; }
  double getFinalEasting() const override { return m_finalEast; }
  bool getPosAtLength(double s, double& north, double& east) const override;
  // False when L <= 0 or |R| < 1.4416*L (the parabola cannot turn so sharply within L), or when the search
  // for the normalised length does not reach a ratio error of 1e-6.
  bool setLenAndR(double L, double R, bool toTheRight) override;
  bool setLenAndSpPrm(double L, double K) override;
  // The radii may come in either order; false when they are equal or the sharper one is too small.
  bool setLenAndTwoR(double L, double R1, double R2, bool toTheRight) override;
  bool copy(const CCurveSpiralTStoSCBase* other) override;
  CCurveSpiralTStoSCBase* clone() const override;

  double getCubicCoefficient() const { return m_a; }
  // Arc length from the TS to local northing x, and its inverse (series, one-entry cache).
  double getLengthByX(double x) const;
  double getXByLength(double s) const;
  // Radius at arc length s of the parabola east = a*x^3; 0 when |x| or |a| is below the zero tolerance.
  static double calcRByL(double a, double s);

 private:
  // Stores length, signed radius and coefficient, then the end point and spiral angle that follow.
  void storeSpiral(double L, double R, double a);

  double m_a = 0.0;                // cubic coefficient, 1/m^2, signed with the side
  mutable double m_cacheLen;       // last length converted (NaN when empty)
  mutable double m_cacheX;         // its local northing
};
