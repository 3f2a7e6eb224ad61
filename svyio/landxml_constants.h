#pragma once
// Tolerances of the LandXML reader.
namespace svy_io {
namespace tol {

// Road design software writes coordinates and stations rounded to the millimetre; a written element start
// (or staStart) further than this (metres) from the one chained from its predecessor is reported.
constexpr double kJointMisfit = 0.001;
// A written start direction that differs from the predecessor's end direction by more than this (radians)
// is a kink and kept; less is rounding (a direction taken from millimetre coordinates of a 2 m element is
// off by up to 5e-4 rad) and the element is made tangent.
constexpr double kKinkAngle = 0.001;

}  // namespace tol
}  // namespace svy_io
