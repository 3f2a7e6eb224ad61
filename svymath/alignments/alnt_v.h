#pragma once
// The vertical alignment (profile): design height as a function of chainage, an ordered chain of vertical
// elements on the same chainage as the horizontal alignment. Chainages, lengths and heights are metres,
// grades percent. Every query that can fail returns false and leaves its outputs unchanged.
//
// Chaining: after every edit (outside a bulk update) the profile re-anchors its elements from the one
// before the change to the end (doVPostUpdate). The first element is anchored to the profile's start
// chainage and height, by two paths that differ on purpose:
// - after setStartHeight / setStartChainageInM (and setStartPos), the stored start chainage S and height H
//   are imposed on the first element: an intersection-point element (CVerticalLSElement, CAlntVeLsWithArc)
//   gets S and H as its first point (curve length and radius 0), any other kind S and H as its start;
// - after an edit at the start (index 0 or 1) or the end of a bulk update, the first element receives H and
//   the chainage the profile reports as its start (getStartChainageInM): for an intersection-point element
//   that is its own point's chainage, which is kept, while its height becomes H.
// So appending a first element defined by intersection points keeps its chainage, and a later
// setStartChainageInM moves it.
//
// A candidate element is accepted by checkIfOk (see there) and the profile keeps a private clone of it.
#include <vector>

#include "svymath/alignments/alignment_base.h"
#include "svymath/alignments/alignment_base_impl.h"
#include "svymath/alignments/alnt_v_element_index.h"
#include "svymath/alignments/vertical_element_base.h"

// The interface of every vertical alignment.
class SVYMATH_API CVertAlntBase : public virtual CAlntBase {
  SVY_RTTI_DECLARE(CVertAlntBase)

 public:
  ~CVertAlntBase() override;

  virtual int getNumOfVes() const = 0;
  // The start height: the first point of an intersection-point first element, else the stored one.
  virtual double getStartPosH() const = 0;
  // The height at the end of the last element.
  virtual bool getFinalHeight(double& height) const = 0;
  // Height and grade (percent) from the element holding the chainage; false where none holds it.
  virtual bool getHeightAtChain(double chainage, double& height) const = 0;
  // The height anywhere: on the profile, or on its first grade before the start and its last grade after
  // the end (extrapolated true).
  virtual bool getHeightAtChainExtr(double chainage, double& height, bool& extrapolated) const = 0;
  virtual bool getHeightAtChainExtr(double chainage, double& height) const = 0;
  virtual bool getGradeAtChainage(double chainage, double& grade) const = 0;
  // The element holding the chainage, the distance into it and its index (pointers may be null).
  virtual const CAlntVe* getVertElemAtChain(double chainage, double* distanceInElement = nullptr,
                                            int* index = nullptr) const = 0;
  // A vertical alignment takes only the height of a start position.
  virtual void setStartPos(double north, double east, double height) = 0;
  virtual void setStartHeight(double height) = 0;

  // Element i as a vertical element, or null.
  const CAlntVe* getVe(int index) const;
  const CAlntVe* getFirstVe() const { return getVe(0); }
  const CAlntVe* getLastVe() const { return getVe(getNumOfElements() - 1); }

 protected:
  CVertAlntBase() = default;
  CVertAlntBase(const CVertAlntBase&) = default;
  CVertAlntBase& operator=(const CVertAlntBase&) = default;
};

class SVYMATH_API CAlntV : public CVertAlntBase, public CAlntBaseImpl {
  SVY_RTTI_DECLARE(CAlntV)

 public:
  SVY_CLASS_NEW_DELETE

  // Empty: start chainage 0, start height undefined.
  CAlntV();
  CAlntV(const CAlntV& other);
  CAlntV& operator=(const CAlntV& other);
  ~CAlntV() override;

  // ---- CAlntBase ----
  double getStartChainageInM() const override;
  bool getFinalChainageInM(double& chainage) const override;
  bool getHLengthInM(double& length) const override;
  // Linear maps about the start chainage getStartChainageInM reports.
  double distance2Chainage(double distance) const override;
  double chainage2Distance(double chainage) const override;
  int getNumOfElements() const override;
  const CAlntElBase* getElement(int index) const override;

  // ---- CVertAlntBase ----
  int getNumOfVes() const override { return getNumOfElements(); }
  double getStartPosH() const override;
  bool getFinalHeight(double& height) const override;
  bool getHeightAtChain(double chainage, double& height) const override;
  bool getHeightAtChainExtr(double chainage, double& height, bool& extrapolated) const override;
  bool getHeightAtChainExtr(double chainage, double& height) const override;
  bool getGradeAtChainage(double chainage, double& grade) const override;
  const CAlntVe* getVertElemAtChain(double chainage, double* distanceInElement = nullptr,
                                    int* index = nullptr) const override;
  void setStartPos(double north, double east, double height) override;
  void setStartHeight(double height) override;

  // ---- CAlntBaseImpl ----
  void onBulkUpdateFinished() override;
  void setStartChainageInM(double chainage) override;

  // ---- editing (false, nothing changed, when checkIfOk refuses the element or it cannot be cloned) ----
  bool appendElement(const CAlntVe& element);
  bool insertElement(int index, const CAlntVe& element);
  bool replaceElement(int index, const CAlntVe& element);
  // Removes element i (false for an index out of range).
  bool removeVe(int index);
  void removeAllVes();
  bool isEmpty() const { return m_elements.empty(); }
  CAlntVe* getVe(int index);
  using CVertAlntBase::getVe;
  // The element holding the chainage and the distance into it (null where none holds it).
  const CAlntVe* getAlntVeAtChain(double chainage, double* distanceInElement) const;
  const std::vector<CAlntVe*>& getElements() const { return m_elements; }
  void copy(const CAlntV& other);

 protected:
  virtual CAlntVe* CloneElement(const CAlntVe& element) const;
  // Whether the candidate fits between the elements at previousIndex and nextIndex (-1: none):
  // - it has a shape: its horizontal length is known, finite and not negative (an element defined by
  //   intersection points has both points and curves that do not overlap);
  // - an element defined by intersection points (types 2 and 4) keeps the order of the points: its point's
  //   chainage lies strictly after that of a previous element of those types and strictly before that of a
  //   next one. Elements of the other kinds take their start from their predecessor and fit anywhere.
  bool checkIfOk(int previousIndex, int nextIndex, const CAlntVe& candidate) const;
  // Inserts the element (owned from now on) before index i; no re-chaining.
  void doInsertVe(int index, CAlntVe* element);

 private:
  bool doObtainTotalHLength(double& length) const override;
  // Re-anchors the elements after a change at index i (-1: a change of the start values), then rebuilds
  // the chainage index.
  void doVPostUpdate(int index);
  void anchorFirstToStart();

  std::vector<CAlntVe*> m_elements;
  double m_startHeight;
  CAlntElementIndex m_index;
};
