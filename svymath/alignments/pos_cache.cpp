#include "svymath/alignments/pos_cache.h"

#include <algorithm>
#include <cmath>
#include <cstring>

#include "svymath/alignments/alnt_pair.h"
#include "svymath/alignments/alnt_v.h"
#include "svymath/alignments/horz_alignment_base.h"
#include "svymath/alignments/horz_element_base.h"
#include "svymath/alignments/pos_cache_log.h"
#include "svymath/alignments/vertical_element_base.h"
#include "svymath/foundation/constants.h"
#include "svymath/foundation/math_angle.h"
#include "svyutils/svy_err_log.h"

SVY_RTTI_DEFINE(CAlntPosCacheBase, CRttiBase)
SVY_RTTI_DEFINE(CAlnt2dPosCache, CAlntPosCacheBase)
SVY_RTTI_DEFINE(CAlntHtPosCache, CAlntPosCacheBase)
SVY_RTTI_DEFINE(CAlnt3dPosCache, CAlntPosCacheBase)

namespace {

using svy_math::tol::kZero;

// A multiplicative hash over the bit patterns of the values, a word at a time: equal geometry gives an equal
// fingerprint, and any change of a value changes it but for a 2^-64 chance.
constexpr std::uint64_t kFingerprintSeed = 14695981039346656037ull;
constexpr std::uint64_t kFingerprintPrime = 1099511628211ull;

void mix(std::uint64_t& hash, double value) {
  std::uint64_t bits = 0;
  std::memcpy(&bits, &value, sizeof bits);
  hash = (hash ^ bits) * kFingerprintPrime;
  hash ^= hash >> 29;
}

TAlntCachePos undefinedPos(double chainage, bool atJoint) {
  const double nan = svy_math::undefinedValue();
  return TAlntCachePos{chainage, nan, nan, nan, atJoint};
}

bool fail(int line) {
  svy_logging::svy_err_log(svy_math::kAlntCacheLogSource, line, "");
  return false;
}

// Samples one element of `length` metres starting at `startChainage`: its start (unless the previous element
// ended at the same chainage), one position per chord step, and its end. step(s) is the element's chord step
// for the deviation at length s (capped at the rest of the element); eval(s, position) fills the coordinates.
template <class Step, class Eval>
bool sampleElement(double startChainage, double length, Step step, Eval eval, std::vector<TAlntCachePos>& out) {
  if (!std::isfinite(startChainage) || !std::isfinite(length) || length < 0.0) return fail(__LINE__);
  double s = 0.0;
  const bool joinsPrevious = !out.empty() && out.back().chainage == startChainage;
  while (true) {
    const bool atEnd = s == length;
    if (s > 0.0 || !joinsPrevious) {
      if (static_cast<double>(out.size()) >= svy_math::limits::kMaxCachePositions) return fail(__LINE__);
      TAlntCachePos position = undefinedPos(startChainage + s, s == 0.0 || atEnd);
      if (!eval(s, position)) return fail(__LINE__);
      out.push_back(position);
    }
    if (atEnd) return true;
    const double advance = step(s);
    if (!(advance > 0.0)) return fail(__LINE__);
    // The last step is capped at the rest of the element; rounding may leave a sliver, which joins it.
    s = length - s - advance < kZero ? length : s + advance;
  }
}

bool sampleHorizontal(const CHorzAlntBase& alignment, double deviation, std::vector<TAlntCachePos>& out) {
  for (int i = 0; i < alignment.getNumOfElements(); ++i) {
    const auto* element = static_cast<const CHorzAlntElemBase*>(alignment.getElement(i));
    double start = 0.0, length = 0.0;
    if (!element->getStartChainageInM(start) || !element->getHLengthInM(length)) return fail(__LINE__);
    const auto step = [&](double s) { return element->getStepForDeviation(s, deviation); };
    const auto eval = [&](double s, TAlntCachePos& p) { return element->getPosNeAtLength(s, p.north, p.east); };
    if (!sampleElement(start, length, step, eval, out)) return false;
  }
  return !out.empty();
}

bool sampleProfile(const CVertAlntBase& profile, double deviation, std::vector<TAlntCachePos>& out) {
  for (int i = 0; i < profile.getNumOfElements(); ++i) {
    const CAlntVe* element = profile.getVe(i);
    double start = 0.0, length = 0.0;
    if (!element->getStartChainageInM(start) || !element->getHLengthInM(length)) return fail(__LINE__);
    const auto step = [&](double s) { return element->getStepForDeviation(s, deviation); };
    const auto eval = [&](double s, TAlntCachePos& p) { return element->getHtAtLen(s, p.height) == eVeHtOk; };
    if (!sampleElement(start, length, step, eval, out)) return false;
  }
  return !out.empty();
}

// An element's shape follows from its kind, start, start direction, length and end curvatures (a spiral's law
// is linear in curvature between them): these are cheap to read, where a spiral's end position is not.
void mixHorizontal(const CHorzAlntBase& alignment, std::uint64_t& hash) {
  mix(hash, alignment.getNumOfElements());
  mix(hash, alignment.getStartChainageInM());
  mix(hash, alignment.getStartPosN());
  mix(hash, alignment.getStartPosE());
  for (int i = 0; i < alignment.getNumOfElements(); ++i) {
    const auto* element = static_cast<const CHorzAlntElemBase*>(alignment.getElement(i));
    double start = 0.0, length = 0.0, north = 0.0, east = 0.0, k0 = 0.0, k1 = 0.0;
    CMathAngle azimuth;
    const bool known = element->getStartChainageInM(start) && element->getHLengthInM(length) &&
                       element->getStartPosNe(north, east) && element->getStartAzimut(azimuth) &&
                       element->getCurvatureAtLength(0.0, k0) && element->getCurvatureAtLength(length, k1);
    for (double value : {static_cast<double>(element->getType()), known ? 1.0 : 0.0, start, length, north, east,
                         azimuth.getRad(), k0, k1}) {
      mix(hash, value);
    }
  }
}

void mixProfile(const CVertAlntBase& profile, std::uint64_t& hash) {
  mix(hash, profile.getNumOfElements());
  mix(hash, profile.getStartChainageInM());
  mix(hash, profile.getStartPosH());
  for (int i = 0; i < profile.getNumOfElements(); ++i) {
    const CAlntVe* element = profile.getVe(i);
    double start = 0.0, length = 0.0;
    const bool known = element->getStartChainageInM(start) && element->getHLengthInM(length);
    for (double value : {static_cast<double>(element->getType()), known ? 1.0 : 0.0, start, length,
                         element->getStartHt(), element->getFinalHt(), element->getStartGrade(),
                         element->getEndGrade()}) {
      mix(hash, value);
    }
  }
}

bool byChainage(const TAlntCachePos& a, const TAlntCachePos& b) { return a.chainage < b.chainage; }

}  // namespace

// ---- CAlntPosCacheBase ----

CAlntPosCacheBase::CAlntPosCacheBase(double deviation)
    : m_deviation(deviation), m_fingerprint(0), m_built(false), m_ok(false) {}

CAlntPosCacheBase::~CAlntPosCacheBase() = default;

void CAlntPosCacheBase::setDeviation(double deviation) {
  m_deviation = deviation;
  m_built = false;
}

bool CAlntPosCacheBase::isCurrent() const { return m_built && m_fingerprint == doFingerprint(); }

bool CAlntPosCacheBase::update() {
  const std::uint64_t fingerprint = doFingerprint();
  if (m_built && fingerprint == m_fingerprint) return m_ok;
  m_positions.clear();
  m_ok = std::isfinite(m_deviation) && m_deviation >= svy_math::tol::kMinCacheDeviation && doSample(m_positions);
  if (!m_ok) m_positions.clear();
  m_fingerprint = fingerprint;
  m_built = true;
  return m_ok;
}

const std::vector<TAlntCachePos>& CAlntPosCacheBase::getPositions() {
  update();
  return m_positions;
}

bool CAlntPosCacheBase::interpolate(double chainage, TAlntCachePos& position) {
  // An alignment's final chainage (start plus the summed lengths) may differ from its last element's end by
  // rounding: chainages within the end snap of the sampled range are taken at its ends.
  using svy_math::tol::kSnap;
  if (!update() || !(chainage >= m_positions.front().chainage - kSnap && chainage <= m_positions.back().chainage + kSnap)) {
    return false;
  }
  chainage = std::min(std::max(chainage, m_positions.front().chainage), m_positions.back().chainage);
  const auto after = std::upper_bound(m_positions.begin(), m_positions.end(), undefinedPos(chainage, false),
                                      byChainage);
  if (after == m_positions.end()) {
    position = m_positions.back();
    return true;
  }
  const TAlntCachePos& a = *(after - 1);
  const TAlntCachePos& b = *after;
  // Along the chord, relative to its start (survey coordinates keep their digits).
  const double t = (chainage - a.chainage) / (b.chainage - a.chainage);
  position = TAlntCachePos{chainage, a.north + t * (b.north - a.north), a.east + t * (b.east - a.east),
                           a.height + t * (b.height - a.height), t == 0.0 && a.atJoint};
  return true;
}

// ---- CAlnt2dPosCache ----

CAlnt2dPosCache::CAlnt2dPosCache(const CHorzAlntBase& alignment, double deviation)
    : CAlntPosCacheBase(deviation), m_alignment(&alignment) {}

bool CAlnt2dPosCache::getPosNeAtChain(double chainage, double& north, double& east) {
  TAlntCachePos position{};
  if (!interpolate(chainage, position)) return false;
  north = position.north;
  east = position.east;
  return true;
}

bool CAlnt2dPosCache::doSample(std::vector<TAlntCachePos>& positions) const {
  const CAlntAccessGuard guard(*m_alignment);
  return sampleHorizontal(*m_alignment, getDeviation(), positions);
}

std::uint64_t CAlnt2dPosCache::doFingerprint() const {
  const CAlntAccessGuard guard(*m_alignment);
  std::uint64_t hash = kFingerprintSeed;
  mixHorizontal(*m_alignment, hash);
  return hash;
}

// ---- CAlntHtPosCache ----

CAlntHtPosCache::CAlntHtPosCache(const CVertAlntBase& profile, double deviation)
    : CAlntPosCacheBase(deviation), m_profile(&profile) {}

bool CAlntHtPosCache::getHeightAtChain(double chainage, double& height) {
  TAlntCachePos position{};
  if (!interpolate(chainage, position)) return false;
  height = position.height;
  return true;
}

bool CAlntHtPosCache::doSample(std::vector<TAlntCachePos>& positions) const {
  const CAlntAccessGuard guard(*m_profile);
  return sampleProfile(*m_profile, getDeviation(), positions);
}

std::uint64_t CAlntHtPosCache::doFingerprint() const {
  const CAlntAccessGuard guard(*m_profile);
  std::uint64_t hash = kFingerprintSeed;
  mixProfile(*m_profile, hash);
  return hash;
}

// ---- CAlnt3dPosCache ----

CAlnt3dPosCache::CAlnt3dPosCache(const CHorzAndVertAlntBase& pair, double deviation)
    : CAlntPosCacheBase(deviation), m_pair(&pair) {}

bool CAlnt3dPosCache::getPosAtChain(double chainage, double& north, double& east, double& height) {
  TAlntCachePos position{};
  if (!interpolate(chainage, position)) return false;
  north = position.north;
  east = position.east;
  height = position.height;
  return true;
}

bool CAlnt3dPosCache::doSample(std::vector<TAlntCachePos>& positions) const {
  const CHorzAlntBase& horizontal = m_pair->getHorzAlnt();
  const CVertAlntBase& profile = m_pair->getVertAlnt();
  const CAlntAccessGuard guardH(horizontal);
  const CAlntAccessGuard guardV(profile);
  std::vector<TAlntCachePos> plan, heights;
  double end = 0.0;
  if (!sampleHorizontal(horizontal, getDeviation(), plan) || !sampleProfile(profile, getDeviation(), heights) ||
      !m_pair->getFinalChainageInM(end)) {
    return false;
  }
  // Both samplings over the range both cover; each missing coordinate from the other alignment.
  const double start = std::max(plan.front().chainage, heights.front().chainage);
  std::vector<TAlntCachePos> merged(plan.size() + heights.size());
  std::merge(plan.begin(), plan.end(), heights.begin(), heights.end(), merged.begin(), byChainage);
  for (const TAlntCachePos& sample : merged) {
    // The end as the pair reports it may differ from its last element's end by rounding.
    if (sample.chainage < start || sample.chainage > end + svy_math::tol::kSnap) continue;
    if (!positions.empty() && positions.back().chainage == sample.chainage) {
      positions.back().atJoint = positions.back().atJoint || sample.atJoint;
      continue;
    }
    TAlntCachePos position = sample;
    if (std::isnan(position.north) && !horizontal.getPosNeAtChain(position.chainage, position.north, position.east)) {
      return fail(__LINE__);
    }
    if (std::isnan(position.height) && !profile.getHeightAtChain(position.chainage, position.height)) {
      return fail(__LINE__);
    }
    positions.push_back(position);
  }
  return positions.size() >= 2;
}

std::uint64_t CAlnt3dPosCache::doFingerprint() const {
  const CAlntAccessGuard guardH(m_pair->getHorzAlnt());
  const CAlntAccessGuard guardV(m_pair->getVertAlnt());
  std::uint64_t hash = kFingerprintSeed;
  mixHorizontal(m_pair->getHorzAlnt(), hash);
  mixProfile(m_pair->getVertAlnt(), hash);
  return hash;
}
