#pragma once
// Azimuths as quadrant bearings: the acute angle from north or south toward east or west,
// "N 45°30'15\" E" for the azimuth 45.504167 degrees, "S 12°05'00\" W" for 192.083333 degrees.
#include "svymath/foundation/export.h"
#include "svyutils/svy_string.h"

namespace svy_formats {

// azimuthDeg: decimal degrees clockwise from north, any value (reduced to [0, 360)). The bearing angle is
// rounded on its total seconds to secondDecimals decimals (negative counts as 0, more than 6 as 6), so no
// field reaches 60; minutes and whole seconds have two digits. Azimuths in [0, 90] read from N toward E,
// (90, 180] from S toward E, (180, 270) from S toward W and [270, 360) from N toward W. A non-finite
// azimuth gives an empty text.
SVYMATH_API svy_text::CSvyString DegreeToBearing(double azimuthDeg, int secondDecimals);

}  // namespace svy_formats
