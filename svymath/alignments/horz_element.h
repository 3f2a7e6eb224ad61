#pragma once
// The abstract horizontal alignment element: a piece of plan geometry (tangent, arc, spiral or an
// intersection-point curve group) that the alignment places after its predecessor.
//
// Placement: whenever its index or its predecessor changes, the alignment calls onSetIndex(alignment, i).
// The first element (i = 0) starts at the alignment's start point and start chainage and keeps its own start
// azimuth; a later one starts at its predecessor's final point and final chainage and, unless its start
// azimuth is fixed, takes over the predecessor's final azimuth (tangency). Where a predecessor query fails,
// the values not yet obtained stay at chainage 0 and an undefined point and angle.
#include "svymath/alignments/horz_element_base.h"
#include "svymath/foundation/math_angle.h"
#include "svymath/foundation/positions.h"
#include "svymath/foundation/rtti.h"

class CHorzAlntBase;
class CAlntH;
class CAlntHeVisitor;
class CAlntHeVisitor_const;

class SVYMATH_API CAlntHe : public CHorzAlntElemBase, public CAlntElemImpl, public virtual CRttiBase {
  SVY_RTTI_DECLARE(CAlntHe)

 public:
  SVY_CLASS_NEW_DELETE

  ~CAlntHe() override;

  bool getStartChainageInM(double& chainage) const override { return readStartChainage(chainage); }
  // Placed (start chainage known) and with a defined shape.
  bool isok() const override;

  // Heap copy owned by the caller.
  virtual CAlntHe* clone() const = 0;
  virtual void Accept(CAlntHeVisitor_const& visitor) const = 0;
  virtual void Accept(CAlntHeVisitor& visitor) = 0;
  // Same kind and the same defining values (lengths and radii within tol::kElementEqual, the same start
  // azimuth control).
  virtual bool isEqual(const CAlntHe* other) const = 0;
  // The element's intersection point: the crossing of the tangents at its two ends (false when they are
  // parallel or undefined); an intersection-point element answers its IP.
  virtual bool getIpPos(double& north, double& east) const;
  // The plan extent of the element's segments (empty when it has no defined shape).
  C2dMinMax getBoundary() const;

 protected:
  friend class CAlntH;

  CAlntHe() = default;
  CAlntHe(const CAlntHe&) = default;
  CAlntHe& operator=(const CAlntHe&) = default;

  // Takes the start chainage, start point and (unless fixed) start azimuth from the alignment.
  virtual void onSetIndex(const CHorzAlntBase& alignment, int index) = 0;
  // Whether the element's own shape is defined (isok adds the placement).
  virtual bool isShapeOk() const = 0;

  // Where element `index` of the alignment starts: the alignment's start for index < 1, else its
  // predecessor's end. Values that cannot be obtained stay chainage 0, undefined point and angle.
  static void getAnchor(const CHorzAlntBase& alignment, int index, double& chainage, C2dPos& start,
                        CMathAngle& azimuth);
};
