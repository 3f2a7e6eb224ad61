#include "svymath/geodesy/ellipsoid.h"

#include <cmath>

namespace svy_math {
namespace {

constexpr double kSemiMajorAxis = 6378137.0;
constexpr double kFirstEccentricity = 0.0818191913305;

TEllipsoidParams makeEllipsoid() {
  TEllipsoidParams p{};
  p.a = kSemiMajorAxis;
  p.e = kFirstEccentricity;
  p.e2 = p.e * p.e;
  p.ep2 = p.e2 / (1.0 - p.e2);
  p.onePlusEp2 = 1.0 + p.ep2;
  p.c = p.a / std::sqrt(1.0 - p.e2);
  return p;
}

}  // namespace

const TEllipsoidParams& ellipsoidParams() {
  // Initialised once, thread-safely, on the first call.
  static const TEllipsoidParams params = makeEllipsoid();
  return params;
}

}  // namespace svy_math
