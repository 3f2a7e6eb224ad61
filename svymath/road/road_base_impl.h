#pragma once
// The road's parts and settings: non-owning references to a horizontal alignment, a vertical alignment, a
// road string set and a template set (each may be null, and the caller keeps them alive while they are
// set), the stepping interval (metres) and the corridor offsets (metres, NaN when not set). Copying a road
// shares the referenced parts; the road never deletes them.
//
// A road without an alignment of one kind answers that alignment's queries from an empty one (false, or
// NaN for the start values).
#include "svymath/alignments/alignment_base_impl.h"
#include "svymath/road/road_base.h"

class SVYMATH_API CRoadBaseImpl : public CRoadBase, public CAlntBaseImpl {
  SVY_RTTI_DECLARE(CRoadBaseImpl)

 public:
  SVY_CLASS_NEW_DELETE

  CRoadBaseImpl();
  CRoadBaseImpl(const CRoadBaseImpl& other);
  CRoadBaseImpl& operator=(const CRoadBaseImpl& other);
  ~CRoadBaseImpl() override;

  // The horizontal alignment's start chainage (the vertical's without one, else the stored one).
  double getStartChainageInM() const override;
  // The horizontal alignment's length, asked afresh each time: the alignment is edited outside the road.
  bool getHLengthInM(double& length) const override;
  const CHorzAlntBase& getHorzAlnt() const override;
  const CVertAlntBase& getVertAlnt() const override;
  const CXsSf* getSectTemplSet() const override { return m_xsSf; }
  const CRoadStringSet* getRoadStringSet() const override { return m_stringSet; }
  double getChainageIntervalInM() const override { return m_chainageInterval; }
  double getCorridorLeftOffset() const override { return m_corridorLeft; }
  double getCorridorRightOffset() const override { return m_corridorRight; }
  bool getCrossSectionAtChainage(double chainage, CRoadCrossSection*& section, bool extrapolate) const override;
  void setChainageIntervalInM(double interval) override { m_chainageInterval = interval; }
  void setCorridorLeftOffset(double offset) override { m_corridorLeft = offset; }
  void setCorridorRightOffset(double offset) override { m_corridorRight = offset; }
  void clearCorridorLeftOffset() override;
  void clearCorridorRightOffset() override;

  void setHal(const CAlntH* alignment) { m_hal = alignment; }
  void setVal(const CAlntV* alignment) { m_val = alignment; }
  void setStringSet(const CRoadStringSet* strings) { m_stringSet = strings; }
  void setXsSf(const CXsSf* templates) { m_xsSf = templates; }
  // The horizontal and vertical parts of a pair (it stays the caller's).
  void setAlignments(const CHorzAndVertAlnt& pair);

  const CAlntH* getHAlnt() const { return m_hal; }
  const CAlntV* getVAlnt() const { return m_val; }
  const CRoadStringSet* getStringSet() const { return m_stringSet; }
  const CXsSf* getXsSf() const { return m_xsSf; }

  // Element shortcuts, forwarded to the referenced alignments (null or false without them).
  const CAlntHe* getHe(int index) const;
  const CAlntHe* getFirstHe() const;
  const CAlntHe* getLastHe() const;
  const CAlntHe* getAlntHeAtChain(double chainage, double* distanceInElement = nullptr) const;
  const CAlntVe* getVe(int index) const;
  const CAlntVe* getFirstVe() const;
  const CAlntVe* getLastVe() const;
  const CAlntVe* getAlntVeAtChain(double chainage, double* distanceInElement = nullptr) const;
  bool getIpPosForElement(int index, double& north, double& east) const;

  // Copies the settings and the references (the parts are shared).
  void copy(const CRoadBaseImpl& other);

 private:
  bool doObtainTotalHLength(double& length) const override;

  double m_chainageInterval;
  double m_corridorLeft;
  double m_corridorRight;
  const CAlntH* m_hal;
  const CAlntV* m_val;
  const CRoadStringSet* m_stringSet;
  const CXsSf* m_xsSf;
  // Answer for a missing alignment: empty, never edited.
  CAlntH m_noHal;
  CAlntV m_noVal;
};
