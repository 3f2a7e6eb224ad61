#pragma once
// Distribution of a misclosure: traverse adjustment by the compass (Bowditch) and transit rules, and the
// proportioning of a measured line between two known end points.
//
// Plan positions are (northing, easting); azimuths are radians clockwise from north; lengths are metres.
// The traverse is run relative to its start point, so that survey coordinates (N 5 000 000) keep their
// digits. Failures return false, leave the outputs as they were and are logged under "TProportioning";
// nothing throws.
#include <cstdint>

#include "svymath/foundation/class_new.h"
#include "svymath/foundation/export.h"
#include "svymath/foundation/positions.h"
#include "svyutils/svy_containers.h"

namespace svy_math {

// Source name of the proportioning error-log entries.
constexpr const char* kProportioningLogSource = "TProportioning";

enum ETraverseRule : std::int32_t {
  // Corrections in proportion to the distance travelled from the start (Bowditch): suited to traverses whose
  // angles and distances are measured to a like precision.
  eCompassRule = 0,
  // Northing corrections in proportion to the sum of |dN| travelled, easting corrections to the sum of
  // |dE|: suited to angles measured more precisely than distances. A traverse with no northing (easting)
  // extent at all takes the compass proportion for that component.
  eTransitRule = 1,
};

// One measured leg: its azimuth (radians clockwise from north) and horizontal distance (metres).
struct TTraverseLeg {
  double azimuth = 0.0;
  double distance = 0.0;
};

// The adjusted traverse and its misclosure.
struct TTraverseAdjustment {
  // Every traverse point after the start, adjusted; the last one is the known end point exactly.
  svy_vector<C2dPos> points;
  // The correction applied to each of those points (adjusted minus as measured), metres.
  svy_vector<C2dPos> corrections;
  // The measured end minus the known end (metres): northing, easting and their plan length.
  double misclosureNorth = 0.0;
  double misclosureEast = 0.0;
  double linearMisclosure = 0.0;
  // The sum of the leg distances (metres).
  double totalLength = 0.0;
  // The relative precision 1:N as N = total length / linear misclosure; +infinity for no misclosure.
  double precision = 0.0;
};

class SVYMATH_API TProportioning {
 public:
  SVY_CLASS_NEW_DELETE

  // Runs the legs from `start`, compares the end with the known `end` (the start again for a closed loop)
  // and distributes the misclosure by the rule. False for no legs, a leg that is not finite or has a
  // negative distance, no length at all, or a start or end that is not finite.
  static bool adjustTraverse(const C2dPos& start, const C2dPos& end, const svy_vector<TTraverseLeg>& legs,
                             ETraverseRule rule, TTraverseAdjustment& result);

  // The points of a line measured from its first to its last point, moved so that those ends fall on the
  // known start and end: each point takes the start's shift plus the change of shift from start to end in
  // proportion to its distance along the measured points, so both ends land exactly. False for fewer than
  // two points, a point that is not finite, or measured points of no length.
  static bool proportionLine(const C2dPos& knownStart, const C2dPos& knownEnd, const svy_vector<C2dPos>& measured,
                             svy_vector<C2dPos>& adjusted);
};

}  // namespace svy_math
