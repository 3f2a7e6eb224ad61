#pragma once
// A plane similarity transformation between two plane systems (for example local site coordinates and
// projected grid coordinates), in the library's axes (northing, easting):
//
//   to = shift + scale * R(rotation) * from,   R(t) (n, e) = (n cos t - e sin t, n sin t + e cos t),
//
// so that a positive rotation turns directions clockwise, as azimuths turn: a line of azimuth a in the
// `from` system has azimuth a + rotation in the `to` system. Rotation in radians, shift in metres of the
// `to` system, scale unitless (1 for a rigid transformation).
#include "svymath/foundation/export.h"
#include "svymath/foundation/positions.h"

namespace svy_math {

struct SVYMATH_API TSimilarity2d {
  double scale = 1.0;
  double rotation = 0.0;  // radians, clockwise
  C2dPos shift;           // (north, east), metres

  // The `to` position of a `from` position.
  C2dPos forward(const C2dPos& from) const;
  // The `from` position of a `to` position; false (out unchanged) when the scale is zero or not finite.
  bool inverse(const C2dPos& to, C2dPos& from) const;
};

}  // namespace svy_math
