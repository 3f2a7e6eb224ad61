#pragma once
// The alignment pair: one horizontal and one vertical alignment on a common chainage, together the 3-D centre
// line of a road. Positions are (northing, easting) in metres, heights metres, grades percent; offsets are
// positive to the right of the direction of increasing chainage.
//
// The pair ends where the shorter of its two alignments ends (getFinalChainageInM through the pair's own
// interface). The horizontal part keeps its own end for its own queries (a CAlntH reference to the pair
// extrapolates from the horizontal's end), so that plan positions between the profile's end and the
// horizontal's end stay on the horizontal alignment.
#include "svymath/alignments/alignment_h.h"
#include "svymath/alignments/alnt_v.h"
#include "svymath/foundation/positions.h"

// The interface of a pair: the heights of the profile and the 3-D queries, built on the two alignments.
class SVYMATH_API CHorzAndVertAlntBase : public virtual CRttiBase {
  SVY_RTTI_DECLARE(CHorzAndVertAlntBase)

 public:
  ~CHorzAndVertAlntBase() override;

  virtual const CHorzAlntBase& getHorzAlnt() const = 0;
  virtual const CVertAlntBase& getVertAlnt() const = 0;
  // The spacing of the regular stations that the chainage iterator yields (metres).
  virtual double getChainageIntervalInM() const = 0;

  // Where the pair ends: the smaller of the two final chainages (the one known when only one is), never
  // before the start chainage; false when neither alignment has elements with a known end.
  bool getFinalChainageInM(double& chainage) const;

  // ---- the profile ----
  bool getPosHAtChain(double chainage, double& height) const;
  bool getPosHAtChainExtr(double chainage, double& height) const;
  bool getHtAtChain(double chainage, double& height) const { return getPosHAtChain(chainage, height); }
  bool getGradeAtChainage(double chainage, double& grade) const;
  double getStartPosH() const;
  bool getFinalPosH(double& height) const;
  const CAlntVe* getVertElemAtChain(double chainage, double* distanceInElement = nullptr,
                                    int* index = nullptr) const;
  int getNumOfVes() const;
  const CAlntVe* getVe(int index) const;
  const CAlntVe* getFirstVe() const;
  const CAlntVe* getLastVe() const;

  // ---- 3-D ----
  // The start point and start height; the mask gets the values that are defined.
  void getStartPos(TCoords& position) const;
  // The centre-line point: north and east (mask bits 1 and 2) when the horizontal alignment holds the
  // chainage, the height (bit 4) when the profile does. The bits are added to those already set in the
  // record (clear the mask first to read them). True when either part answered.
  bool getPosAtChain(double chainage, TCoords& position) const;
  // The plan position at a chainage and offset on the horizontal alignment (false off it).
  bool getPosAtChainAndOffset(double chainage, double offset, double& north, double& east) const;
  // The same with the centre line's design height at the chainage (the cross-section is the road's); the
  // mask bits as for getPosAtChain.
  bool getPosAtChainAndOffset(double chainage, double offset, TCoords& position) const;

 protected:
  CHorzAndVertAlntBase() = default;
  CHorzAndVertAlntBase(const CHorzAndVertAlntBase&) = default;
  CHorzAndVertAlntBase& operator=(const CHorzAndVertAlntBase&) = default;
};

class SVYMATH_API CHorzAndVertAlnt : public CAlntH, public CHorzAndVertAlntBase {
  SVY_RTTI_DECLARE(CHorzAndVertAlnt)

 public:
  SVY_CLASS_NEW_DELETE

  // Empty horizontal and vertical parts, chainage interval 100 m.
  CHorzAndVertAlnt();
  CHorzAndVertAlnt(const CHorzAndVertAlnt& other);
  CHorzAndVertAlnt& operator=(const CHorzAndVertAlnt& other);
  ~CHorzAndVertAlnt() override;

  const CHorzAlntBase& getHorzAlnt() const override { return *this; }
  const CVertAlntBase& getVertAlnt() const override { return m_vertical; }
  double getChainageIntervalInM() const override { return m_chainageInterval; }
  void setChainageIntervalInM(double interval) { m_chainageInterval = interval; }
  const CAlntV& getAlntVes() const { return m_vertical; }
  CAlntV& getAlntVes() { return m_vertical; }
  const CAlntV& getVes() const { return m_vertical; }

  // The pair's end (see CHorzAndVertAlntBase); CAlntH's own end stays reachable as CAlntH::getFinalChainageInM.
  using CHorzAndVertAlntBase::getFinalChainageInM;
  using CHorzAndVertAlntBase::getVe;
  using CHorzAndVertAlntBase::getFirstVe;
  using CHorzAndVertAlntBase::getLastVe;

  // ---- editing: horizontal elements to the horizontal part, vertical ones to the profile ----
  using CAlntH::appendElement;
  using CAlntH::insertElement;
  using CAlntH::replaceElement;
  bool appendElement(const CAlntVe& element) { return m_vertical.appendElement(element); }
  bool insertElement(int index, const CAlntVe& element) { return m_vertical.insertElement(index, element); }
  bool replaceElement(int index, const CAlntVe& element) { return m_vertical.replaceElement(index, element); }
  bool removeVe(int index) { return m_vertical.removeVe(index); }
  void removeAll();

  // The start point to the horizontal part, its height to the profile.
  void setStartPos(double north, double east, double height) override;
  // One start chainage for both parts.
  void setStartChainageInM(double chainage) override;

 private:
  double m_chainageInterval;
  CAlntV m_vertical;
};
