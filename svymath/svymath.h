#pragma once
// Umbrella header: every public header of the library.
#include "svymath/version.h"
#include "svymath/foundation/constants.h"
#include "svymath/foundation/rtti.h"
#include "svymath/foundation/abstract_point.h"
#include "svymath/foundation/positions.h"
#include "svymath/foundation/line_coeffs.h"
#include "svymath/foundation/math_angle.h"
#include "svymath/foundation/tangle.h"
#include "svymath/foundation/angle_functions.h"
#include "svymath/foundation/arc.h"
#include "svymath/foundation/unit_conversions.h"
