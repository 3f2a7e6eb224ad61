#include "svymath/alignments/alignment_base.h"

// Boost marks one of its own headers, still included by Boost.Geometry and Boost.Thread, deprecated; the
// notice is about Boost's internal include, not about ours.
#ifndef BOOST_ALLOW_DEPRECATED_HEADERS
#define BOOST_ALLOW_DEPRECATED_HEADERS
#endif
#include <boost/thread/recursive_mutex.hpp>

SVY_RTTI_DEFINE(CAlntBase, CRttiBase)

class CAlntBase::CAccessLock {
 public:
  boost::recursive_mutex mutex;
};

CAlntBase::CAlntBase() : m_accessLock(new CAccessLock) {}

CAlntBase::~CAlntBase() = default;

CAlntBase::CAlntBase(const CAlntBase& /*other*/) : CRttiBase(), m_accessLock(new CAccessLock) {}

CAlntBase& CAlntBase::operator=(const CAlntBase& /*other*/) { return *this; }

void CAlntBase::lockAccess() const { m_accessLock->mutex.lock(); }

void CAlntBase::unlockAccess() const { m_accessLock->mutex.unlock(); }
