#pragma once
// Internal to the alignment: an R-tree over the plan boxes of an alignment's elements, the candidate source
// of the batch point-to-chainage query, and the scratch buffers that query reuses from point to point.
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

// Buffers of the batch query, kept from one point to the next.
struct TAlntSearchScratch {
  std::vector<TIndexEntry> hits;
  std::vector<int> candidates;
};

class CAlntSearchIndex {
 public:
  // Box i belongs to element i; an empty box (an element without a defined shape) makes its element a
  // candidate of every search. Boxes are grown by tol::kSearchIndexMargin.
  explicit CAlntSearchIndex(const std::vector<C2dMinMax>& boxes);

  std::size_t size() const { return m_count; }
  // Distance from the point to the nearest grown box (0 inside one; infinity when there is none).
  double nearestDistance(const C2dPos& p, TAlntSearchScratch& scratch) const;
  // The elements whose grown boxes meet the square of half-side `radius` about p, with those of undefined
  // shape, in ascending order.
  void collect(const C2dPos& p, double radius, TAlntSearchScratch& scratch) const;

 private:
  boost::geometry::index::rtree<TIndexEntry, boost::geometry::index::rstar<16>> m_tree;
  std::vector<int> m_always;
  std::size_t m_count;
};

}  // namespace detail
}  // namespace svy_math
