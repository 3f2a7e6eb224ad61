#pragma once
// Internal to the alignment: an R-tree over the plan boxes of an alignment's elements, the candidate source
// of the point-to-chainage queries, with the buffers they reuse from point to point. The alignment uses it
// under its access lock only, which also guards the buffers.
// Boost marks one of its own headers, still included by Boost.Geometry and Boost.Thread, deprecated; the
// notice is about Boost's internal include, not about ours.
#ifndef BOOST_ALLOW_DEPRECATED_HEADERS
#define BOOST_ALLOW_DEPRECATED_HEADERS
#endif
#include <cstddef>
#include <limits>
#include <utility>
#include <vector>

#include <boost/geometry/geometries/box.hpp>
#include <boost/geometry/geometries/point.hpp>
#include <boost/geometry/index/rtree.hpp>

#include "svymath/foundation/positions.h"

namespace svy_math {
namespace detail {

using TIndexPoint = boost::geometry::model::point<double, 2, boost::geometry::cs::cartesian>;
using TIndexBox = boost::geometry::model::box<TIndexPoint>;
using TIndexEntry = std::pair<TIndexBox, int>;

// What a search over some of the elements saw, for deciding whether elements left out could have changed
// its answer: the smallest distance value any element offered (|offset|, or the distance to a joint), and
// the largest best value held after that minimum was taken.
struct TAlntSearchTrace {
  double minValue = std::numeric_limits<double>::infinity();
  double maxSinceMin = -std::numeric_limits<double>::infinity();

  void onAccepted(double value) {
    if (value < minValue) {
      minValue = value;
      maxSinceMin = value;
    } else if (value > maxSinceMin) {
      maxSinceMin = value;
    }
  }
};

// What one element answered for the current point (its distance bound and its foot), kept so that a search
// repeated over a wider square does not project the element again. Valid while its stamp is the index's.
struct TAlntElementAnswer {
  unsigned distanceStamp = 0;
  bool distanceOk = false;
  double distance = 0.0;
  unsigned footStamp = 0;
  bool footOk = false;
  double along = 0.0;
  double offset = 0.0;
};

class CAlntSearchIndex {
 public:
  // Box i belongs to element i; an empty box (an element without a defined shape) makes its element a
  // candidate of every search. Boxes are grown by tol::kSearchIndexMargin.
  explicit CAlntSearchIndex(const std::vector<C2dMinMax>& boxes);

  std::size_t size() const { return m_count; }
  // Distance from the point to the nearest grown box (0 inside one; infinity when there is none).
  double nearestDistance(const C2dPos& p) const;
  // The elements whose grown boxes meet the square of half-side `radius` about p, with those of undefined
  // shape, in ascending order (valid until the next call).
  const std::vector<int>& collect(const C2dPos& p, double radius) const;
  // Forgets the elements' answers to the previous point.
  void beginPoint() const;
  TAlntElementAnswer& answer(int element) const { return m_answers[static_cast<std::size_t>(element)]; }
  unsigned stamp() const { return m_stamp; }

 private:
  boost::geometry::index::rtree<TIndexEntry, boost::geometry::index::rstar<16>> m_tree;
  std::vector<int> m_always;
  std::size_t m_count;
  mutable std::vector<TIndexEntry> m_hits;
  mutable std::vector<int> m_candidates;
  mutable std::vector<TAlntElementAnswer> m_answers;
  mutable unsigned m_stamp;
};

}  // namespace detail
}  // namespace svy_math
