#pragma once
// The lookup under every query by chainage: which element of an alignment holds a chainage.
//
// The rule is a walk from the last element to the first: element i is a candidate when its start chainage
// s <= c (for the first element, s - 1 mm <= c: a millimetre of tolerance before the alignment's start), and
// a candidate is taken when its length L is known and -1 mm <= c - s < L + 1 mm. The walk stops with no
// element at the first element whose start chainage is unknown. So a chainage exactly at a joint belongs to
// the later element, and one up to 1 mm past the end still belongs to the last.
//
// The index answers by the same rule with a binary search on the start chainages, in logarithmic time, as
// long as the start chainages are known and in increasing order (a chain re-anchored by its alignment);
// otherwise it walks. It holds copies of the start chainages and lengths, so it is rebuilt by the alignment
// after every change of its elements or their chaining; queries only read it.
#include <vector>

#include "svymath/foundation/export.h"

class CAlntBase;

class SVYMATH_API CAlntElementIndex {
 public:
  // Copies the start chainages and lengths of the alignment's elements.
  void rebuild(const CAlntBase& alignment);
  // The index of the element holding the chainage, or -1; `distance` (may be null) receives c - s, which
  // may be slightly negative on the first element or slightly beyond the length on the last.
  int find(const CAlntBase& alignment, double chainage, double* distance) const;

 private:
  // The walk itself, on the elements (for chains the binary search cannot serve).
  static int walk(const CAlntBase& alignment, double chainage, double* distance);

  std::vector<double> m_starts;
  std::vector<double> m_lengths;  // NaN where an element has no length
  // Largest end chainage s + L among the elements up to each index, to stop a search early.
  std::vector<double> m_maxEnds;
  bool m_searchable = true;
};
