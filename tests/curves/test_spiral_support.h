#pragma once
// Shared helpers of the spiral tests: reading numeric CSV tables, an adaptive Simpson quadrature (the
// independent oracle for Fresnel integrals and spiral positions), and the position of a curve obtained by
// integrating its heading.
#include <cmath>
#include <fstream>
#include <functional>
#include <sstream>
#include <string>
#include <vector>

namespace spiral_test {

// Rows of numbers of a CSV file after its header line; any blank, comma, tab or CR separates fields.
inline std::vector<std::vector<double>> readNumericTable(const std::string& path, int headerLines = 1) {
  std::vector<std::vector<double>> rows;
  std::ifstream in(path);
  std::string line;
  for (int i = 0; i < headerLines && std::getline(in, line); ++i) {
  }
  while (std::getline(in, line)) {
    for (char& c : line) {
      if (c == ',' || c == '\t' || c == '\r') c = ' ';
    }
    std::istringstream fields(line);
    std::vector<double> row;
    double value = 0.0;
    while (fields >> value) row.push_back(value);
    if (!row.empty()) rows.push_back(row);
  }
  return rows;
}

namespace detail {

inline double simpsonStep(const std::function<double(double)>& f, double a, double b, double fa, double fm,
                          double fb, double whole, double tol, int depth) {
  const double m = 0.5 * (a + b);
  const double lm = 0.5 * (a + m);
  const double rm = 0.5 * (m + b);
  const double flm = f(lm);
  const double frm = f(rm);
  const double left = (m - a) / 6.0 * (fa + 4.0 * flm + fm);
  const double right = (b - m) / 6.0 * (fm + 4.0 * frm + fb);
  const double delta = left + right - whole;
  if (depth <= 0 || std::fabs(delta) <= 15.0 * tol) return left + right + delta / 15.0;
  return simpsonStep(f, a, m, fa, flm, fm, left, 0.5 * tol, depth - 1) +
         simpsonStep(f, m, b, fm, frm, fb, right, 0.5 * tol, depth - 1);
}

}  // namespace detail

// Integral of f over [a, b] by adaptive Simpson to the absolute tolerance tol. The interval is first cut
// into pieces so that oscillating integrands are sampled before the error test is trusted.
inline double integrate(const std::function<double(double)>& f, double a, double b, double tol,
                        int pieces = 64) {
  double sum = 0.0;
  const double h = (b - a) / pieces;
  for (int i = 0; i < pieces; ++i) {
    const double lo = a + i * h;
    const double hi = lo + h;
    const double flo = f(lo);
    const double fhi = f(hi);
    const double fm = f(0.5 * (lo + hi));
    const double whole = h / 6.0 * (flo + 4.0 * fm + fhi);
    sum += detail::simpsonStep(f, lo, hi, flo, fm, fhi, whole, tol / pieces, 40);
  }
  return sum;
}

// The point reached after length s from the origin heading north, for a heading (radians, clockwise from
// north) given as a function of length: (integral of cos, integral of sin).
inline void integrateHeading(const std::function<double(double)>& heading, double s, double tol, double& north,
                             double& east) {
  north = integrate([&](double u) { return std::cos(heading(u)); }, 0.0, s, tol, 16);
  east = integrate([&](double u) { return std::sin(heading(u)); }, 0.0, s, tol, 16);
}

}  // namespace spiral_test
