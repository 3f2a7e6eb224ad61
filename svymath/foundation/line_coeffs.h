#pragma once
// A straight line in implicit form a*x + b*y + c = 0, filled by the planar line solvers.

struct CLineCoeffs {
  double a = 0.0;
  double b = 0.0;
  double c = 0.0;

  CLineCoeffs() = default;
  CLineCoeffs(double ca, double cb, double cc) : a(ca), b(cb), c(cc) {}
};
