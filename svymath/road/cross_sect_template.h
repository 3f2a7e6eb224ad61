#pragma once
// A cross-section template: the design shape of the road across its centre line, an ordered list of points
// each given by its offset (metres, negative left, positive right) and its height relative to the centre
// line (metres), with a name and a feature index, and optional cut and fill slopes per side (run over
// rise as in CRoadCrossSectionSlope; NaN when the side has no such slope).
#include "svymath/foundation/class_new.h"
#include "svymath/foundation/export.h"
#include "svymath/foundation/rtti.h"
#include "svymath/road/cross_section_slope.h"
#include "svyutils/svy_containers.h"
#include "svyutils/svy_string.h"

struct TXsTemplatePoint {
  svy_text::CSvyString name;
  double offset;
  double height;
  unsigned featureIndex;
};

class SVYMATH_API CCrossSectTemplate : public virtual CRttiBase {
  SVY_RTTI_DECLARE(CCrossSectTemplate)

 public:
  SVY_CLASS_NEW_DELETE

  explicit CCrossSectTemplate(const svy_text::CSvyString& name = {});
  CCrossSectTemplate(const CCrossSectTemplate& other);
  CCrossSectTemplate& operator=(const CCrossSectTemplate& other);
  ~CCrossSectTemplate() override;

  const svy_text::CSvyString& getName() const { return m_name; }
  // Adds a point at its place by offset (after points at the same offset, so that a vertical face is given
  // from its lower to its upper point or the reverse, as it is met walking to the right). False when the
  // offset or height is not a finite number.
  bool addPoint(const svy_text::CSvyString& name, double offset, double height, unsigned featureIndex = 0);
  void removeAllPoints() { m_points.clear(); }
  int getNumOfPoints() const { return static_cast<int>(m_points.size()); }
  const TXsTemplatePoint* getPoint(int index) const;
  // The first point with a name, or null.
  const TXsTemplatePoint* findPoint(const svy_text::CSvyString& name) const;

  void setSideSlopes(bool rightSide, double cutRunRise, double fillRunRise);
  double getCutRunRise(bool rightSide) const { return m_cutRunRise[rightSide ? 1 : 0]; }
  double getFillRunRise(bool rightSide) const { return m_fillRunRise[rightSide ? 1 : 0]; }

  // Adds the template's points to a section at a centre-line elevation (elevation = centre line + height).
  // False when the template has no points or the elevation is not a number.
  bool fillSection(double clElevation, CEditableRoadCrossSection& section) const;
  // The side slope of a section built from this template, hinged at the section's outermost point.
  CRoadCrossSectionSlope getSlope(const CRoadCrossSection& section, bool rightSide) const;

 private:
  svy_text::CSvyString m_name;
  svy_vector<TXsTemplatePoint> m_points;
  double m_cutRunRise[2];
  double m_fillRunRise[2];
};
