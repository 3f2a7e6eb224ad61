#pragma once
// The library's tolerances and unit factors, each named once with its unit and the reason for its value.
//
// Conventions of the whole library, stated once:
// - plan positions are (northing, easting): component 0 is N, component 1 is E;
// - azimuths are radians measured clockwise from north: azimuth = atan2(dE, dN);
//   the unit direction of azimuth a is (N = cos a, E = sin a);
// - offsets are positive to the right of the direction of travel; radii are positive turning right;
// - angles inside objects are radians; plain-number angle functions take decimal degrees unless their
//   name says Rad, Grad, Mil or a DMS form; grades are percent; lengths are metres.
#include <cstdint>
#include <cstring>

namespace svy_math {
namespace tol {

// Zero test for lengths, angles and determinants: strict on both sides (-kZero < x < kZero).
constexpr double kZero = 1e-12;
// An offset smaller than this (metres) is treated as lying on the element.
constexpr double kOffsetZero = 1e-05;
// Snap of a length or chainage to an element's end, and the tie-break between elements (metres).
constexpr double kSnap = 0.001;
// Geodetic latitude iteration (Cartesian to geodetic): stops when tan(latitude) changes by at most this.
// The iteration contracts by about e^2 per step near the surface, so the remaining error is ~1e-12 rad.
constexpr double kGeodeticIteration = 1e-10;
// A point closer than this to the polar axis (metres) is taken as on the axis: longitude 0, latitude +-90 deg.
constexpr double kPolarAxisDistance = 1e-10;
// Safety cap of the latitude iteration. Surface points converge in under 10 steps; points deep inside the
// earth near the equatorial plane (where the map's slope approaches 1) need up to a few million. Reaching
// the cap ends with NaN instead of looping.
constexpr int kGeodeticIterationCap = 100000000;

}  // namespace tol

namespace units {

constexpr double kPi = 3.14159265358979323846;
constexpr double kTwoPi = 6.283185307179586;
constexpr double kHalfPi = 1.5707963267948966;
// Degrees <-> radians, the exact double constants the angle functions multiply by.
constexpr double kDegToRad = 0.017453292519943295;
constexpr double kRadToDeg = 57.29577951308232;
// Time of day and GPS weeks.
constexpr double kSecondsPerDay = 86400.0;
constexpr double kSecondsPerHour = 3600.0;
constexpr double kSecondsPerMinute = 60.0;
constexpr double kMinutesPerDay = 1440.0;
constexpr double kHoursPerDay = 24.0;
constexpr int kDaysPerWeek = 7;

}  // namespace units

// An undefined value: a double with all bits set (a quiet NaN). Records use it for "not given".
inline double undefinedValue() {
  const std::uint64_t allBits = ~std::uint64_t{0};
  double value;
  std::memcpy(&value, &allBits, sizeof value);
  return value;
}
inline bool isUndefined(double x) { return x != x; }

}  // namespace svy_math
