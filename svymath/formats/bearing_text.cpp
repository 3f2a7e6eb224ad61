#include "svymath/formats/bearing_text.h"

#include <algorithm>
#include <cmath>

#include "svymath/formats/angle_text.h"
#include "svymath/foundation/angle_functions.h"

namespace svy_formats {
namespace {

// Quadrant limits of azimuths (degrees).
constexpr double kQuarter = 90.0;
constexpr double kHalf = 180.0;
constexpr double kThreeQuarters = 270.0;
constexpr double kFull = 360.0;
// Seconds beyond micro-arcseconds carry nothing a bearing is used for.
constexpr int kMaxSecondDecimals = 6;

struct TQuadrantBearing {
  const wchar_t* from;
  double angle;
  const wchar_t* toward;
};

TQuadrantBearing quadrantBearing(double azimuth) {
  if (azimuth <= kQuarter) return {L"N", azimuth, L"E"};
  if (azimuth <= kHalf) return {L"S", kHalf - azimuth, L"E"};
  if (azimuth < kThreeQuarters) return {L"S", azimuth - kHalf, L"W"};
  return {L"N", kFull - azimuth, L"W"};
}

}  // namespace

svy_text::CSvyString DegreeToBearing(double azimuthDeg, int secondDecimals) {
  if (!std::isfinite(azimuthDeg)) return svy_text::CSvyString();
  const int decimals = std::clamp(secondDecimals, 0, kMaxSecondDecimals);
  const TQuadrantBearing bearing = quadrantBearing(pos360(azimuthDeg));
  svy_text::CSvyString text(bearing.from);
  text += L' ';
  text += DMSToString(bearing.angle, decimals);
  text += L' ';
  text += bearing.toward;
  return text;
}

}  // namespace svy_formats
