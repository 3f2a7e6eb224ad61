#pragma once
// The cut/fill slope of one side of a road cross-section. It starts at a hinge point (an offset and an
// elevation) and runs outward, away from the centre line, until it meets the ground at the catch point.
//
// Slopes are stored as run over rise (metres of offset per metre of height): a cut slope is positive (it
// rises outward from the hinge), a fill slope negative (it falls outward). A stored magnitude below the zero
// tolerance is a flat slope; NaN is no slope. Local offsets are measured outward from the hinge.
#include "svymath/foundation/class_new.h"
#include "svymath/foundation/export.h"
#include "svymath/road/cross_section.h"

class SVYMATH_API CRoadCrossSectionSlope {
 public:
  SVY_CLASS_NEW_DELETE

  // No cut and no fill slope; the hinge is the section's default hinge point until one is set.
  CRoadCrossSectionSlope(const CRoadCrossSection& section, bool rightSide);
  CRoadCrossSectionSlope(const CRoadCrossSection& section, bool rightSide, double cutRunRise, double fillRunRise);
  CRoadCrossSectionSlope(const CRoadCrossSectionSlope& other) = default;
  CRoadCrossSectionSlope& operator=(const CRoadCrossSectionSlope&) = delete;
  virtual ~CRoadCrossSectionSlope();

  virtual bool isRightSide() const { return m_rightSide; }
  virtual bool hasCut() const;
  virtual bool hasFill() const;
  virtual bool hasFlatCutSlope() const;
  virtual bool hasFlatFillSlope() const;
  // The stored run over rise (NaN without the slope).
  virtual double getCutSlopeRunRise() const { return m_cutRunRise; }
  virtual double getFillSlopeRunRise() const { return m_fillRunRise; }
  // Rise over run: the reciprocal of the stored value, 0 for a flat slope, NaN without one.
  virtual double getCutSlopeRiseRun() const;
  virtual double getFillSlopeRiseRun() const;

  // A rise over run inside the zero tolerance stores a flat slope, anything else its reciprocal.
  void setCutSlopeRiseRun(double riseRun);
  void setCutSlopeRunRise(double runRise) { m_cutRunRise = runRise; }
  void setFillSlopeRiseRun(double riseRun);
  void setFillSlopeRunRise(double runRise) { m_fillRunRise = runRise; }
  void clearCut();
  void clearFill();

  // An explicit hinge: (offset, elevation) in metres, or a point's offset and elevation (null resets).
  void setHingePoint(double offset, double elevation);
  void setHingePoint(const CRoadCrossSectPoint* point);
  void resetHingePoint() { m_explicitHinge = false; }
  // The outermost point of the section on this side (rightmost or leftmost), where a side slope starts
  // when no hinge is set; null for a section without points.
  const CRoadCrossSectPoint* getDefaultHingePoint() const;
  // The hinge's offset and elevation (explicit, else the default hinge point); false without either.
  bool getHingePoint(double& offset, double& elevation) const;
  bool getHingePointElevation(double& elevation) const;
  bool getHingePointOffset(double& offset) const;

  // Whether an offset lies on the slope: outward of the hinge, or within tol::kSnap inside it. False without
  // a hinge or without any slope on this side.
  bool isOffsetAtSlope(double offset) const;
  // Whether a catch point exists against level ground at an elevation. A flat cut (or fill) slope answers
  // true although getCatchPointOffset finds no catch point for it: earlier releases answered so and host
  // applications rely on it, so it is kept.
  bool isCatchPointAvailable(double groundElevation) const;
  // The catch point against level ground at an elevation: its offset from the centre line and, if asked,
  // the run over rise of the slope that reaches it (cut when the ground is at or above the hinge or there
  // is no usable fill slope, fill below it). False when the chosen slope does not reach the ground outward.
  bool getCatchPointOffset(double groundElevation, double& offset, double* runRise = nullptr) const;
  // The elevation of the cut (fill) slope at an offset; false without the hinge elevation or the slope.
  bool getHeightFromCutSlope(double offset, double& height) const;
  bool getHeightFromFillSlope(double offset, double& height) const;
  // The elevation at an offset of the slope that the ground there calls for: cut when it is the only slope
  // or the hinge is at or below the ground, fill when it is the only slope or the ground is below the hinge.
  bool getHeightFromSlopeAuto(double offset, double groundElevation, double& height, double* runRise = nullptr) const;

  const CRoadCrossSection& getSection() const { return m_section; }

 protected:
  // Centre-line offset to the local offset outward from the hinge, and back.
  double convertOffsetToLocal(double offset) const;
  double convertToClOffset(double local) const;

 private:
  // The hinge's elevation or offset: the explicit hinge's, else the default hinge point's.
  bool hingeValue(bool elevation, double& value) const;
  bool heightFromSlope(double offset, double runRise, double& height) const;
  bool catchOnSlope(double runRise, double groundElevation, double hingeElevation, double& offset,
                    double* runRiseOut) const;

  const CRoadCrossSection& m_section;
  bool m_rightSide;
  double m_cutRunRise;
  double m_fillRunRise;
  bool m_explicitHinge;
  double m_hingeElevation;
  double m_hingeOffset;
};
