#pragma once
// What every alignment element has, horizontal or vertical: a start chainage and a length, and the
// conversion between chainage (metres along the whole alignment) and distance (metres from the element's
// start). Positions, heights and directions come with the horizontal and vertical element interfaces.
#include "svymath/foundation/class_new.h"
#include "svymath/foundation/export.h"

// Chainage arithmetic shared by horizontal and vertical elements. Every query returns false, leaving its
// output unchanged, when the start chainage or the length is unknown.
class SVYMATH_API CAlntElBase {
 public:
  virtual ~CAlntElBase();

  // The element's length (metres; plan length for a horizontal element, horizontal length for a vertical one).
  virtual bool getHLengthInM(double& length) const = 0;
  virtual bool getStartChainageInM(double& chainage) const = 0;
  // Start chainage plus length.
  virtual bool getFinalChainageInM(double& chainage) const;
  // Start chainage + distance.
  virtual bool distance2Chainage(double distance, double& chainage) const;
  // Chainage - start chainage.
  virtual bool chainage2Distance(double chainage, double& distance) const;
  // The element kind: a TAlntHeType value for horizontal elements, a TAlntVeType value for vertical ones.
  virtual int getType() const = 0;

 protected:
  CAlntElBase() = default;
  CAlntElBase(const CAlntElBase&) = default;
  CAlntElBase& operator=(const CAlntElBase&) = default;
};

// Holds the start chainage that the alignment hands an element when it places it (NaN until placed).
class SVYMATH_API CAlntElemImpl {
 public:
  SVY_CLASS_NEW_DELETE

  CAlntElemImpl();
  virtual ~CAlntElemImpl();

  // Whether the element is placed (its start chainage known); elements add their own shape test.
  virtual bool isok() const;

  // The stored start chainage; false while it is unknown. Concrete elements answer
  // CAlntElBase::getStartChainageInM with it.
  bool readStartChainage(double& chainage) const;
  // Stores the start chainage given by the alignment (NaN forgets it).
  void onStartChainageUpdate(double chainage) { m_startChainage = chainage; }

 protected:
  CAlntElemImpl(const CAlntElemImpl&) = default;
  CAlntElemImpl& operator=(const CAlntElemImpl&) = default;

 private:
  double m_startChainage;
};
