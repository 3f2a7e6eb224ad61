// Uses the installed library through its umbrella header: the inverse of a 3-4-5 triangle, its station
// text and the library version. Exits 0 when the numbers are right.
#include <svymath/svymath.h>

#include <cmath>
#include <cstdio>

int main() {
  double azimuth = 0.0;
  double distance = 0.0;
  // Easting first, then northing: from (E 0, N 0) to (E 4, N 3).
  const bool ok = Inverse2D(0.0, 0.0, 4.0, 3.0, azimuth, distance);
  const double azimuthDeg = azimuth * svy_math::units::kRadToDeg;
  const std::string station = StnToString(1234.567, 1000.0).ToNarrow();
  std::printf("svymath %s: azimuth %.9f deg, distance %.3f m, station %s\n", SVYMATH_VERSION_STRING, azimuthDeg,
              distance, station.c_str());
  const bool right = ok && std::fabs(distance - 5.0) < 1e-12 && std::fabs(azimuthDeg - 53.130102354) < 1e-9 &&
                     station == "1+234.57";
  return right ? 0 : 1;
}
