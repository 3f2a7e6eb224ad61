#pragma once
// The offset alignment of a whole horizontal alignment, as for a lane edge: a constant offset, or an offset
// that runs linearly from one value at a start chainage to another at an end chainage (a widening), constant
// before and after. Offsets are metres, positive right; chainages are those of the base alignment, carried to
// the offset alignment along the base's normals: the point at chainage c of the offset alignment is the base
// point at (c, offset(c)), and a point's chainage on the offset alignment is its chainage on the base, its
// offset the base offset less offset(c) (a true perpendicular offset where the offset is constant, since
// parallel curves share their normals; measured along the base normal on a widening, as it is staked).
//
// The offset alignment exists only while the offset stays on the near side of every centre of curvature of
// the base (on the inside of a curve: smaller than the radius, spirals included); isok() says whether it
// does, and every query returns false, leaving its outputs unchanged, when it does not. The alignment is read,
// not owned; build the offset alignment again after editing the alignment.
#include <vector>

#include "svymath/foundation/class_new.h"
#include "svymath/foundation/export.h"
#include "svymath/foundation/rtti.h"

class CHorzAlntBase;

// One point of an offset alignment: chainage, the offset from the base there, and its plan position (metres).
struct SVYMATH_API TOffsetAlntPoint {
  double chainage;
  double offset;
  double north;
  double east;
};

class SVYMATH_API Offsets4TS : public virtual CRttiBase {
  SVY_RTTI_DECLARE(Offsets4TS)

 public:
  SVY_CLASS_NEW_DELETE

  Offsets4TS(const CHorzAlntBase& alignment, double offset);
  // startOffset up to startChainage, linearly to endOffset at endChainage, endOffset after it.
  Offsets4TS(const CHorzAlntBase& alignment, double startChainage, double startOffset, double endChainage,
             double endOffset);
  ~Offsets4TS() override;

  bool isok() const { return m_ok; }
  // The offset from the base at a chainage (NaN when the chainage is not finite).
  double getOffsetAtChain(double chainage) const;

  // The offset alignment's point at a chainage of the base alignment (within its start and final chainage).
  bool getPosNeAtChain(double chainage, double& north, double& east) const;
  // Its direction there (decimal degrees): the base azimuth turned by atan(offset' / (1 - offset * k)).
  bool getAzimuthAtChain(double chainage, double& azimuthDeg) const;
  // A point's chainage and offset with respect to the offset alignment (see above).
  bool getChainageAndOffset(double north, double east, double& chainage, double& offset) const;
  // Points at every multiple of `interval` metres, every element joint, the ends of the widening and the two
  // ends of the alignment, in order; false for an interval that is not positive and finite.
  bool getPoints(double interval, std::vector<TOffsetAlntPoint>& points) const;

 private:
  bool checkCentres() const;

  const CHorzAlntBase* m_alignment;
  double m_startChainage;
  double m_startOffset;
  double m_endChainage;
  double m_endOffset;
  bool m_ok;
};
