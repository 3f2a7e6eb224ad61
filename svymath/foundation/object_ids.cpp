#include "svymath/foundation/object_ids.h"

#include <algorithm>
#include <iterator>

TObjIds::TObjIds(std::initializer_list<TObjId> ids) {
  for (TObjId id : ids) insert(id);
}

bool TObjIds::insert(TObjId id) {
  if (id == kNoObjId) return false;
  const auto at = std::lower_bound(m_ids.begin(), m_ids.end(), id);
  if (at != m_ids.end() && *at == id) return false;
  m_ids.insert(at, id);
  return true;
}

bool TObjIds::erase(TObjId id) {
  const auto at = std::lower_bound(m_ids.begin(), m_ids.end(), id);
  if (at == m_ids.end() || *at != id) return false;
  m_ids.erase(at);
  return true;
}

bool TObjIds::contains(TObjId id) const { return std::binary_search(m_ids.begin(), m_ids.end(), id); }

TObjIds& TObjIds::unite(const TObjIds& other) {
  svy_vector<TObjId> merged;
  merged.reserve(m_ids.size() + other.m_ids.size());
  std::set_union(m_ids.begin(), m_ids.end(), other.m_ids.begin(), other.m_ids.end(), std::back_inserter(merged));
  m_ids.swap(merged);
  return *this;
}

TObjIds& TObjIds::intersect(const TObjIds& other) {
  svy_vector<TObjId> common;
  std::set_intersection(m_ids.begin(), m_ids.end(), other.m_ids.begin(), other.m_ids.end(), std::back_inserter(common));
  m_ids.swap(common);
  return *this;
}

TObjIds& TObjIds::subtract(const TObjIds& other) {
  svy_vector<TObjId> rest;
  std::set_difference(m_ids.begin(), m_ids.end(), other.m_ids.begin(), other.m_ids.end(), std::back_inserter(rest));
  m_ids.swap(rest);
  return *this;
}

namespace {

// The first pair whose old id is not below oldId (const or mutable pairs alike).
template <class Pairs>
auto lowerBound(Pairs& pairs, TObjId oldId) {
  return std::lower_bound(pairs.begin(), pairs.end(), oldId,
                          [](const CObjId2ObjIdMap::TPair& pair, TObjId id) { return pair.first < id; });
}

}  // namespace

bool CObjId2ObjIdMap::add(TObjId oldId, TObjId newId) {
  if (oldId == kNoObjId || newId == kNoObjId) return false;
  const auto at = lowerBound(m_pairs, oldId);
  if (at != m_pairs.end() && at->first == oldId) return false;
  m_pairs.insert(at, TPair(oldId, newId));
  return true;
}

bool CObjId2ObjIdMap::set(TObjId oldId, TObjId newId) {
  if (oldId == kNoObjId || newId == kNoObjId) return false;
  const auto at = lowerBound(m_pairs, oldId);
  if (at != m_pairs.end() && at->first == oldId)
    at->second = newId;
  else
    m_pairs.insert(at, TPair(oldId, newId));
  return true;
}

bool CObjId2ObjIdMap::erase(TObjId oldId) {
  const auto at = lowerBound(m_pairs, oldId);
  if (at == m_pairs.end() || at->first != oldId) return false;
  m_pairs.erase(at);
  return true;
}

bool CObjId2ObjIdMap::lookup(TObjId oldId, TObjId& newId) const {
  const auto at = lowerBound(m_pairs, oldId);
  if (at == m_pairs.end() || at->first != oldId) return false;
  newId = at->second;
  return true;
}

bool CObjId2ObjIdMap::contains(TObjId oldId) const {
  TObjId ignored = kNoObjId;
  return lookup(oldId, ignored);
}

TObjId CObjId2ObjIdMap::remap(TObjId id) const {
  TObjId mapped = id;
  lookup(id, mapped);
  return mapped;
}

TObjIds CObjId2ObjIdMap::remap(const TObjIds& ids) const {
  TObjIds out;
  for (TObjId id : ids) out.insert(remap(id));
  return out;
}

bool CObjId2ObjIdMap::getInverse(CObjId2ObjIdMap& inverse) const {
  CObjId2ObjIdMap out;
  for (const TPair& pair : m_pairs)
    if (!out.add(pair.second, pair.first)) return false;
  inverse = std::move(out);
  return true;
}

ObjName ObjName::getNext() const {
  const std::wstring& text = m_name.str();
  std::size_t digitsStart = text.size();
  while (digitsStart > 0 && text[digitsStart - 1] >= L'0' && text[digitsStart - 1] <= L'9') --digitsStart;
  if (digitsStart == text.size()) return ObjName(svy_text::CSvyStringT<wchar_t>(text + L"1"));
  // Count up in the text itself, so that numbers of any length and their zero padding survive.
  std::wstring next = text;
  std::size_t i = next.size();
  while (i > digitsStart && next[i - 1] == L'9') next[--i] = L'0';
  if (i > digitsStart)
    ++next[i - 1];
  else
    next.insert(digitsStart, 1, L'1');
  return ObjName(svy_text::CSvyStringT<wchar_t>(next));
}
