#include "svymath/area/area_search.h"

#include <cmath>

#include "svymath/foundation/angle_functions.h"
#include "svymath/foundation/constants.h"

namespace {
bool equalWithin(double a, double b, double tolerance) { return -tolerance < a - b && a - b < tolerance; }
}  // namespace

TSearch::TSearch(double highEnd, double lowEnd, bool isAngular) { vInitialize(highEnd, lowEnd, isAngular); }

TSearch::~TSearch() = default;

void TSearch::vInitialize(double highEnd, double lowEnd, bool isAngular) {
  high = highEnd;
  low = lowEnd;
  angular = isAngular;
  if (angular) {
    high = Normalize0ToLt2Pi(high);
    low = Normalize0ToLt2Pi(low);
    if (low > high) high += svy_math::units::kTwoPi;
  }
  invalidCount = 0;
  probeIndex = 0;
  probeAnchor = 0.0;
  probeStep = 0.0;
  failed = equalWithin(high, low, svy_math::tol::kZero);
  current = low + (high - low) * 0.5;
}

void TSearch::vCurrentIsToHigh() {
  high = current;
  invalidCount = 0;
  current = low + (current - low) * 0.5;
}

void TSearch::vCurrentIsToLow() {
  low = current;
  invalidCount = 0;
  current = current + (high - current) * 0.5;
}

void TSearch::vCurrentIsInvalid() {
  if (invalidCount == 0) {
    invalidCount = 1;
    probeIndex = 0;
    probeAnchor = current;
    probeStep = (high - low) * 0.25;
  }
  if (probeIndex >= 2 * invalidCount) {
    probeIndex = 0;
    invalidCount += 1;
    probeStep = (high - low) / std::ldexp(1.0, invalidCount + 1);
  }
  const int j = probeIndex;
  current = (j % 2 == 0) ? low + (j + 1) * probeStep : high - j * probeStep;
  probeIndex = j + 1;
}

bool TSearch::boHasFailed() const { return failed || equalWithin(high, low, svy_math::tol::kZero); }

bool TSearch::boHasConvergedOrFailed(const double& tolerance) const {
  return failed || equalWithin(high, low, tolerance);
}
