#pragma once
// The catch point of a side slope against sloping ground: where the cut or fill slope running outward from
// the hinge meets a ground profile across the section (a line, or a polyline of surveyed ground points).
//
// Offsets are metres from the centre line (positive right), elevations metres. The slope is chosen as
// CRoadCrossSectionSlope::getHeightFromSlopeAuto chooses it, from the ground elevation at the hinge's offset:
// cut when the ground there is at or above the hinge, fill when it is below.
#include "svymath/foundation/export.h"
#include "svymath/road/cross_section_slope.h"

// One point of a ground profile across a section.
struct TXsGroundPoint {
  double offset;
  double elevation;
};

// How the search for a catch point ended.
enum ECatchPointStatus {
  eCatchPointFound = 0,
  eCatchPointNoHinge,   // the slope has no hinge point
  eCatchPointNoSlope,   // no slope of the side suits the ground at the hinge
  eCatchPointNoGround,  // fewer than two ground points, points out of offset order or not numbers, or the
                        // ground does not reach the hinge's offset
  eCatchPointNotMet     // the chosen slope runs outward without meeting the ground
};

// The end of a slope after a horizontal run outward from the hinge (metres, not negative): its offset from
// the centre line and its elevation, with the run over rise given (0 for a flat slope). False without a
// hinge, for a negative run or for values that are not numbers.
SVYMATH_API bool ComputeXYOffsetsForCutFillSlope(const CRoadCrossSectionSlope& slope, double runRise, double run,
                                                 double& offset, double& elevation);

// The catch point of the slope against the ground polyline (points in increasing offset). With extendGround
// the outermost ground segments continue beyond the outermost points (two points then make a ground line);
// without it the ground ends there. The outputs, and the run over rise of the slope used if asked, are
// written only when the status is eCatchPointFound.
SVYMATH_API ECatchPointStatus ComputeCatchPoint(const CRoadCrossSectionSlope& slope, const TXsGroundPoint* ground,
                                                int count, bool extendGround, double& offset, double& elevation,
                                                double* runRise = nullptr);
