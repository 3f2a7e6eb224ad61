#pragma once
// A road: a horizontal alignment, a vertical alignment and a surface definition (a set of cross-section
// templates or a set of road strings) answering 3-D questions at a chainage and offset (metres; offsets
// positive to the right; grades percent): the plan position, the design height and the cross-section there.
//
// CRoadBase is the interface and holds the road-level algorithms; CRoadBaseImpl (road_base_impl.h) holds
// the references to the parts and the corridor settings. Centre-line queries are those of the alignment
// pair; the road ends where the shorter of its two alignments ends.
#include "svymath/alignments/alnt_pair.h"
#include "svymath/road/cross_section.h"
#include "svymath/road/road_string.h"
#include "svymath/road/xs_sf.h"

class CHorzAlntElemBase;

class SVYMATH_API CRoadBase : public CHorzAndVertAlntBase {
  SVY_RTTI_DECLARE(CRoadBase)

 public:
  SVY_CLASS_NEW_DELETE

  ~CRoadBase() override;

  // ---- the centre line, from the two alignments ----
  virtual double getStartChainageInM() const = 0;
  // The pair's end: the shorter alignment ends the road.
  virtual bool getFinalChainageInM(double& chainage) const;
  virtual bool getHLengthInM(double& length) const = 0;
  virtual double distance2Chainage(double distance) const;
  virtual double chainage2Distance(double chainage) const;
  const CHorzAlntBase& getHorzAlnt() const override = 0;
  const CVertAlntBase& getVertAlnt() const override = 0;
  virtual double getStartPosN() const;
  virtual double getStartPosE() const;
  virtual bool getFinalPosNe(double& north, double& east) const;
  virtual bool getPosNeAtChain(double chainage, double& north, double& east) const;
  virtual bool getHtAtChain(double chainage, double& height) const;
  virtual bool getAzimuthAtChain(double chainage, double& azimuthDeg) const;
  virtual bool getPosNeAtChainExtr(double chainage, double& north, double& east, bool& extrapolated) const;
  virtual bool getPosNeAtChainAndOffsetExtr(double chainage, double offset, double& north, double& east,
                                            bool* extrapolated = nullptr) const;
  virtual bool getAzimuthAtChainExtr(double chainage, double& azimuthDeg) const;
  virtual const CHorzAlntElemBase* getHorzElemAtChain(double chainage, double* distanceInElement = nullptr,
                                                      int* index = nullptr) const;
  // The plan position at a chainage and offset, on the horizontal alignment (false beyond its ends).
  using CHorzAndVertAlntBase::getPosAtChainAndOffset;
  virtual bool getPosAtChainAndOffset(double chainage, double offset, double& north, double& east) const;
  virtual int getNumOfVes() const;
  virtual double getStartPosH() const;
  virtual bool getFinalPosH(double& height) const;
  virtual bool getPosHAtChain(double chainage, double& height) const;
  virtual bool getPosHAtChainExtr(double chainage, double& height) const;
  virtual const CAlntVe* getVertElemAtChain(double chainage, double* distanceInElement = nullptr,
                                            int* index = nullptr) const;

  // ---- the surface ----
  virtual const CXsSf* getSectTemplSet() const = 0;
  virtual const CRoadStringSet* getRoadStringSet() const = 0;
  // A template set with at least one assignment; a string set with at least one string; either.
  virtual bool hasSurfaceByTemplates() const;
  virtual bool hasSurfaceByStrings() const;
  virtual bool hasSurfaceDefinition() const;
  double getChainageIntervalInM() const override = 0;
  // The corridor's extent left and right of the centre line (offsets in metres; NaN when not set).
  virtual double getCorridorLeftOffset() const = 0;
  virtual double getCorridorRightOffset() const = 0;
  virtual bool hasCorridorLeftOffset() const;
  virtual bool hasCorridorRightOffset() const;
  // The design height at a chainage and offset. With useCrossSection, from the section there: on its
  // surface (slopePercent, if asked, gets the segment's slope in percent), or at or beyond its outermost
  // points the nearer outermost point's elevation with slope 0 (also a success). Without useCrossSection,
  // or when no section can be built there, the centre-line height, whatever the offset, with slope 0.
  virtual bool getHtAtChainAndOffset(double chainage, double offset, double& height, bool useCrossSection,
                                     double* slopePercent = nullptr) const;
  // The plan position and the design height together; true only when both are found.
  virtual bool get3DPosAtChainAndOffset(double chainage, double offset, double& north, double& east, double& height,
                                        bool useCrossSection, double* slopePercent = nullptr) const;
  // A new section at a chainage from the surface definition (templates first, else strings), at the
  // centre-line height and position with the centre line's azimuth; the caller owns it. With extrapolate,
  // chainages beyond the alignments' ends are answered along the end tangents and end grades, and the
  // section's extrapolated flags say so; without it they fail. False (section untouched) without a surface
  // definition or without points there.
  virtual bool getCrossSectionAtChainage(double chainage, CRoadCrossSection*& section, bool extrapolate) const = 0;
  virtual void setChainageIntervalInM(double interval) = 0;
  virtual void setCorridorLeftOffset(double offset) = 0;
  virtual void setCorridorRightOffset(double offset) = 0;
  virtual void clearCorridorLeftOffset() = 0;
  virtual void clearCorridorRightOffset() = 0;

  // ---- strings generated from the surface ----
  // Replaces the cache with one string per point of the sections (by name, the n-th of a name from the
  // left) at the regular stations (the chainage interval from the start), at each template assignment and at
  // the end, with absolute heights.
  // False (cache emptied) when the road has no surface definition or no length.
  bool generateStringCache();
  void clearStringSetCache() { m_stringCache.removeAll(); }
  const CRoadStringSet& getStringSetCache() const { return m_stringCache; }

 protected:
  CRoadBase();
  CRoadBase(const CRoadBase& other);
  CRoadBase& operator=(const CRoadBase& other);

 private:
  CRoadStringSet m_stringCache;
};
