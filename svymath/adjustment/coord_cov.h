#pragma once
// The covariance of a 3-D coordinate (square metres): three variances, then the three covariances.
// In a topocentric (local-level) frame the components are (north, east, up), the order of TCoords; in the
// geocentric frame they are the Cartesian (X, Y, Z) of Coord.
#include "svymath/foundation/class_new.h"
#include "svymath/foundation/export.h"

class SVYMATH_API TCoordCov {
 public:
  SVY_CLASS_NEW_DELETE

  // The zero covariance.
  TCoordCov() = default;
  TCoordCov(double var1, double var2, double var3, double cov12, double cov13, double cov23)
      : s11(var1), s22(var2), s33(var3), s12(cov12), s13(cov13), s23(cov23) {}

  // Element (row, col), 0-based, of the full symmetric matrix.
  double element(int row, int col) const;

  // The inverse (the weight matrix) by cofactors. Returns false, out unchanged, when |determinant| < 1e-40.
  bool getInverse(TCoordCov& out) const;
  // The covariance of the components scaled by f1, f2, f3: element (i, j) times fi * fj.
  void scale(double f1, double f2, double f3);
  // The covariance of m * x for the rotation (or any linear map) m given row by row: m * C * m^T.
  void transformToAnotherCS(const double (*m)[3]);
  // From geocentric (X, Y, Z) to the local (north, east, up) frame at geodetic latitude and longitude
  // (radians), and back. The two are inverse rotations of each other.
  void geocentric2topocentric(double latitude, double longitude);
  void topocentric2geocentric(double latitude, double longitude);

  double s11 = 0.0;
  double s22 = 0.0;
  double s33 = 0.0;
  double s12 = 0.0;
  double s13 = 0.0;
  double s23 = 0.0;
};
