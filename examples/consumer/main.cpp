// A host program using the installed library through its umbrella header. Exits 0 when every number is
// the known one, so the package test checks the library as well as the installation.
#include <svymath/svymath.h>

#include <cmath>
#include <cstdio>
#include <string>

int main() {
  // Inverse: plane points are passed easting first, then northing. From (N 0, E 0) to (N 3, E 4).
  double azimuth = 0.0;  // radians clockwise from north, in [0, 2 pi)
  double distance = 0.0;
  const bool inverseOk = Inverse2D(0.0, 0.0, 4.0, 3.0, azimuth, distance);

  // Radiation back along the same azimuth and distance lands on the second point.
  double east = 0.0;
  double north = 0.0;
  Radiate2D(0.0, 0.0, azimuth, distance, east, north);

  // Angles: CMathAngle(double) takes degrees and keeps radians; the packed DDD.MMSS form as text.
  const CMathAngle angle(azimuth * svy_math::units::kRadToDeg);
  const std::string dms = DDDMMSS2String(Deg2DDDMMSS(angle.getDeg(), 6, false), 2).ToNarrow();

  // Station text with a 1000 m interval, and back.
  const std::string station = StnToString(1234.567, 1000.0).ToNarrow();
  double chainage = 0.0;
  const int parsed = StnFromString(svy_text::CSvyString(station.c_str()), chainage, 1000.0);

  // Units: international and US survey feet differ by 2 ppm.
  const double usFeet = Meter2USFeet(1000.0);
  const double feet = Meter2IFeet(1000.0);

  // Curves: the tangent length of a 90 degree curve of radius 100 m.
  const double tangent = GetTangentFromDelta(90.0, 100.0);

  // GPS time: 2024-01-01 00:00:00 is Monday of GPS week 2295.
  int week = 0;
  double secondsOfWeek = 0.0;
  ymdhms_to_gps(2024, 1, 1, 0, 0, 0.0, &week, &secondsOfWeek);

  std::printf("svymath %s\n", SVYMATH_VERSION_STRING);
  std::printf("inverse: %.9f deg (%s), %.3f m; radiated back to N %.6f E %.6f\n", angle.getDeg(), dms.c_str(),
              distance, north, east);
  std::printf("station %s reads back as %.3f m\n", station.c_str(), chainage);
  std::printf("1000 m = %.4f ft = %.4f US survey ft; tangent %.3f m; GPS week %d, %.0f s\n", feet, usFeet, tangent,
              week, secondsOfWeek);

  const bool right = inverseOk && std::fabs(distance - 5.0) < 1e-12 && std::fabs(north - 3.0) < 1e-12 &&
                     std::fabs(east - 4.0) < 1e-12 && std::fabs(angle.getDeg() - 53.130102354155978) < 1e-12 &&
                     station == "1+234.57" && parsed == 1 && std::fabs(chainage - 1234.57) < 1e-9 &&
                     std::fabs(feet - 3280.8399) < 1e-4 && std::fabs(usFeet - 3280.8333) < 1e-4 &&
                     std::fabs(tangent - 100.0) < 1e-9 && week == 2295 && secondsOfWeek == 86400.0;
  return right ? 0 : 1;
}
