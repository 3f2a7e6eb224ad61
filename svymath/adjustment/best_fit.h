#pragma once
// Best-fit problems on 2-D points for the least-squares engine, all with unit weights.
//
//   line     p1 = m p2 + b (north as a function of east); unknowns (m, b); row of A (p2, 1), Y = p1.
//   curve    a circle; unknowns (u, v, r): centre east u, centre north v, radius r; at the current
//            solution, with d the distance from the centre to the point, row of A
//            (-(u - p2)/d, -(v - p1)/d, 1) and misclosure Y = d - r.
//   radius   a circle about a known centre (c1, c2); unknown r; row of A (-1), Y = distance - r.
//            The -1 is the opposite sign to the curve's radius column. The initial guess is the mean
//            distance, already the least-squares radius, so the first correction is zero and the fit
//            converges at once: the sign never acts.
//
// Survey coordinates (N 5 000 000, E 500 000) keep their accuracy: the line and every Gauss-Newton step are
// solved relative to the centroid (their constant column makes leastSquares centre them), the circle's
// rows use differences from the centre only and its initial guess is computed relative to the centroid. A
// line whose eastings differ only by the rounding of the coordinates is refused (eLsqSingular); a circle
// iterates until its corrections are within the rounding of its misclosures.
#include "svymath/adjustment/best_fit_points.h"
#include "svymath/adjustment/least_squares.h"
#include "svymath/foundation/export.h"
#include "svymath/foundation/positions.h"

namespace svy_math {

class SVYMATH_API TBestFitLineData : public TLeastSquaresData {
 public:
  TBestFitLineData() = default;
  explicit TBestFitLineData(const svy_list<C2dPos>& points);

  void addData(const C2dPos& p) { m_points.add(p); }
  void reset() { m_points.clear(); }
  int getDataCount() const { return m_points.count(); }

  TLsqMatrix getAMatrix() const override;
  TLsqMatrix getYMatrix() const override;
  TLsqMatrix getWeightMatrix() const override;

  // Root mean square of the residuals p1 - (m p2 + b) of the solution (m, b); NaN without points or with a
  // solution of another length.
  double getRms(const svy_vector<double>& solution) const;

 private:
  TBestFitPoints m_points;
};

class SVYMATH_API TBestFitCurveData : public TNonLinearLeastSquaresData {
 public:
  TBestFitCurveData() = default;
  explicit TBestFitCurveData(const svy_list<C2dPos>& points);

  void addData(const C2dPos& p) { m_points.add(p); }
  // Clears the points and the solution (the convergence criteria stay).
  void reset();
  int getDataCount() const { return m_points.count(); }

  // The algebraic (Kasa) circle: x^2 + y^2 + D x + E y + F = 0 fitted by linear least squares to the points
  // taken relative to their centroid and scaled to unit mean square radius, so that neither large
  // coordinates nor the scale of the circle cost digits. eLsqTooFewObservations for fewer than three points
  // (none included), eLsqNotFinite for a non-finite point, eLsqSingular when the points are collinear or
  // coincide.
  ELeastSquaresStatus computeInitialGuess() override;

  TLsqMatrix getAMatrix() const override;
  TLsqMatrix getYMatrix() const override;
  TLsqMatrix getWeightMatrix() const override;
  // A few units of the last place of the radius: the rounding of the distances d and of d - r.
  double getMisclosureRounding() const override;

 private:
  TBestFitPoints m_points;
};

class SVYMATH_API TBestFitRadiusData : public TNonLinearLeastSquaresData {
 public:
  TBestFitRadiusData() = default;
  TBestFitRadiusData(const svy_list<C2dPos>& points, const C2dPos& centre);

  void addData(const C2dPos& p) { m_points.add(p); }
  // Clears the points and the solution (the centre and the convergence criteria stay).
  void reset();
  int getDataCount() const { return m_points.count(); }
  void setCircleCenter(const C2dPos& centre);
  bool isCircleCenterSet() const { return m_centreSet; }

  // The mean distance from the centre; eLsqTooFewObservations without a centre or without points.
  ELeastSquaresStatus computeInitialGuess() override;

  TLsqMatrix getAMatrix() const override;
  TLsqMatrix getYMatrix() const override;
  TLsqMatrix getWeightMatrix() const override;

 private:
  TBestFitPoints m_points;
  C2dPos m_centre;
  bool m_centreSet = false;
};

}  // namespace svy_math
