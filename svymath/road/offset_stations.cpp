#include "svymath/road/offset_stations.h"

#include <algorithm>
#include <cmath>
#include <utility>

#include "svymath/alignments/horz_alignment_base.h"
#include "svymath/alignments/horz_element_base.h"
#include "svymath/foundation/constants.h"

namespace svy_math {

bool StakeOutChainages(const CHorzAlntBase& alignment, double from, double to, double interval,
                       const std::vector<double>& extra, std::vector<double>& out) {
  if (!std::isfinite(from) || !std::isfinite(to) || !(to >= from) || !std::isfinite(interval) || !(interval > 0.0) ||
      (to - from) / interval > limits::kMaxChainageStations) {
    return false;
  }
  const auto inRun = [&](double c) { return c >= from - tol::kSnap && c <= to + tol::kSnap; };
  // (chainage, rank): a joint or extra chainage ranks before a station, a station before an end of the run.
  std::vector<std::pair<double, int>> chainages;
  const int count = alignment.getNumOfElements();
  for (int i = 0; i < count; ++i) {
    const auto* element = static_cast<const CHorzAlntElemBase*>(alignment.getElement(i));
    double start = 0.0, end = 0.0;
    if (element->getStartChainageInM(start) && inRun(start)) chainages.emplace_back(start, 0);
    if (element->getFinalChainageInM(end) && inRun(end)) chainages.emplace_back(end, 0);
  }
  for (double c : extra) {
    if (inRun(c)) chainages.emplace_back(c, 0);
  }
  chainages.emplace_back(from, 2);
  chainages.emplace_back(to, 2);
  for (double k = std::ceil(from / interval); k * interval < to; ++k) chainages.emplace_back(k * interval, 1);
  std::sort(chainages.begin(), chainages.end());
  std::vector<double> merged;
  std::vector<int> ranks;
  for (const auto& [c, rank] : chainages) {
    const double clamped = std::min(std::max(c, from), to);
    if (merged.empty() || clamped - merged.back() >= tol::kSnap) {
      merged.push_back(clamped);
      ranks.push_back(rank);
    } else if (rank < ranks.back()) {
      merged.back() = clamped;
      ranks.back() = rank;
    }
  }
  out.swap(merged);
  return true;
}

}  // namespace svy_math
