#pragma once
// The editable horizontal alignment: an ordered chain of horizontal elements (private clones, owned and
// deleted by the alignment) measured by chainage from its start chainage, beginning at its start point.
//
// Re-anchoring: every edit (insert, replace, remove, start point, start chainage) invalidates the cached
// length and calls onSetIndex on the elements from the one before the change to the last, so that each
// starts where its predecessor ends; the element before the change is redone too because an
// intersection-point element depends on its successor. Between onBulkUpdateStarted and
// onBulkUpdateFinished edits are not re-anchored (queries see the stale chain); finishing re-anchors all.
//
// Access lock (recursive, see CAlntBase): every query of the alignment itself takes it, because the
// elements fill caches inside their const queries (angles, spiral laws): both FindChainageAndOffset forms,
// the batch query FindChainagesAndOffsets (which also builds its search index under it), the queries by
// chainage and their extrapolating forms, FindApproxChainageAndOffset, getHLengthInM and
// getFinalChainageInM (they fill the length cache), getFinalPosNe, getBoundary, getIpPosForElement and
// ForEachSegment. An element reached through getHe or getHorzElemAtChain is not guarded: query it from one
// thread at a time. Editing takes no lock: do not edit an alignment while another thread reads it.
#include <cstddef>
#include <memory>
#include <vector>

#include "svymath/alignments/alignment_base_impl.h"
#include "svymath/alignments/horz_alignment_base.h"
#include "svymath/alignments/horz_element.h"

namespace svy_math {
namespace detail {
class CAlntSearchIndex;
struct TAlntSearchTrace;
}  // namespace detail
}  // namespace svy_math

// One answer of the batch point-to-chainage query, the outputs of FindChainageAndOffset for one point.
struct SVYMATH_API TAlntStationResult {
  bool found = false;         // false: the point has no chainage (the other fields are then meaningless)
  double chainage = 0.0;      // metres
  double offset = 0.0;        // metres, positive right
  int index = -1;             // the element
  bool atJoint = false;       // in the wedge outside a kink
  bool extrapolated = false;  // on an extension beyond an end
};

class SVYMATH_API CAlntH : public virtual CHorzAlntBase, public CAlntBaseImpl {
  SVY_RTTI_DECLARE(CAlntH)

 public:
  SVY_CLASS_NEW_DELETE

  // Empty: start chainage 0, start point undefined, length unknown.
  CAlntH();
  CAlntH(const CAlntH& other);
  CAlntH& operator=(const CAlntH& other);
  ~CAlntH() override;

  // ---- CAlntBase ----
  double getStartChainageInM() const override { return getStoredStartChainageInM(); }
  bool getFinalChainageInM(double& chainage) const override;
  bool getHLengthInM(double& length) const override;
  double distance2Chainage(double distance) const override { return distance + getStoredStartChainageInM(); }
  double chainage2Distance(double chainage) const override { return chainage - getStoredStartChainageInM(); }
  int getNumOfElements() const override { return static_cast<int>(m_elements.size()); }
  const CAlntElBase* getElement(int index) const override { return getHe(index); }

  // ---- CHorzAlntBase ----
  double getStartPosN() const override { return m_startNorth; }
  double getStartPosE() const override { return m_startEast; }
  bool getFinalPosNe(double& north, double& east) const override;
  C2dMinMax getBoundary() const override;
  bool getPosNeAtChain(double chainage, double& north, double& east) const override;
  bool getAzimuthAtChain(double chainage, double& azimuthDeg) const override;
  // Both FindChainageAndOffset forms give the answers of the element-by-element search (every element in
  // order, the tie-break and wedge rules) but take the elements to search from a spatial index of their
  // boxes, built on first use after an edit: only the elements that could change the answer are projected.
  bool FindChainageAndOffset(double north, double east, double& chainage, double& offset, bool& extrapolated,
                             int* index = nullptr, bool* atJoint = nullptr) const override;
  bool FindChainageAndOffset(double north, double east, double& chainage, double& offset, int* index = nullptr,
                             bool* atJoint = nullptr) const override;
  bool FindApproxChainageAndOffset(double approxChainage, double north, double east, double& chainage,
                                   double& offset) const override;
  bool getPosNeAtChainExtr(double chainage, double& north, double& east, bool& extrapolated) const override;
  bool getPosNeAtChainExtr(double chainage, double& north, double& east) const override;
  bool getPosNeAtChainAndOffsetExtr(double chainage, double offset, double& north, double& east,
                                    bool* extrapolated = nullptr) const override;
  bool getAzimuthAtChainExtr(double chainage, double& azimuthDeg) const override;
  bool getCurvatureAtChainage(double chainage, double& curvature) const override;
  const CHorzAlntElemBase* getHorzElemAtChain(double chainage, double* distanceInElement,
                                              int* index) const override;
  void setStartPos(double north, double east, double third) override;
  bool appendElement(const CAlntHe& element) override;
  bool insertElement(int index, const CAlntHe& element) override;
  bool replaceElement(int index, const CAlntHe& element) override;
  // Deletes element index and re-anchors the rest; false (nothing changed) for an index out of range.
  bool removeHe(int index) override;
  // An intersection-point element's IP; for the other kinds the crossing of the tangents at the element's
  // two ends (false when they are parallel, as for a tangent element).
  bool getIpPosForElement(int index, double& north, double& east) const override;

  // ---- CAlntBaseImpl ----
  // Clears the bulk flag and re-anchors every element.
  void onBulkUpdateFinished() override;
  // Stores the start chainage and re-anchors every element.
  void setStartChainageInM(double chainage) override;

  // ---- typed access ----
  const CAlntHe* getHe(int index) const;
  const CAlntHe* getFirstHe() const { return getHe(0); }
  const CAlntHe* getLastHe() const { return getHe(getNumOfElements() - 1); }
  const CAlntHe* getAlntHeAtChain(double chainage, double* distanceInElement) const;
  void removeAllHes();
  void copy(const CAlntH& other);

  // Batch point-to-chainage over arrays of `count` points: results[k] answers (north[k], east[k]) exactly as
  // FindChainageAndOffset would (the seven-argument form when withExtension is true, else the six-argument
  // form). Returns the number of points found (0 for null arrays). Holds the access lock for the whole batch.
  std::size_t FindChainagesAndOffsets(const double* north, const double* east, std::size_t count,
                                      TAlntStationResult* results, bool withExtension) const;
  // Whether the point-to-chainage queries take their candidates from the spatial index (the default) or
  // project every element: the answers are the same. Without the index an alignment that is edited between
  // single queries saves rebuilding it; with it a query costs about as much at 1000 elements as at 10.
  void setUseSearchIndex(bool use) { m_useSearchIndex = use; }
  bool getUseSearchIndex() const { return m_useSearchIndex; }

 protected:
  // A heap clone of the element, owned by the caller (null when it cannot be cloned).
  virtual CAlntHe* CloneElement(const CAlntHe& element) const;
  // Inserts an owned element before index without re-anchoring.
  void doInsertHe(int index, CAlntHe* element);

 private:
  bool doObtainTotalHLength(double& length) const override;
  // Re-anchors from the element before `index` to the end (unless in a bulk update).
  void doHPostUpdate(int index);
  // Forgets the search index (after any change of the chain).
  void invalidateSearchIndex() const;
  // The best on-alignment answer over the candidate elements (ascending indices; null: every element).
  bool findOnAlignment(double north, double east, const std::vector<int>* candidates, TAlntStationResult& result,
                       svy_math::detail::TAlntSearchTrace* trace) const;
  // The six- or seven-argument search of one point, through the index unless it is switched off. Called
  // under the access lock.
  bool findPoint(double north, double east, bool withExtension, TAlntStationResult& result) const;
  // The on-alignment search over the elements near the point (the index is built first when missing).
  bool findThroughIndex(double north, double east, TAlntStationResult& result) const;
  // An element's distance bound and its foot for the point; with `remembered` through the index's record of
  // what the element answered earlier for the same point.
  bool elementDistance(int index, double north, double east, bool remembered, double& distance) const;
  bool elementFoot(int index, double north, double east, bool remembered, double& along, double& offset) const;
  // Step two and three of the seven-argument form: the extensions beyond the two ends.
  bool extendBeyondEnds(double north, double east, bool found, TAlntStationResult& result) const;
  void deleteElements();
  // The element holding the chainage (the getHorzElemAtChain rule).
  const CAlntHe* findHeAtChain(double chainage, double* distanceInElement, int* index) const;

  std::vector<CAlntHe*> m_elements;
  double m_startNorth;
  double m_startEast;
  bool m_useSearchIndex;
  mutable std::unique_ptr<svy_math::detail::CAlntSearchIndex> m_searchIndex;
};
