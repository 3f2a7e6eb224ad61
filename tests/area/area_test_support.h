#pragma once
// Boundaries for the area tests and an independent oracle: the shoelace area of a fine polyline that follows
// every arc by its own angles (taken here with atan2, not through the library's arc helpers).
#include <cmath>
#include <vector>

#include "svymath/area/area_segment.h"

namespace svy_area_test {

constexpr double kPi = 3.14159265358979323846;

inline TCoords ne(double north, double east) {
  TCoords c;
  c.north = north;
  c.east = east;
  return c;
}

// A closed boundary of lines through the (north, east) vertices.
inline svy_list<AreaSegment> polygon(const std::vector<TCoords>& vertices) {
  svy_list<AreaSegment> list;
  for (std::size_t i = 0; i < vertices.size(); ++i) list.emplace_back(vertices[i], vertices[(i + 1) % vertices.size()]);
  return list;
}

// The boundary run backwards.
inline svy_list<AreaSegment> reversed(const svy_list<AreaSegment>& list) {
  svy_list<AreaSegment> out;
  for (auto it = list.rbegin(); it != list.rend(); ++it)
    out.push_back(it->boIsArc() ? AreaSegment(it->end, it->start, it->center, !it->counterClockwise)
                                : AreaSegment(it->end, it->start));
  return out;
}

// Shoelace area (absolute, square metres) of the boundary with each arc replaced by `steps` chords.
inline double polylineArea(const svy_list<AreaSegment>& list, int steps = 8000) {
  std::vector<std::pair<double, double>> pts;  // (north, east) relative to the first start
  const double n0 = list.front().start.north;
  const double e0 = list.front().start.east;
  for (const AreaSegment& s : list) {
    if (!s.boIsArc()) {
      pts.emplace_back(s.start.north - n0, s.start.east - e0);
      continue;
    }
    const double a0 = std::atan2(s.start.east - s.center.east, s.start.north - s.center.north);
    const double a1 = std::atan2(s.end.east - s.center.east, s.end.north - s.center.north);
    double cw = std::fmod(a1 - a0 + 4.0 * kPi, 2.0 * kPi);  // azimuths grow clockwise
    const double sweep = s.counterClockwise ? -(2.0 * kPi - cw) : cw;
    const double r = std::hypot(s.start.north - s.center.north, s.start.east - s.center.east);
    for (int k = 0; k < steps; ++k) {
      const double a = a0 + sweep * k / steps;
      pts.emplace_back(s.center.north - n0 + r * std::cos(a), s.center.east - e0 + r * std::sin(a));
    }
  }
  double sum = 0.0;
  for (std::size_t i = 0; i < pts.size(); ++i) {
    const auto& p = pts[i];
    const auto& q = pts[(i + 1) % pts.size()];
    sum += p.second * q.first - q.second * p.first;
  }
  return std::fabs(0.5 * sum);
}

}  // namespace svy_area_test
