#pragma once
// A surface definition by templates: cross-section templates assigned to chainages (metres). Between two
// consecutive assignments the section is interpolated linearly in chainage: points are matched by name
// (the n-th point of a name from the left with the n-th of that name in the later template, as names
// repeat on the two sides), and their offsets and relative heights are
// interpolated; a point whose name the other template lacks is left out between the two assignments (it
// stands only at its own template's chainage). Side slopes are interpolated when both templates have them,
// else the earlier template's hold. Before the first assignment the first template holds, after the last the
// last one.
#include "svymath/foundation/class_new.h"
#include "svymath/foundation/export.h"
#include "svymath/foundation/rtti.h"
#include "svymath/road/cross_sect_template.h"
#include "svyutils/svy_containers.h"

class SVYMATH_API CXsSf : public virtual CRttiBase {
  SVY_RTTI_DECLARE(CXsSf)

 public:
  SVY_CLASS_NEW_DELETE

  CXsSf();
  CXsSf(const CXsSf& other);
  CXsSf& operator=(const CXsSf& other);
  ~CXsSf() override;

  // Assigns a copy of a template to a chainage, in chainage order; an assignment within tol::kSnap of an
  // existing one replaces it. False for a chainage that is not a finite number.
  bool assignTemplate(double chainage, const CCrossSectTemplate& sectionTemplate);
  bool removeAssignment(int index);
  void removeAll() { m_entries.clear(); }
  int getNumOfAssignments() const { return static_cast<int>(m_entries.size()); }
  double getAssignmentChainage(int index) const;
  const CCrossSectTemplate* getTemplate(int index) const;

  // The template in force at a chainage, interpolated as described above; false without assignments.
  bool getTemplateAtChainage(double chainage, CCrossSectTemplate& result) const;
  // Adds the points in force at a chainage to a section at a centre-line elevation; false without
  // assignments, without points there, or for values that are not numbers.
  bool fillSection(double chainage, double clElevation, CEditableRoadCrossSection& section) const;
  // The side slopes (run over rise, NaN when none) in force at a chainage; false without assignments.
  bool getSideSlopesAtChainage(double chainage, bool rightSide, double& cutRunRise, double& fillRunRise) const;

 private:
  struct TEntry {
    double chainage;
    CCrossSectTemplate sectionTemplate;
  };
  // The assignments in force: before and after (the same one outside or at an assignment) and the
  // interpolation factor between them. False without assignments or for a chainage that is not a number.
  bool bracket(double chainage, const TEntry*& before, const TEntry*& after, double& t) const;
  template <typename Sink>
  bool forEachPointAt(double chainage, Sink&& sink) const;

  svy_vector<TEntry> m_entries;
};
