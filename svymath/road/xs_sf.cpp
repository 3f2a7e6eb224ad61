#include "svymath/road/xs_sf.h"

#include <algorithm>
#include <cmath>

#include "svymath/foundation/constants.h"

SVY_RTTI_DEFINE(CXsSf, CRttiBase)

namespace {

// The point of `other` matching point i of `from`: the same name, and as many points of that name before
// it (names repeat on the two sides of a template, and are met in the same order).
const TXsTemplatePoint* matchingPoint(const CCrossSectTemplate& from, int i, const CCrossSectTemplate& other) {
  const svy_text::CSvyString& name = from.getPoint(i)->name;
  int occurrence = 0;
  for (int k = 0; k < i; ++k) occurrence += from.getPoint(k)->name == name ? 1 : 0;
  for (int k = 0; k < other.getNumOfPoints(); ++k) {
    if (other.getPoint(k)->name == name && occurrence-- == 0) return other.getPoint(k);
  }
  return nullptr;
}

}  // namespace

CXsSf::CXsSf() = default;
CXsSf::CXsSf(const CXsSf& other) : CRttiBase(), m_entries(other.m_entries) {}
CXsSf& CXsSf::operator=(const CXsSf& other) {
  m_entries = other.m_entries;
  return *this;
}
CXsSf::~CXsSf() = default;

bool CXsSf::assignTemplate(double chainage, const CCrossSectTemplate& sectionTemplate) {
  if (!std::isfinite(chainage)) return false;
  auto place = std::lower_bound(m_entries.begin(), m_entries.end(), chainage - svy_math::tol::kSnap,
                                [](const TEntry& e, double c) { return e.chainage <= c; });
  if (place != m_entries.end() && std::fabs(place->chainage - chainage) < svy_math::tol::kSnap) {
    place->sectionTemplate = sectionTemplate;
  } else {
    m_entries.insert(place, TEntry{chainage, sectionTemplate});
  }
  return true;
}

bool CXsSf::removeAssignment(int index) {
  if (index < 0 || index >= getNumOfAssignments()) return false;
  m_entries.erase(m_entries.begin() + index);
  return true;
}

double CXsSf::getAssignmentChainage(int index) const {
  return index >= 0 && index < getNumOfAssignments() ? m_entries[static_cast<size_t>(index)].chainage
                                                     : svy_math::undefinedValue();
}

const CCrossSectTemplate* CXsSf::getTemplate(int index) const {
  return index >= 0 && index < getNumOfAssignments() ? &m_entries[static_cast<size_t>(index)].sectionTemplate : nullptr;
}

bool CXsSf::bracket(double chainage, const TEntry*& before, const TEntry*& after, double& t) const {
  if (m_entries.empty() || std::isnan(chainage)) return false;
  auto next = std::upper_bound(m_entries.begin(), m_entries.end(), chainage,
                               [](double c, const TEntry& e) { return c < e.chainage; });
  if (next == m_entries.begin() || next == m_entries.end()) {
    before = after = next == m_entries.begin() ? &m_entries.front() : &m_entries.back();
    t = 0.0;
    return true;
  }
  before = &*(next - 1);
  after = &*next;
  t = (chainage - before->chainage) / (after->chainage - before->chainage);
  return true;
}

// Hands sink(name, offset, height, featureIndex) each point in force at the chainage, in the earlier
// template's order.
template <typename Sink>
bool CXsSf::forEachPointAt(double chainage, Sink&& sink) const {
  const TEntry* before = nullptr;
  const TEntry* after = nullptr;
  double t = 0.0;
  if (!bracket(chainage, before, after, t)) return false;
  bool any = false;
  for (int i = 0; i < before->sectionTemplate.getNumOfPoints(); ++i) {
    const TXsTemplatePoint& p = *before->sectionTemplate.getPoint(i);
    const TXsTemplatePoint* q =
        before == after ? &p : matchingPoint(before->sectionTemplate, i, after->sectionTemplate);
    if (q == nullptr) continue;
    sink(p.name, p.offset + t * (q->offset - p.offset), p.height + t * (q->height - p.height), p.featureIndex);
    any = true;
  }
  return any;
}

bool CXsSf::getTemplateAtChainage(double chainage, CCrossSectTemplate& result) const {
  const TEntry* before = nullptr;
  const TEntry* after = nullptr;
  double t = 0.0;
  if (!bracket(chainage, before, after, t)) return false;
  double slopes[2][2];
  for (int side = 0; side < 2; ++side) getSideSlopesAtChainage(chainage, side == 1, slopes[side][0], slopes[side][1]);
  // The earlier template's name: the interpolated shape is a transition out of it.
  CCrossSectTemplate interpolated(before->sectionTemplate.getName());
  forEachPointAt(chainage, [&](const svy_text::CSvyString& name, double offset, double height, unsigned index) {
    interpolated.addPoint(name, offset, height, index);
  });
  for (int side = 0; side < 2; ++side) interpolated.setSideSlopes(side == 1, slopes[side][0], slopes[side][1]);
  result = interpolated;
  return true;
}

bool CXsSf::fillSection(double chainage, double clElevation, CEditableRoadCrossSection& section) const {
  if (!std::isfinite(clElevation)) return false;
  return forEachPointAt(chainage, [&](const svy_text::CSvyString& name, double offset, double height, unsigned index) {
    section.addPoint(offset, clElevation + height, name, index);
  });
}

bool CXsSf::getSideSlopesAtChainage(double chainage, bool rightSide, double& cutRunRise, double& fillRunRise) const {
  const TEntry* before = nullptr;
  const TEntry* after = nullptr;
  double t = 0.0;
  if (!bracket(chainage, before, after, t)) return false;
  const auto blend = [t](double a, double b) { return std::isnan(a) || std::isnan(b) ? a : a + t * (b - a); };
  cutRunRise = blend(before->sectionTemplate.getCutRunRise(rightSide), after->sectionTemplate.getCutRunRise(rightSide));
  fillRunRise =
      blend(before->sectionTemplate.getFillRunRise(rightSide), after->sectionTemplate.getFillRunRise(rightSide));
  return true;
}
