#pragma once
// The signs used in number and angle texts. The library writes and reads numbers the same way on every
// host (decimal point '.', no grouping when writing), so these are fixed, not taken from the host's locale.
#include "svymath/foundation/export.h"
#include "svyutils/svy_string.h"

namespace svy_formats {

// "."
SVYMATH_API svy_text::CSvyString DecimalSignString();
// "," (for display only: the library's own number texts have no grouping)
SVYMATH_API svy_text::CSvyString ThousandSignString();
// The degree sign U+00B0, as in the DMS texts.
SVYMATH_API svy_text::CSvyString DegreeSignString();

}  // namespace svy_formats
