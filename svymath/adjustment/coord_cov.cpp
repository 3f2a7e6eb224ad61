#include "svymath/adjustment/coord_cov.h"

#include <cmath>

#include "svymath/foundation/constants.h"

namespace {

using TRotation = double[3][3];

// Rows: the unit north, east and up vectors of the local frame at (latitude, longitude), in geocentric
// components. x_local = r * x_geocentric.
void localFrameRotation(double latitude, double longitude, TRotation& r) {
  const double sinLat = std::sin(latitude);
  const double cosLat = std::cos(latitude);
  const double sinLon = std::sin(longitude);
  const double cosLon = std::cos(longitude);
  const double rows[3][3] = {{-sinLat * cosLon, -sinLat * sinLon, cosLat},
                             {-sinLon, cosLon, 0.0},
                             {cosLat * cosLon, cosLat * sinLon, sinLat}};
  for (int i = 0; i < 3; ++i)
    for (int j = 0; j < 3; ++j) r[i][j] = rows[i][j];
}

void setFromFull(TCoordCov& c, const double full[3][3]) {
  c.s11 = full[0][0];
  c.s22 = full[1][1];
  c.s33 = full[2][2];
  c.s12 = full[1][0];
  c.s13 = full[2][0];
  c.s23 = full[2][1];
}

}  // namespace

double TCoordCov::element(int row, int col) const {
  if (row == col) return row == 0 ? s11 : (row == 1 ? s22 : s33);
  const int sum = row + col;  // 1: (0,1), 2: (0,2), 3: (1,2)
  return sum == 1 ? s12 : (sum == 2 ? s13 : s23);
}

bool TCoordCov::getInverse(TCoordCov& out) const {
  const double c11 = s22 * s33 - s23 * s23;
  const double c12 = s13 * s23 - s12 * s33;
  const double c13 = s12 * s23 - s13 * s22;
  const double det = s11 * c11 + s12 * c12 + s13 * c13;
  if (!(std::fabs(det) >= svy_math::tol::kCovDeterminantZero)) return false;
  const double inv = 1.0 / det;
  out = TCoordCov(c11 * inv, (s11 * s33 - s13 * s13) * inv, (s11 * s22 - s12 * s12) * inv, c12 * inv, c13 * inv,
                  (s12 * s13 - s11 * s23) * inv);
  return true;
}

void TCoordCov::scale(double f1, double f2, double f3) {
  s11 *= f1 * f1;
  s22 *= f2 * f2;
  s33 *= f3 * f3;
  s12 *= f1 * f2;
  s13 *= f1 * f3;
  s23 *= f2 * f3;
}

void TCoordCov::transformToAnotherCS(const double (*m)[3]) {
  double mc[3][3];
  for (int i = 0; i < 3; ++i)
    for (int j = 0; j < 3; ++j) mc[i][j] = m[i][0] * element(0, j) + m[i][1] * element(1, j) + m[i][2] * element(2, j);
  double result[3][3];
  for (int i = 0; i < 3; ++i)
    for (int j = 0; j < 3; ++j) result[i][j] = mc[i][0] * m[j][0] + mc[i][1] * m[j][1] + mc[i][2] * m[j][2];
  setFromFull(*this, result);
}

void TCoordCov::geocentric2topocentric(double latitude, double longitude) {
  TRotation r;
  localFrameRotation(latitude, longitude, r);
  transformToAnotherCS(r);
}

void TCoordCov::topocentric2geocentric(double latitude, double longitude) {
  TRotation r;
  localFrameRotation(latitude, longitude, r);
  TRotation transposed;
  for (int i = 0; i < 3; ++i)
    for (int j = 0; j < 3; ++j) transposed[i][j] = r[j][i];
  transformToAnotherCS(transposed);
}
