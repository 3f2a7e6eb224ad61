#pragma once
// The face every alignment shows, horizontal or vertical: chainage (metres along the alignment, from its
// start chainage), length, its elements, and the per-alignment access lock.
//
// The access lock is recursive: a thread that holds it may take it again (the long queries call each
// other). It serialises the queries that take it (the point-to-chainage searches, which also build the
// alignment's search index on first use); editing takes no lock, so an alignment must not be edited while
// another thread reads it. Copying an alignment gives the copy its own, unlocked lock.
#include <memory>

#include "svymath/foundation/class_new.h"
#include "svymath/foundation/export.h"
#include "svymath/foundation/rtti.h"

class CAlntElBase;

class SVYMATH_API CAlntBase : public virtual CRttiBase {
  SVY_RTTI_DECLARE(CAlntBase)

 public:
  SVY_CLASS_NEW_DELETE

  ~CAlntBase() override;

  // The chainage of the alignment's start (metres).
  virtual double getStartChainageInM() const = 0;
  // Start chainage plus total length; false when the length is not known.
  virtual bool getFinalChainageInM(double& chainage) const = 0;
  // The total length of the elements (metres); false when an element has no length.
  virtual bool getHLengthInM(double& length) const = 0;
  // Exact linear maps between a distance from the start and a chainage (station equations do not enter).
  virtual double distance2Chainage(double distance) const = 0;
  virtual double chainage2Distance(double chainage) const = 0;
  virtual int getNumOfElements() const = 0;
  // Element i (0-based), or null outside 0 .. getNumOfElements() - 1.
  virtual const CAlntElBase* getElement(int index) const = 0;

  // getFinalChainageInM under another name, for callers that hold the base.
  bool getEndChainageInM(double& chainage) const { return getFinalChainageInM(chainage); }

  // Takes and releases the access lock (recursive); CAlntAccessGuard does both for a scope.
  void lockAccess() const;
  void unlockAccess() const;

 protected:
  CAlntBase();
  // The lock is not copied: each alignment has its own.
  CAlntBase(const CAlntBase& other);
  CAlntBase& operator=(const CAlntBase& other);

 private:
  // A boost::recursive_mutex, kept out of this header.
  class CAccessLock;
  std::unique_ptr<CAccessLock> m_accessLock;
};

// Holds an alignment's access lock for the life of the guard.
class CAlntAccessGuard {
 public:
  explicit CAlntAccessGuard(const CAlntBase& alignment) : m_alignment(alignment) { m_alignment.lockAccess(); }
  ~CAlntAccessGuard() { m_alignment.unlockAccess(); }
  CAlntAccessGuard(const CAlntAccessGuard&) = delete;
  CAlntAccessGuard& operator=(const CAlntAccessGuard&) = delete;

 private:
  const CAlntBase& m_alignment;
};
