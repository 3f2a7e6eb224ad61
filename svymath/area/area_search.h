#pragma once
// A one-dimensional bracketing search (bisection) with probing of values that cannot be evaluated.
//
// The caller tries dGetCurrent() and answers: too high (the bracket's top moves there), too low (its bottom
// moves there), or invalid (no answer for that value). After an invalid answer the search probes other
// values spread over the bracket, ever finer: level 1 tries low + 1/4 and high - 1/4 of the bracket, level 2
// low + 1/8, high - 1/8, low + 3/8, high - 3/8, level k 2k values with a step of 1/2^(k+1). The level is
// nGetInvalidCount(); a valid answer resets it, and callers stop at a level cap.
#include <cstdint>

#include "svymath/foundation/export.h"

class SVYMATH_API TSearch {
 public:
  TSearch() = default;
  // Starts the search in [low, high]; see vInitialize.
  TSearch(double high, double low, bool angular);
  TSearch(const TSearch&) = default;
  TSearch& operator=(const TSearch&) = default;
  virtual ~TSearch();

  // Stores the bracket. An angular bracket (radians) has both ends brought into [0, 2 pi), and high raised
  // by 2 pi when low then exceeds it (the bracket runs across north). Fails at once when the ends agree
  // within 1e-12. The first value tried is the bracket's middle.
  void vInitialize(double high, double low, bool angular);

  double dGetCurrent() const { return current; }
  int nGetInvalidCount() const { return invalidCount; }

  // The value tried was too high: it becomes the top of the bracket; the next value halves the rest.
  void vCurrentIsToHigh();
  // The value tried was too low: it becomes the bottom of the bracket.
  void vCurrentIsToLow();
  // The value tried could not be evaluated: the next value is the next probe (see above).
  void vCurrentIsInvalid();

  // Whether the bracket was empty at the start, or has shrunk to 1e-12.
  bool boHasFailed() const;
  // Whether the bracket was empty at the start, or has shrunk to the tolerance.
  bool boHasConvergedOrFailed(const double& tolerance) const;

  double high = 0.0;
  double low = 0.0;
  double current = 0.0;
  double probeAnchor = 0.0;
  double probeStep = 0.0;
  std::int32_t invalidCount = 0;
  std::int32_t probeIndex = 0;
  bool failed = false;
  bool angular = false;
};
