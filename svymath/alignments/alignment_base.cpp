#include "svymath/alignments/alignment_base.h"

SVY_RTTI_DEFINE(CAlntBase, CRttiBase)

CAlntBase::CAlntBase() = default;

CAlntBase::~CAlntBase() = default;

CAlntBase::CAlntBase(const CAlntBase& /*other*/) : CRttiBase() {}

CAlntBase& CAlntBase::operator=(const CAlntBase& /*other*/) { return *this; }
