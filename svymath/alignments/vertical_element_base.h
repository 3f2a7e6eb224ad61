#pragma once
// The vertical element: a piece of a profile that answers height and grade at a length (horizontal metres
// from its start) or at a chainage. Heights are metres, grades percent.
//
// The vertical alignment (CAlntV) chains its elements: it hands the first one the profile's start height and
// chainage (setStartHtAndChain) and tells every element about its neighbours (onNeighbourUpdate), from which
// an element takes its own start (the end of the element before it) and, for the kinds defined by
// intersection points, the grades of the lines on either side.
#include "svymath/alignments/alignment_element_base.h"
#include "svymath/alignments/vertical_types.h"
#include "svymath/foundation/rtti.h"

class CAlntVeVisitor;
class CAlntVeVisitor_const;

// Height and grade by chainage, built on the queries by length.
class SVYMATH_API CVertAlntElemBase : public CAlntElBase {
 public:
  ~CVertAlntElemBase() override;

  // Height at a length from the start: an errCodes value (eVeHtOk, or before start / after end).
  virtual int getHtAtLen(double length, double& height) const = 0;
  // Grade (percent) at a length; false outside the element.
  virtual bool getGradeAtLength(double length, double& grade) const = 0;

  // The same at a chainage; false where the element holds no height or is not placed.
  bool getHtAtChain(double chainage, double& height) const;
  bool getGradeAtChainage(double chainage, double& grade) const;
  // getHtAtChain under the name the position queries use.
  bool getPosHeightInM(double chainage, double& height) const { return getHtAtChain(chainage, height); }

 protected:
  CVertAlntElemBase() = default;
  CVertAlntElemBase(const CVertAlntElemBase&) = default;
  CVertAlntElemBase& operator=(const CVertAlntElemBase&) = default;
};

// The abstract vertical element. Undefined values are NaN; an element is created undefined.
class SVYMATH_API CAlntVe : public CVertAlntElemBase, public CAlntElemImpl, public virtual CRttiBase {
  SVY_RTTI_DECLARE(CAlntVe)

 public:
  SVY_CLASS_NEW_DELETE

  ~CAlntVe() override;

  // CAlntElBase: the start chainage held by CAlntElemImpl and the horizontal length getLen().
  bool getHLengthInM(double& length) const override;
  bool getStartChainageInM(double& chainage) const override;

  // Horizontal length, start and end height, start and end grade (percent); NaN while undefined.
  virtual double getLen() const = 0;
  virtual double getStartHt() const = 0;
  virtual double getFinalHt() const = 0;
  virtual double getStartGrade() const = 0;
  virtual double getEndGrade() const = 0;
  // The element as a vertical intersection point record; false while undefined.
  virtual bool getAsLs(CLsInfo& info) const = 0;
  // The length of a chord step from `length` whose sagitta stays within `deviation` metres, never past the
  // element's end; the rest of the element on a grade or when deviation is not positive; 0 outside.
  virtual double getStepForDeviation(double length, double deviation) const = 0;

  // Placement by the alignment (see the file comment). Either neighbour may be null.
  virtual void setStartHtAndChain(double height, double chainage) = 0;
  // By default the element starts where the previous one ends.
  virtual void onNeighbourUpdate(const CAlntVe* previous, const CAlntVe* next);

  // A heap copy owned by the caller.
  virtual CAlntVe* clone() const = 0;
  // Same kind, same defining values and placement (within the zero tolerance).
  virtual bool isEqual(const CAlntVe* other) const = 0;
  virtual void Accept(CAlntVeVisitor& visitor) = 0;
  virtual void Accept(CAlntVeVisitor_const& visitor) const = 0;

 protected:
  CAlntVe() = default;
  CAlntVe(const CAlntVe&) = default;
  CAlntVe& operator=(const CAlntVe&) = default;

  // The final height and chainage of the element before this one; false when there is none or it has no
  // end yet.
  static bool previousEnd(const CAlntVe* previous, double& height, double& chainage);
  // The chord step along the chainage whose chord stays within `deviation` (metres, measured vertically) of
  // a curve whose second derivative of height by chainage is at most maxCurvature (1/m): a chord of length
  // c lies at most maxCurvature c^2 / 8 from the curve. The rest of the element when either is not positive.
  static double chordStep(double deviation, double maxCurvature, double rest);
  // The comparisons of isEqual: both undefined, or within the zero tolerance; the same start chainage.
  static bool sameValue(double a, double b);
  bool sameStart(const CAlntVe& other) const;
};
