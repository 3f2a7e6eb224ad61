#pragma once
// Plane localization (site calibration): the similarity transformation (scale, rotation, two shifts; see
// similarity_2d.h) that best carries control points known in a `from` system onto the same points known in
// a `to` system, by least squares, or the rigid one (scale fixed at 1).
//
// The normal equations are formed about the centroids of both point sets, where they separate: with
// centred coordinates (n, e) -> (N, E) and S = sum(n^2 + e^2), the similarity has
//   scale cos(rotation) = sum(n N + e E) / S,   scale sin(rotation) = sum(n E - e N) / S,
// and the shift carries the `from` centroid onto the `to` centroid. The rigid fit takes the same rotation
// with scale 1. Survey coordinates (N 5 000 000) therefore keep their digits.
//
// Quality: each point's residual (to minus the transformed from), the root mean square of the residual
// lengths, and the standard error of unit weight sigma0 = sqrt(sum |v|^2 / (2 m - u)) with u = 4
// (similarity) or 3 (rigid) unknowns. A point is flagged when its residual, divided by its own standard
// deviation from the other points' sigma0 (the externally studentized residual), exceeds 3: for a good
// point that happens with 1.1% chance (chi-square of two degrees of freedom). Flags need a redundancy of at
// least 3 (three points for a rigid fit, four for a similarity).
#include <cstdint>

#include "svymath/cogo/similarity_2d.h"
#include "svymath/foundation/class_new.h"
#include "svymath/foundation/export.h"
#include "svymath/foundation/positions.h"
#include "svymath/foundation/rtti.h"
#include "svyutils/svy_containers.h"

enum ELocalizationStatus : std::int32_t {
  eLocOk = 0,
  // Fewer than two control points.
  eLocTooFewPoints = 1,
  // The control points coincide in the `from` or in the `to` system: no rotation or scale follows.
  eLocCoincident = 2,
  // No fit has been computed since the last change of the control points.
  eLocNotSolved = 3,
};

// One control point's residual in the `to` system (metres): to minus the transformed from.
struct SVYMATH_API TLocalizationResidual {
  double dNorth = 0.0;
  double dEast = 0.0;
  double length = 0.0;  // hypot(dNorth, dEast)
  bool outlier = false;
};

class SVYMATH_API CLocalizationOn2dPlane : public virtual CRttiBase {
  SVY_RTTI_DECLARE(CLocalizationOn2dPlane)

 public:
  SVY_CLASS_NEW_DELETE

  CLocalizationOn2dPlane() = default;
  ~CLocalizationOn2dPlane() override;

  // Adds a control point known in both systems; false (nothing added) when a value is not finite.
  bool addPoint(const C2dPos& from, const C2dPos& to);
  void reset();
  int count() const { return static_cast<int>(m_from.size()); }

  // Fits the transformation to the control points: a similarity, or with rigid a rotation and shifts only.
  ELocalizationStatus solve(bool rigid = false);
  ELocalizationStatus status() const { return m_status; }

  // The fitted transformation (identity before a successful solve).
  const svy_math::TSimilarity2d& transformation() const { return m_transform; }
  // Root mean square of the residual lengths (metres).
  double getRms() const { return m_rms; }
  // Standard error of unit weight (metres); NaN without redundancy.
  double getStandardError() const { return m_sigma0; }
  // The residual of control point i (0-based, in the order added); false when out of range or not solved.
  bool getResidual(int i, TLocalizationResidual& out) const;

  // Applies the fitted transformation; false when there is none.
  bool toTarget(const C2dPos& from, C2dPos& to) const;
  bool toSource(const C2dPos& to, C2dPos& from) const;

 private:
  svy_vector<C2dPos> m_from;
  svy_vector<C2dPos> m_to;
  svy_vector<TLocalizationResidual> m_residuals;
  svy_math::TSimilarity2d m_transform;
  ELocalizationStatus m_status = eLocNotSolved;
  double m_rms = 0.0;
  double m_sigma0 = 0.0;
};
