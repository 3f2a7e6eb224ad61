#include "svymath/adjustment/fit_quality.h"

#include "svymath/foundation/constants.h"

namespace svy_math {

namespace {

// Lower (exclusive) rms bounds in metres of the classes 9 down to 2.
constexpr double kRmsClassBounds[] = {200.0, 10.0, 5.0, 1.0, 0.5, 0.1, 0.05, 0.01};
constexpr signed char kWorstClass = 9;
constexpr signed char kBestClass = 1;

int undefinedCount(const TAbstractPoint3<double>& p) {
  return (isUndefined(p[0]) ? 1 : 0) + (isUndefined(p[1]) ? 1 : 0) + (isUndefined(p[2]) ? 1 : 0);
}

}  // namespace

signed char RmsToKnown(double rms) {
  if (isUndefined(rms)) return kWorstClass;
  signed char grade = kWorstClass;
  for (double bound : kRmsClassBounds) {
    if (rms > bound) return grade;
    --grade;
  }
  return kBestClass;
}

DefTriad::DefTriad() : TAbstractPoint3<double>(undefinedValue()) {}

bool DefTriad::IsUndef(const TAbstractPoint3<double>& p) { return undefinedCount(p) == 3; }

bool DefTriad::IsPartialUndef(const TAbstractPoint3<double>& p) {
  const int count = undefinedCount(p);
  return count > 0 && count < 3;
}

}  // namespace svy_math
