#include "svymath/alignments/alignment_search_index.h"

#include <algorithm>
#include <cmath>
#include <iterator>

#include <boost/geometry.hpp>

#include "svymath/foundation/constants.h"

namespace svy_math {
namespace detail {

namespace bgi = boost::geometry::index;

namespace {

std::vector<TIndexEntry> toEntries(const std::vector<C2dMinMax>& boxes, std::vector<int>& always) {
  const double margin = tol::kSearchIndexMargin;
  std::vector<TIndexEntry> entries;
  entries.reserve(boxes.size());
  for (std::size_t i = 0; i < boxes.size(); ++i) {
    const C2dMinMax& b = boxes[i];
    const bool finite = std::isfinite(b.minNorth) && std::isfinite(b.minEast) && std::isfinite(b.maxNorth) &&
                        std::isfinite(b.maxEast);
    if (b.empty || !finite) {
      always.push_back(static_cast<int>(i));
      continue;
    }
    entries.emplace_back(TIndexBox(TIndexPoint(b.minNorth - margin, b.minEast - margin),
                                   TIndexPoint(b.maxNorth + margin, b.maxEast + margin)),
                         static_cast<int>(i));
  }
  return entries;
}

}  // namespace

// The packing constructor bulk-loads the tree (sort-tile-recursive), which also gives better queries than
// inserting one box after another.
CAlntSearchIndex::CAlntSearchIndex(const std::vector<C2dMinMax>& boxes)
    : m_tree(toEntries(boxes, m_always)), m_count(boxes.size()) {}

double CAlntSearchIndex::nearestDistance(const C2dPos& p, TAlntSearchScratch& scratch) const {
  const TIndexPoint point(p.north(), p.east());
  scratch.hits.clear();
  m_tree.query(bgi::nearest(point, 1), std::back_inserter(scratch.hits));
  return scratch.hits.empty() ? std::numeric_limits<double>::infinity()
                              : boost::geometry::distance(point, scratch.hits.front().first);
}

void CAlntSearchIndex::collect(const C2dPos& p, double radius, TAlntSearchScratch& scratch) const {
  scratch.hits.clear();
  scratch.candidates.clear();
  const TIndexBox square(TIndexPoint(p.north() - radius, p.east() - radius),
                         TIndexPoint(p.north() + radius, p.east() + radius));
  m_tree.query(bgi::intersects(square), std::back_inserter(scratch.hits));
  for (const TIndexEntry& hit : scratch.hits) scratch.candidates.push_back(hit.second);
  scratch.candidates.insert(scratch.candidates.end(), m_always.begin(), m_always.end());
  std::sort(scratch.candidates.begin(), scratch.candidates.end());
}

}  // namespace detail
}  // namespace svy_math
