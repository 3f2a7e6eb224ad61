#pragma once
// The chainages of a stake-out run along a horizontal alignment: the ends of the run, every multiple of the
// interval between them, every element joint (the transition points) and any extra chainages in the run, in
// order, chainages closer than the end snap (tol::kSnap, 1 mm) kept once (the joint or extra one first).
#include <cstddef>
#include <vector>

#include "svymath/foundation/export.h"

class CHorzAlntBase;

namespace svy_math {

// False (out untouched) for a run that is empty or not finite, an interval that is not positive and finite,
// or more than limits::kMaxChainageStations stations.
SVYMATH_API bool StakeOutChainages(const CHorzAlntBase& alignment, double from, double to, double interval,
                                   const std::vector<double>& extra, std::vector<double>& out);

}  // namespace svy_math
