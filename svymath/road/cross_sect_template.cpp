#include "svymath/road/cross_sect_template.h"

#include <cmath>

#include "svymath/foundation/constants.h"

SVY_RTTI_DEFINE(CCrossSectTemplate, CRttiBase)

CCrossSectTemplate::CCrossSectTemplate(const svy_text::CSvyString& name)
    : m_name(name),
      m_cutRunRise{svy_math::undefinedValue(), svy_math::undefinedValue()},
      m_fillRunRise{svy_math::undefinedValue(), svy_math::undefinedValue()} {}

CCrossSectTemplate::CCrossSectTemplate(const CCrossSectTemplate& other)
    : CRttiBase(),
      m_name(other.m_name),
      m_points(other.m_points),
      m_cutRunRise{other.m_cutRunRise[0], other.m_cutRunRise[1]},
      m_fillRunRise{other.m_fillRunRise[0], other.m_fillRunRise[1]} {}

CCrossSectTemplate& CCrossSectTemplate::operator=(const CCrossSectTemplate& other) {
  m_name = other.m_name;
  m_points = other.m_points;
  for (int side = 0; side < 2; ++side) {
    m_cutRunRise[side] = other.m_cutRunRise[side];
    m_fillRunRise[side] = other.m_fillRunRise[side];
  }
  return *this;
}

CCrossSectTemplate::~CCrossSectTemplate() = default;

bool CCrossSectTemplate::addPoint(const svy_text::CSvyString& name, double offset, double height,
                                  unsigned featureIndex) {
  if (!std::isfinite(offset) || !std::isfinite(height)) return false;
  auto place = m_points.end();
  while (place != m_points.begin() && (place - 1)->offset > offset) --place;
  m_points.insert(place, TXsTemplatePoint{name, offset, height, featureIndex});
  return true;
}

const TXsTemplatePoint* CCrossSectTemplate::getPoint(int index) const {
  return index >= 0 && index < getNumOfPoints() ? &m_points[static_cast<size_t>(index)] : nullptr;
}

const TXsTemplatePoint* CCrossSectTemplate::findPoint(const svy_text::CSvyString& name) const {
  for (const TXsTemplatePoint& p : m_points) {
    if (p.name == name) return &p;
  }
  return nullptr;
}

void CCrossSectTemplate::setSideSlopes(bool rightSide, double cutRunRise, double fillRunRise) {
  m_cutRunRise[rightSide ? 1 : 0] = cutRunRise;
  m_fillRunRise[rightSide ? 1 : 0] = fillRunRise;
}

bool CCrossSectTemplate::fillSection(double clElevation, CEditableRoadCrossSection& section) const {
  if (m_points.empty() || std::isnan(clElevation)) return false;
  for (const TXsTemplatePoint& p : m_points) section.addPoint(p.offset, clElevation + p.height, p.name, p.featureIndex);
  return true;
}

CRoadCrossSectionSlope CCrossSectTemplate::getSlope(const CRoadCrossSection& section, bool rightSide) const {
  return CRoadCrossSectionSlope(section, rightSide, getCutRunRise(rightSide), getFillRunRise(rightSide));
}
