#pragma once
// Position caches: an alignment (or a profile, or a pair) sampled once into a list of positions so that the
// chord between two neighbouring positions stays within a given deviation of the true curve, with a position
// at every element start and end. This is what draws an alignment on a screen or exports it as a polyline at a
// stated tolerance; positions between the samples are interpolated along the chords.
//
// Chainages, positions (northing, easting), heights and deviations are metres. The deviation is measured in
// plan for CAlnt2dPosCache, in height for CAlntHtPosCache; CAlnt3dPosCache takes the union of both samplings,
// so each of its chords keeps both (a sub-chord of a curve without a turning point deviates no more than the
// chord it splits).
//
// The cache reads the alignment it was given (the caller keeps it alive) and remembers a fingerprint of its
// geometry (element count, start, each element's chainages, length and end positions or heights). Every
// query compares it with the alignment and rebuilds the samples after an edit, so queries are not const: one
// cache serves one thread at a time. Queries return false, leaving outputs unchanged, when the alignment
// cannot be sampled (an element without length, a deviation that is not finite or below tol::kMinCacheDeviation,
// more than limits::kMaxCachePositions samples) or the chainage lies outside the sampled range.
#include <cstddef>
#include <cstdint>
#include <vector>

#include "svymath/foundation/class_new.h"
#include "svymath/foundation/export.h"
#include "svymath/foundation/rtti.h"

class CHorzAlntBase;
class CVertAlntBase;
class CHorzAndVertAlntBase;

// One sampled position. A 2-D cache leaves height NaN, a height cache north and east NaN.
struct SVYMATH_API TAlntCachePos {
  double chainage;  // metres
  double north;     // metres
  double east;      // metres
  double height;    // metres
  bool atJoint;     // an element start or end (a transition point)
};

// What the three caches share: the samples, the deviation, the fingerprint and the interpolation.
class SVYMATH_API CAlntPosCacheBase : public virtual CRttiBase {
  SVY_RTTI_DECLARE(CAlntPosCacheBase)

 public:
  SVY_CLASS_NEW_DELETE

  ~CAlntPosCacheBase() override;

  double getDeviation() const { return m_deviation; }
  // A new deviation (metres) takes effect at the next query.
  void setDeviation(double deviation);

  // Rebuilds the samples when the alignment changed since the last build; false when it cannot be sampled.
  bool update();
  // Whether the samples match the alignment as it is now.
  bool isCurrent() const;

  // The samples in order of chainage, after update() (rebuilds when stale; empty on failure).
  const std::vector<TAlntCachePos>& getPositions();
  std::size_t getNumOfPositions() { return getPositions().size(); }

 protected:
  explicit CAlntPosCacheBase(double deviation);
  CAlntPosCacheBase(const CAlntPosCacheBase&) = default;
  CAlntPosCacheBase& operator=(const CAlntPosCacheBase&) = default;

  // The sample interpolated at the chainage (after update()); false outside the sampled range.
  bool interpolate(double chainage, TAlntCachePos& position);

 private:
  // Fills `positions` (given empty) in order of chainage; false when the alignment cannot be sampled.
  virtual bool doSample(std::vector<TAlntCachePos>& positions) const = 0;
  virtual std::uint64_t doFingerprint() const = 0;

  std::vector<TAlntCachePos> m_positions;
  double m_deviation;
  std::uint64_t m_fingerprint;
  bool m_built;
  bool m_ok;
};

// Plan positions of a horizontal alignment; the deviation is the plan distance of a chord from the curve.
class SVYMATH_API CAlnt2dPosCache : public CAlntPosCacheBase {
  SVY_RTTI_DECLARE(CAlnt2dPosCache)

 public:
  CAlnt2dPosCache(const CHorzAlntBase& alignment, double deviation);

  bool getPosNeAtChain(double chainage, double& north, double& east);

 private:
  bool doSample(std::vector<TAlntCachePos>& positions) const override;
  std::uint64_t doFingerprint() const override;

  const CHorzAlntBase* m_alignment;
};

// Heights of a profile; the deviation is the height difference of a chord from the curve.
class SVYMATH_API CAlntHtPosCache : public CAlntPosCacheBase {
  SVY_RTTI_DECLARE(CAlntHtPosCache)

 public:
  CAlntHtPosCache(const CVertAlntBase& profile, double deviation);

  bool getHeightAtChain(double chainage, double& height);

 private:
  bool doSample(std::vector<TAlntCachePos>& positions) const override;
  std::uint64_t doFingerprint() const override;

  const CVertAlntBase* m_profile;
};

// 3-D centre-line positions of a pair over the range both alignments cover (start to the pair's end).
class SVYMATH_API CAlnt3dPosCache : public CAlntPosCacheBase {
  SVY_RTTI_DECLARE(CAlnt3dPosCache)

 public:
  CAlnt3dPosCache(const CHorzAndVertAlntBase& pair, double deviation);

  bool getPosAtChain(double chainage, double& north, double& east, double& height);

 private:
  bool doSample(std::vector<TAlntCachePos>& positions) const override;
  std::uint64_t doFingerprint() const override;

  const CHorzAndVertAlntBase* m_pair;
};
