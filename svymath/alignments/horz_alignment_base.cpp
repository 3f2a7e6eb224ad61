#include "svymath/alignments/horz_alignment_base.h"

#include "svymath/alignments/horz_element_base.h"

SVY_RTTI_DEFINE(CHorzAlntBase, CAlntBase)

CHorzAlntBase::~CHorzAlntBase() = default;

// A horizontal alignment holds horizontal elements only, so its elements are CHorzAlntElemBase.
const CHorzAlntElemBase* CHorzAlntBase::getHe(int index) const {
  return static_cast<const CHorzAlntElemBase*>(getElement(index));
}

const CHorzAlntElemBase* CHorzAlntBase::getFirstHe() const { return getHe(0); }

const CHorzAlntElemBase* CHorzAlntBase::getLastHe() const { return getHe(getNumOfElements() - 1); }

void CHorzAlntBase::ForEachSegment(CGenericSegmentVisitor_const& visitor) const {
  CAlntAccessGuard guard(*this);
  for (int i = 0; i < getNumOfElements(); ++i) getHe(i)->ForEachSegment(visitor);
}
