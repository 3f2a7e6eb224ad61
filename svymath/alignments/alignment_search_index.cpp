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
    : m_tree(toEntries(boxes, m_always)), m_count(boxes.size()), m_answers(boxes.size()), m_stamp(0) {}

// Stamps run from 1; after the last one every answer is cleared and the stamps start again.
void CAlntSearchIndex::beginPoint() const {
  if (++m_stamp == 0) {
    for (TAlntElementAnswer& answer : m_answers) answer = TAlntElementAnswer();
    m_stamp = 1;
  }
}

double CAlntSearchIndex::nearestDistance(const C2dPos& p) const {
  const TIndexPoint point(p.north(), p.east());
  m_hits.clear();
  m_tree.query(bgi::nearest(point, 1), std::back_inserter(m_hits));
  return m_hits.empty() ? std::numeric_limits<double>::infinity() : boost::geometry::distance(point, m_hits.front().first);
}

const std::vector<int>& CAlntSearchIndex::collect(const C2dPos& p, double radius) const {
  m_hits.clear();
  m_candidates.clear();
  const TIndexBox square(TIndexPoint(p.north() - radius, p.east() - radius),
                         TIndexPoint(p.north() + radius, p.east() + radius));
  m_tree.query(bgi::intersects(square), std::back_inserter(m_hits));
  for (const TIndexEntry& hit : m_hits) m_candidates.push_back(hit.second);
  m_candidates.insert(m_candidates.end(), m_always.begin(), m_always.end());
  std::sort(m_candidates.begin(), m_candidates.end());
  return m_candidates;
}

}  // namespace detail
}  // namespace svy_math
