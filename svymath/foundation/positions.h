#pragma once
// Plan positions, coordinate records, extents and segments.
//
// Axis convention of the whole library: a plan position is (northing, easting), component 0 is N (grid north,
// up on the map), component 1 is E (grid east, right). Azimuths are radians clockwise from north,
// azimuth = atan2(dE, dN); the unit direction of azimuth a is (N = cos a, E = sin a). Offsets are positive
// to the right of the direction of travel.
#include <cmath>
#include <type_traits>

#include "svymath/foundation/abstract_point.h"
#include "svymath/foundation/export.h"

class CMathAngle;
class GeoCoord;

// A plan position: northing, easting. Default-constructed at (0, 0).
class C2dPos : public svy_math::TAbstractPoint2<double> {
 public:
  using Base2 = svy_math::TAbstractPoint2<double>;
  using Base2::operator=;

  C2dPos() : Base2(0.0, 0.0) {}
  C2dPos(double north, double east) : Base2(north, east) {}
  C2dPos(const svy_math::TAbstractPoint<double, 2>& p) : Base2(p) {}  // NOLINT: point arithmetic results

  double& north() { return m_comp[0]; }
  double north() const { return m_comp[0]; }
  double& east() { return m_comp[1]; }
  double east() const { return m_comp[1]; }
  // Whether northing and easting are both finite numbers.
  bool isFinite() const { return std::isfinite(m_comp[0]) && std::isfinite(m_comp[1]); }
};

static_assert(sizeof(C2dPos) == 2 * sizeof(double), "a position is two doubles");
static_assert(std::is_trivially_copyable<C2dPos>::value, "positions copy as bytes");

// A coordinate record: northing, easting, height, with a mask of the valid values (1 northing, 2 easting,
// 4 height). Plan distances taken from it ignore the height.
struct SVYMATH_API TCoords {
  enum : unsigned { kNorthValid = 1u, kEastValid = 2u, kHeightValid = 4u, kAllValid = 7u };

  double north = 0.0;
  double east = 0.0;
  double height = 0.0;
  unsigned mask = kAllValid;

  C2dPos pos() const { return C2dPos(north, east); }
  // Whether northing and easting are both finite numbers.
  bool hasFinitePlanPosition() const;
  // Rotates the plan position about the vertical axis through centre, clockwise on the map by angle
  // (the rotation of CMathAngle::getRotated); the height is kept.
  void rotateAroundZ(const CMathAngle& angle, const C2dPos& centre = C2dPos());
};

// A Cartesian coordinate (X, Y, Z in metres) of the geodesy functions.
class SVYMATH_API Coord : public svy_math::TAbstractPoint3<double> {
 public:
  using Base3 = svy_math::TAbstractPoint3<double>;

  Coord() : Base3(0.0, 0.0, 0.0) {}
  Coord(double x, double y, double z) : Base3(x, y, z) {}
  Coord(const svy_math::TAbstractPoint<double, 3>& p) : Base3(p) {}  // NOLINT: point arithmetic results

  // All three components take the scalar.
  Coord& operator=(double scalar) {
    Base3::operator=(scalar);
    return *this;
  }

  double& x() { return m_comp[0]; }
  double x() const { return m_comp[0]; }
  double& y() { return m_comp[1]; }
  double y() const { return m_comp[1]; }
  double& z() { return m_comp[2]; }
  double z() const { return m_comp[2]; }

  // Geodetic (latitude, longitude, ellipsoidal height) to Cartesian; defined with the geodesy functions.
  Coord& blh2xyz(const GeoCoord& geodetic);
  // Moves this position by a local (east, north, up) vector (metres) in the local-level frame at this
  // position (defined with the geodesy functions). False, unchanged, when a value is not finite.
  bool offsetCoord(const svy_math::TAbstractPoint3<double>& enu);
  // The (east, north, up) vector (metres) from this position to `other` in the local-level frame here.
  // False (enu unchanged) when a value is not finite.
  bool relatCoord(const Coord& other, svy_math::TAbstractPoint3<double>& enu) const;
};

static_assert(sizeof(Coord) == 3 * sizeof(double), "a Cartesian coordinate is three doubles");

// An axis-aligned plan extent. A default extent is empty; including a position or a computed extent makes
// it non-empty (a freshly computed extent carries empty == false).
struct SVYMATH_API C2dMinMax {
  double minNorth = 0.0;
  double minEast = 0.0;
  double maxNorth = 0.0;
  double maxEast = 0.0;
  bool empty = true;

  C2dMinMax() = default;
  // The extent of two corner positions, in any order.
  C2dMinMax(const C2dPos& a, const C2dPos& b);

  void include(const C2dPos& p);
  void include(const C2dMinMax& other);
  // Whether p lies inside the extent grown by margin on every side (never for an empty extent).
  bool contains(const C2dPos& p, double margin = 0.0) const;
  // Whether the two extents, each grown by margin, overlap (never when either is empty).
  bool intersects(const C2dMinMax& other, double margin = 0.0) const;
};

// A straight segment between two positions.
struct SVYMATH_API C2dSegment {
  C2dPos start;
  C2dPos end;

  C2dSegment() = default;
  C2dSegment(const C2dPos& from, const C2dPos& to) : start(from), end(to) {}

  // Distance from p to the segment: the perpendicular distance when p projects onto it (ends included),
  // else the distance to the nearer end (the end point when both are equally near). A segment shorter than
  // the zero tolerance gives the distance to its end point.
  double getDistance(const C2dPos& p) const;
};
