#pragma once
// Umbrella header: every public header of the library.
#include "svymath/version.h"
#include "svymath/foundation/constants.h"
#include "svymath/foundation/rtti.h"
