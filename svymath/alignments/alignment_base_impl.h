#pragma once
// The implementation shared by horizontal and vertical alignments: start chainage, the cached total length,
// the bulk-update flag and the station equations the alignment holds for its caller.
//
// The total length is cached: NaN means "not known" and is what doInvalidateTotalLen stores after every
// edit. When it is not known, getHLengthInM-style queries call doObtainTotalHLength with the cache itself
// as output; that sums the elements' lengths into it and stops at the first element without a length. The
// partial sum then stays cached, so the next query reports it as the length (and succeeds) until an edit
// invalidates the cache again. This is intended and kept: callers of earlier releases rely on it.
#include "svymath/foundation/class_new.h"
#include "svymath/foundation/export.h"
#include "svymath/foundation/rtti.h"

class StationEquations;

class SVYMATH_API CAlntBaseImpl : public virtual CRttiBase {
  SVY_RTTI_DECLARE(CAlntBaseImpl)

 public:
  SVY_CLASS_NEW_DELETE

  ~CAlntBaseImpl() override;

  // Clears the bulk-update flag; alignments override it to re-anchor their elements afterwards.
  virtual void onBulkUpdateFinished();
  // The station equations held for the caller (not owned: the caller keeps them alive while they are set).
  virtual bool HasStationEquations() const;
  virtual const StationEquations* GetStationEquations() const;
  virtual void SetStationEquations(const StationEquations* equations);
  // Stores the start chainage (metres); alignments override it to re-anchor their elements.
  virtual void setStartChainageInM(double chainage);

  // Sets the bulk-update flag: edits then skip re-anchoring until onBulkUpdateFinished.
  void onBulkUpdateStarted() { m_inBulkUpdate = true; }
  bool isInBulkUpdate() const { return m_inBulkUpdate; }
  // The cached total length as it is (NaN when not known), and a direct write of it.
  double internal_getTotalLengthAsItIs() const { return m_totalLength; }
  void internal_setTotalLengthAsItIs(double length) const { m_totalLength = length; }
  void doInvalidateTotalLen() const;
  // Copies the start chainage and the cached length, clears the bulk flag and shares the station equations.
  void copy(const CAlntBaseImpl& other);

 protected:
  CAlntBaseImpl();
  CAlntBaseImpl(const CAlntBaseImpl& other);
  CAlntBaseImpl& operator=(const CAlntBaseImpl& other);

  double getStoredStartChainageInM() const { return m_startChainage; }
  // The total length by the caching rule above.
  bool getCachedTotalHLength(double& length) const;

 private:
  // Sums the elements' lengths into `length`, which starts at 0; false at the first element without one.
  virtual bool doObtainTotalHLength(double& length) const = 0;

  double m_startChainage;
  mutable double m_totalLength;
  bool m_inBulkUpdate;
  const StationEquations* m_stationEquations;
};
