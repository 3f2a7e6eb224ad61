#include <cmath>
#include <cstddef>

#include "svymath/adjustment/best_fit.h"
#include "svymath/foundation/constants.h"

namespace svy_math {

TBestFitLineData::TBestFitLineData(const svy_list<C2dPos>& points) {
  for (const C2dPos& p : points) m_points.add(p);
}

TLsqMatrix TBestFitLineData::getAMatrix() const {
  TLsqMatrix a(static_cast<std::size_t>(m_points.count()), 2);
  std::size_t row = 0;
  for (const C2dPos& p : m_points.points()) {
    a(row, 0) = p.east();
    a(row, 1) = 1.0;
    ++row;
  }
  return a;
}

TLsqMatrix TBestFitLineData::getYMatrix() const {
  TLsqMatrix y(static_cast<std::size_t>(m_points.count()), 1);
  std::size_t row = 0;
  for (const C2dPos& p : m_points.points()) y(row++, 0) = p.north();
  return y;
}

TLsqMatrix TBestFitLineData::getWeightMatrix() const { return detail::unitWeightMatrix(m_points.count()); }

double TBestFitLineData::getRms(const svy_vector<double>& solution) const {
  if (m_points.count() == 0 || solution.size() != 2) return undefinedValue();
  double sum = 0.0;
  for (const C2dPos& p : m_points.points()) {
    const double residual = p.north() - (solution[0] * p.east() + solution[1]);
    sum += residual * residual;
  }
  return std::sqrt(sum / m_points.count());
}

}  // namespace svy_math
