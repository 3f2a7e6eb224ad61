#pragma once
// Quality grading of a fit and 3-component values with undefined markers.
#include "svymath/foundation/abstract_point.h"
#include "svymath/foundation/export.h"

namespace svy_math {

// The quality class of a root-mean-square residual (metres): 9 above 200, 8 above 10, 7 above 5, 6 above 1,
// 5 above 0.5, 4 above 0.1, 3 above 0.05, 2 above 0.01, else 1 (each bound exclusive). A NaN rms is
// graded 9, the worst class, rather than passing every test.
SVYMATH_API signed char RmsToKnown(double rms);

// Three components, each possibly undefined (NaN). Default-constructed fully undefined.
class SVYMATH_API DefTriad : public TAbstractPoint3<double> {
 public:
  DefTriad();
  DefTriad(double c0, double c1, double c2) : TAbstractPoint3<double>(c0, c1, c2) {}
  DefTriad(const TAbstractPoint3<double>& p) : TAbstractPoint3<double>(p) {}  // NOLINT: same components

  // Whether all three components are undefined.
  bool IsUndef() const { return IsUndef(*this); }
  // Whether some, but not all, components are undefined.
  bool IsPartialUndef() const { return IsPartialUndef(*this); }
  static bool IsUndef(const TAbstractPoint3<double>& p);
  static bool IsPartialUndef(const TAbstractPoint3<double>& p);
};

}  // namespace svy_math
