#pragma once
// A straight tangent as curve data, in the local frame of its element (origin at the element's start,
// local north along the element's reference direction, local east its right-hand normal). The segment runs
// from the origin along its own azimuth relative to that frame, for its length.
//
// Defined either by setLen with one of the setAz forms, or by setFinalNE (the local end point, from which
// length and azimuth follow). Undefined values are NaN. The sine and cosine of the azimuth are cached inside
// const queries, so one record must not be read from two threads at once.
#include <cstdint>

#include "svymath/foundation/class_new.h"
#include "svymath/foundation/export.h"
#include "svymath/foundation/math_angle.h"

class SVYMATH_API CCurveDataSegment {
 public:
  SVY_CLASS_NEW_DELETE

  CCurveDataSegment();

  // The kind code of segment data (the alignment element code of a tangent).
  static int static_type();

  void reset();
  void copy(const CCurveDataSegment& other) { *this = other; }
  // Length with azimuth, or the end point, are known.
  bool isok() const;

  // Length >= 0; false (unchanged) for a negative or undefined length.
  bool setLen(double length);
  void setAz(const CMathAngle& azimuth);
  void setAzDeg(double degrees);
  void setAzRad(double radians);
  // The local end point; length and azimuth follow from it.
  void setFinalNE(double north, double east);

  double getTotalLength() const { return m_length; }
  // The segment's azimuth relative to the local frame (undefined when unset).
  CMathAngle getAzimuth() const;
  // Direction at any length, decimal degrees (0 when undefined).
  double GetAzimuth(double s) const;
  // (s cos a, s sin a); false (logged) for undefined data or s outside [0, length] beyond the snap.
  bool getPosAtLength(double s, double& north, double& east) const;
  double getCurvatureAtLength(double s) const;
  // The rest of the segment from s.
  double getStepForDeviation(double s, double deviation) const;
  // The point of the segment nearest to the local point: len its length, dist its distance, positive
  // when the point lies right of the segment. False for undefined data or a non-finite point.
  bool getShortestDistAndCurveLen(double north, double east, double& dist, double& len) const;

  double getFinalNorthing() const;
  double getFinalEasting() const;
  bool getFinalAzimut(CMathAngle& azimuth) const;
  double getFinalAzimutInRad() const;

  std::uint32_t getFlags() const { return m_flags; }
  void setFlags(std::uint32_t flags) { m_flags = flags; }
  std::uint32_t getAlntElementFlags() const { return m_flags; }

 private:
  // Clears the trigonometric cache and recomputes the end point when length and azimuth are known.
  void onDefinitionChanged();
  double cosAz() const;
  double sinAz() const;

  double m_finalNorth;
  double m_finalEast;
  double m_length;
  double m_azimuth;  // radians
  mutable double m_sin;
  mutable double m_cos;
  std::uint32_t m_flags = 0;
};
