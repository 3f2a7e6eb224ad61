#pragma once
// The 2-D points of a best-fit problem, in the order given. p1 is a point's first component (north) and p2
// its second (east).
#include <boost/numeric/ublas/matrix.hpp>

#include "svymath/foundation/positions.h"
#include "svyutils/svy_containers.h"

namespace svy_math {

class TBestFitPoints {
 public:
  void add(const C2dPos& p) {
    m_points.push_back(p);
    ++m_count;
  }
  void clear() {
    m_points.clear();
    m_count = 0;
  }
  const svy_list<C2dPos>& points() const { return m_points; }
  int count() const { return m_count; }

 private:
  svy_list<C2dPos> m_points;
  int m_count = 0;
};

namespace detail {

// The unit weight matrix of n observations.
inline boost::numeric::ublas::matrix<double> unitWeightMatrix(int n) {
  const std::size_t size = n > 0 ? static_cast<std::size_t>(n) : 0U;
  boost::numeric::ublas::matrix<double> w(size, size, 0.0);
  for (std::size_t i = 0; i < size; ++i) w(i, i) = 1.0;
  return w;
}

}  // namespace detail

}  // namespace svy_math
