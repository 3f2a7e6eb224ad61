#pragma once
// Object identifiers of the host's model: a set of ids, an old-to-new id map (as when a group of objects
// is copied and the references inside the group must follow the copies), and an object's display name.
// Small value types: copyable, comparable, with the container behaviour of the standard library (sorted,
// unique ids; iteration in increasing order). Nothing here throws except the allocator running out of
// memory.
#include <cstddef>
#include <cstdint>
#include <initializer_list>
#include <utility>

#include "svymath/foundation/class_new.h"
#include "svymath/foundation/export.h"
#include "svyutils/svy_containers.h"
#include "svyutils/svy_string.h"

// An object identifier; 0 is no object.
using TObjId = std::uint64_t;
constexpr TObjId kNoObjId = 0;

// A set of object ids, kept sorted and without repeats.
class SVYMATH_API TObjIds {
 public:
  SVY_CLASS_NEW_DELETE
  using const_iterator = svy_vector<TObjId>::const_iterator;

  TObjIds() = default;
  TObjIds(std::initializer_list<TObjId> ids);

  // Adds the id; false when it was already there. kNoObjId is never added.
  bool insert(TObjId id);
  // Removes the id; false when it was not there.
  bool erase(TObjId id);
  bool contains(TObjId id) const;
  std::size_t size() const { return m_ids.size(); }
  bool empty() const { return m_ids.empty(); }
  void clear() { m_ids.clear(); }
  const_iterator begin() const { return m_ids.begin(); }
  const_iterator end() const { return m_ids.end(); }

  // Set algebra in place: every id of either set; only the ids of both; the ids not in other.
  TObjIds& unite(const TObjIds& other);
  TObjIds& intersect(const TObjIds& other);
  TObjIds& subtract(const TObjIds& other);

  bool operator==(const TObjIds& other) const { return m_ids == other.m_ids; }
  bool operator!=(const TObjIds& other) const { return m_ids != other.m_ids; }

 private:
  svy_vector<TObjId> m_ids;
};

// Old ids mapped to new ones, each old id at most once.
class SVYMATH_API CObjId2ObjIdMap {
 public:
  SVY_CLASS_NEW_DELETE
  using TPair = std::pair<TObjId, TObjId>;  // (old, new)
  using const_iterator = svy_vector<TPair>::const_iterator;

  // Maps oldId to newId; false (the map unchanged) when oldId is already mapped or either id is kNoObjId.
  bool add(TObjId oldId, TObjId newId);
  // Maps oldId to newId, replacing an earlier mapping; false when either id is kNoObjId.
  bool set(TObjId oldId, TObjId newId);
  bool erase(TObjId oldId);
  // The new id of oldId; false (newId untouched) when it is not mapped.
  bool lookup(TObjId oldId, TObjId& newId) const;
  bool contains(TObjId oldId) const;
  // The new id of a mapped id, the id itself otherwise: a reference to an object outside the copied group
  // keeps pointing at the original.
  TObjId remap(TObjId id) const;
  // Every id of the set remapped (the result is again sorted and unique).
  TObjIds remap(const TObjIds& ids) const;
  // The map from the new ids back to the old ones; false (out untouched) when two old ids share a new one.
  bool getInverse(CObjId2ObjIdMap& inverse) const;

  std::size_t size() const { return m_pairs.size(); }
  bool empty() const { return m_pairs.empty(); }
  void clear() { m_pairs.clear(); }
  // The pairs in increasing order of the old id.
  const_iterator begin() const { return m_pairs.begin(); }
  const_iterator end() const { return m_pairs.end(); }

  bool operator==(const CObjId2ObjIdMap& other) const { return m_pairs == other.m_pairs; }
  bool operator!=(const CObjId2ObjIdMap& other) const { return m_pairs != other.m_pairs; }

 private:
  svy_vector<TPair> m_pairs;  // sorted by old id
};

// The display name of an object, e.g. "P101" or "Boundary 7".
class SVYMATH_API ObjName {
 public:
  SVY_CLASS_NEW_DELETE

  ObjName() = default;
  ObjName(const wchar_t* name) : m_name(name) {}                    // NOLINT(google-explicit-constructor)
  ObjName(const svy_text::CSvyStringT<wchar_t>& name) : m_name(name) {}  // NOLINT(google-explicit-constructor)

  const svy_text::CSvyStringT<wchar_t>& get() const { return m_name; }
  void set(const svy_text::CSvyStringT<wchar_t>& name) { m_name = name; }
  bool isEmpty() const { return m_name.IsEmpty(); }

  // The name that follows in a numbered series, as when points are copied or staked one after another:
  // the number at the end of the name counts up, keeping its zero padding ("P009" -> "P010", "7" -> "8",
  // "A99" -> "A100"); a name without a final number gets "1" appended ("Corner" -> "Corner1").
  ObjName getNext() const;

  // Exact comparison (case sensitive), and the ordering by character code.
  bool operator==(const ObjName& other) const { return m_name.str() == other.m_name.str(); }
  bool operator!=(const ObjName& other) const { return !(*this == other); }
  bool operator<(const ObjName& other) const { return m_name.str() < other.m_name.str(); }
  // Comparison ignoring case: negative, 0 or positive.
  int compareNoCase(const ObjName& other) const { return m_name.CompareNoCase(other.m_name.c_str()); }

 private:
  svy_text::CSvyStringT<wchar_t> m_name;
};
