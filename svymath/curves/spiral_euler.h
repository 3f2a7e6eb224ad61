#pragma once
// The clothoid (Euler spiral): curvature grows linearly with length, k(s) = s / (R*L). Positions come from
// the Fresnel integrals: with k = sqrt(|R|*L*pi), north = k*C(s/k), east = k*S(s/k) (east negated to the
// left).
#include "svymath/curves/spiral_base.h"

class SVYMATH_API CEulerSpiralTStoSC : public CCurveSpiralTStoSCBase {
 public:
  SVY_CLASS_NEW_DELETE

  CEulerSpiralTStoSC();

  AlntMathSpiralType getMathSpiralType() const override { return eMathSpiralEuler; }
  double GetAzimuth(double s) const override;
  double getLengthAtAzimuth(const CMathAngle& angle) const override;
  double getCurvatureAtLength(double s) const override;
  double getFinalNorthing() const override;
  double getFinalEasting() const override;
  bool getPosAtLength(double s, double& north, double& east) const override;
  bool setLenAndR(double L, double R, bool toTheRight) override;
  // Keeps a quirk of the hosts' stored data: the radius becomes K/L only for a zero length and 0 for every
  // other, so a clothoid defined this way has its spiral angle L^2/(2K) but all positions at the origin.
  bool setLenAndSpPrm(double L, double K) override;
  bool setLenAndTwoR(double L, double R1, double R2, bool toTheRight) override;
  CCurveSpiralTStoSCBase* clone() const override;

 private:
  void fillFinalPos() const;
};
