#include "svymath/alignments/alnt_v_element_index.h"

#include <algorithm>
#include <cmath>

#include "svymath/alignments/alignment_base.h"
#include "svymath/alignments/alignment_element_base.h"
#include "svymath/foundation/constants.h"

using svy_math::tol::kSnap;

namespace {

// Whether element i, with start s and length L, is taken for the chainage (the rule's test).
bool takes(int index, double start, double length, double chainage, double& distance) {
  const bool candidate = start <= chainage || (index == 0 && start - kSnap <= chainage);
  if (!candidate || length != length) return false;
  distance = chainage - start;
  return distance >= -kSnap && distance < length + kSnap;
}

}  // namespace

void CAlntElementIndex::rebuild(const CAlntBase& alignment) {
  const int count = alignment.getNumOfElements();
  m_starts.assign(static_cast<std::size_t>(count), 0.0);
  m_lengths.assign(static_cast<std::size_t>(count), svy_math::undefinedValue());
  m_maxEnds.assign(static_cast<std::size_t>(count), -HUGE_VAL);
  m_searchable = true;
  double maxEnd = -HUGE_VAL;
  for (int i = 0; i < count; ++i) {
    const CAlntElBase* element = alignment.getElement(i);
    double start = 0.0;
    double length = 0.0;
    if (element == nullptr || !element->getStartChainageInM(start) || !std::isfinite(start) ||
        (i > 0 && start < m_starts[i - 1])) {
      m_searchable = false;
      return;
    }
    m_starts[i] = start;
    if (element->getHLengthInM(length)) {
      m_lengths[i] = length;
      if (start + length > maxEnd) maxEnd = start + length;
    }
    m_maxEnds[i] = maxEnd;
  }
}

int CAlntElementIndex::walk(const CAlntBase& alignment, double chainage, double* distance) {
  for (int i = alignment.getNumOfElements() - 1; i >= 0; --i) {
    const CAlntElBase* element = alignment.getElement(i);
    double start = 0.0;
    if (element == nullptr || !element->getStartChainageInM(start)) return -1;
    double length = svy_math::undefinedValue();
    element->getHLengthInM(length);
    double d = 0.0;
    if (takes(i, start, length, chainage, d)) {
      if (distance != nullptr) *distance = d;
      return i;
    }
  }
  return -1;
}

int CAlntElementIndex::find(const CAlntBase& alignment, double chainage, double* distance) const {
  const int count = static_cast<int>(m_starts.size());
  if (!m_searchable || count != alignment.getNumOfElements()) return walk(alignment, chainage, distance);
  if (count == 0) return -1;
  // The last candidate of the walk: the last start <= c (or the first element, within its tolerance).
  int i = static_cast<int>(std::upper_bound(m_starts.begin(), m_starts.end(), chainage) - m_starts.begin()) - 1;
  if (i < 0) i = 0;
  // Walk down from there; no element before i can be taken once every end lies a snap behind c.
  for (; i >= 0 && !(m_maxEnds[i] + 2.0 * kSnap <= chainage); --i) {
    double d = 0.0;
    if (takes(i, m_starts[i], m_lengths[i], chainage, d)) {
      if (distance != nullptr) *distance = d;
      return i;
    }
  }
  return -1;
}
