#pragma once
// Any part of a transition spiral as curve data: the part of the full spiral (CCurveDataSpiral1R) that
// begins at a start offset o along its law. A TS-to-SC part runs on the law from o to L (from the radius
// at o to the sharp radius), shifted and rotated so that it starts at the local origin along the local
// north axis; a CS-to-ST part runs from L back to o. With o = 0 it is the full spiral.
#include "svymath/curves/curve_data_spiral1r.h"

class SVYMATH_API CCurveDataSpiral : public CCurveDataSpiral1R {
 public:
  SVY_CLASS_NEW_DELETE

  explicit CCurveDataSpiral(AlntMathSpiralType type = eMathSpiralEuler);
  CCurveDataSpiral(const CCurveDataSpiral& other) = default;
  CCurveDataSpiral& operator=(const CCurveDataSpiral& other) = default;
  // A full spiral taken over as a part with offset 0.
  explicit CCurveDataSpiral(const CCurveDataSpiral1R& full);
  ~CCurveDataSpiral() override;

  void reset() override;
  void copy(const CCurveDataSpiral& other) { *this = other; }

  // The part between the radii R1 and R2 (either order; 0 or infinity for the tangent), L long, turning to
  // the given side; isTSSC: it runs towards the sharper radius. False when no such spiral exists.
  bool setLenAndTwoR(double L, double R1, double R2, bool toTheRight, bool isTSSC) override;
  bool setTurnRight(bool toTheRight) override;
  // Keeps the law and starts the part at law length offset, 0 <= offset < L. False (unchanged) otherwise.
  bool setStartOffset(double offset);
  double getStartOffset() const { return m_startOffset; }
  // A proper part of the law (start offset above zero).
  bool isCompoundSpiral() const;

  double getTotalLength() const override;
  double GetAzimuth(double s) const override;
  bool getPosAtLength(double s, double& north, double& east) const override;
  double getCurvatureAtLength(double s) const override;
  double getStepForDeviation(double s, double dev) const override;
  double getLengthAtAzimuth(const CMathAngle& angle) const override;

  // Signed radius at the start and at the end of the part (positive turning right); 0 at a tangent end.
  double getStartRadius() const;
  double getFinalRadius() const;

 protected:
  void onDefinitionChanged() override;
  void onSpiralRedefined() override { m_startOffset = 0.0; }

 private:
  // Signed radius (element's side) at law length s; 0 where the law is straight.
  double radiusAtLawLength(double s) const;

  CMathAngle m_rotation;     // rotation that turns the law's direction at o onto the local north axis
  double m_shiftNorth = 0.0;  // the full spiral's point at o (TS-to-SC parts)
  double m_shiftEast = 0.0;
  double m_startOffset = 0.0;  // o, law length where the part begins
};
