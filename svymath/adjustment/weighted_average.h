#pragma once
// The weighted average of repeated coordinates of one point, each weighted by the inverse of its
// covariance: x = (sum W_i)^-1 sum W_i x_i, W_i = C_i^-1. Only the components valid in a coordinate's mask
// take part, with the covariance of those components. The sums are kept relative to the first value of each
// component, so that survey coordinates (N 5 000 000) keep their digits.
#include "svymath/adjustment/coord_cov.h"
#include "svymath/foundation/class_new.h"
#include "svymath/foundation/export.h"
#include "svymath/foundation/positions.h"

class SVYMATH_API CWaCoords {
 public:
  SVY_CLASS_NEW_DELETE

  CWaCoords();

  // Adds a coordinate (north, east, height) and its covariance in that order. Returns false, adding
  // nothing, when a valid component is not finite, the mask has no valid component, or the covariance of
  // the valid components is not positive definite.
  bool add(const TCoords& coords, const TCoordCov& cov);
  // The weighted average of the components that received weight; its mask tells which (the other fields
  // are left as they were). Returns false, out unchanged, when nothing was added.
  bool getResult(TCoords& out) const;
  // Forgets every coordinate added.
  void reset();
  int count() const { return m_count; }

 private:
  // Sum of the weight matrices, packed (1,1), (2,1), (2,2), (3,1), (3,2), (3,3).
  double m_weight[6];
  // Sum of W_i (x_i - origin).
  double m_weightedSum[3];
  double m_origin[3];
  unsigned m_originSet;
  int m_count;
};
