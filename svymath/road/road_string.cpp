#include "svymath/road/road_string.h"

#include <algorithm>
#include <cmath>

SVY_RTTI_DEFINE(CRoadString, CRttiBase)
SVY_RTTI_DEFINE(CRoadStringSet, CRttiBase)

CRoadString::CRoadString(const svy_text::CSvyString& name, unsigned featureIndex)
    : m_name(name), m_featureIndex(featureIndex) {}

CRoadString::CRoadString(const CRoadString& other)
    : CRttiBase(), m_name(other.m_name), m_featureIndex(other.m_featureIndex), m_vertices(other.m_vertices) {}

CRoadString& CRoadString::operator=(const CRoadString& other) {
  m_name = other.m_name;
  m_featureIndex = other.m_featureIndex;
  m_vertices = other.m_vertices;
  return *this;
}

CRoadString::~CRoadString() = default;

bool CRoadString::addVertex(double chainage, double offset, double height) {
  if (!std::isfinite(chainage) || !std::isfinite(offset) || !std::isfinite(height)) return false;
  if (!m_vertices.empty() && chainage < m_vertices.back().chainage) return false;
  m_vertices.push_back(TRoadStringVertex{chainage, offset, height});
  return true;
}

const TRoadStringVertex* CRoadString::getVertex(int index) const {
  return index >= 0 && index < getNumOfVertices() ? &m_vertices[static_cast<size_t>(index)] : nullptr;
}

bool CRoadString::getOffsetAndHeightAtChainage(double chainage, double& offset, double& height) const {
  if (m_vertices.empty() || !(chainage >= m_vertices.front().chainage && chainage <= m_vertices.back().chainage)) {
    return false;
  }
  // The first vertex beyond the chainage; the segment before it holds the chainage.
  auto next = std::upper_bound(m_vertices.begin(), m_vertices.end(), chainage,
                               [](double c, const TRoadStringVertex& v) { return c < v.chainage; });
  if (next == m_vertices.end()) {
    offset = m_vertices.back().offset;
    height = m_vertices.back().height;
    return true;
  }
  const TRoadStringVertex& a = *(next - 1);
  const TRoadStringVertex& b = *next;
  const double t = (chainage - a.chainage) / (b.chainage - a.chainage);
  offset = a.offset + t * (b.offset - a.offset);
  height = a.height + t * (b.height - a.height);
  return true;
}

CRoadStringSet::CRoadStringSet() = default;
CRoadStringSet::CRoadStringSet(const CRoadStringSet& other) : CRttiBase(), m_strings(other.m_strings) {}
CRoadStringSet& CRoadStringSet::operator=(const CRoadStringSet& other) {
  m_strings = other.m_strings;
  return *this;
}
CRoadStringSet::~CRoadStringSet() = default;

int CRoadStringSet::addString(const CRoadString& roadString) {
  m_strings.push_back(roadString);
  return getNumOfStrings() - 1;
}

const CRoadString* CRoadStringSet::getString(int index) const {
  return index >= 0 && index < getNumOfStrings() ? &m_strings[static_cast<size_t>(index)] : nullptr;
}

CRoadString* CRoadStringSet::getString(int index) {
  return index >= 0 && index < getNumOfStrings() ? &m_strings[static_cast<size_t>(index)] : nullptr;
}

CRoadString* CRoadStringSet::findString(const svy_text::CSvyString& name) {
  for (CRoadString& s : m_strings) {
    if (s.getName() == name) return &s;
  }
  return nullptr;
}

bool CRoadStringSet::fillSection(double chainage, CEditableRoadCrossSection& section) const {
  bool any = false;
  for (const CRoadString& s : m_strings) {
    double offset = 0.0;
    double height = 0.0;
    if (!s.getOffsetAndHeightAtChainage(chainage, offset, height)) continue;
    any = section.addPoint(offset, height, s.getName(), s.getFeatureIndex()) || any;
  }
  return any;
}
