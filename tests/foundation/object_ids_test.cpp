// Object ids: the set's algebra, the old-to-new map of a copied group, and numbered display names.
#include <gtest/gtest.h>

#include "svymath/foundation/object_ids.h"

namespace {

svy_vector<TObjId> idsOf(const TObjIds& ids) { return svy_vector<TObjId>(ids.begin(), ids.end()); }

TEST(ObjIds, SortedUniqueSetWithAlgebra) {
  TObjIds ids{7, 3, 9, 3, kNoObjId};
  EXPECT_EQ(idsOf(ids), (svy_vector<TObjId>{3, 7, 9}));
  EXPECT_FALSE(ids.insert(7));
  EXPECT_TRUE(ids.insert(5));
  EXPECT_TRUE(ids.erase(9));
  EXPECT_FALSE(ids.erase(9));
  EXPECT_TRUE(ids.contains(5));
  EXPECT_EQ(idsOf(TObjIds(ids).unite({1, 5, 11})), (svy_vector<TObjId>{1, 3, 5, 7, 11}));
  EXPECT_EQ(idsOf(TObjIds(ids).intersect({1, 5, 7})), (svy_vector<TObjId>{5, 7}));
  EXPECT_EQ(idsOf(TObjIds(ids).subtract({3})), (svy_vector<TObjId>{5, 7}));
  EXPECT_EQ(ids, TObjIds({7, 5, 3}));
}

// Copying objects 10, 11, 12 as 20, 21, 22: references inside the group follow the copies, the one to 99
// outside it keeps pointing at the original; the inverse maps back.
TEST(ObjId2ObjIdMap, RemapsAReferenceSetAndInvertsWhenOneToOne) {
  CObjId2ObjIdMap map;
  for (TObjId id : {12, 10, 11}) EXPECT_TRUE(map.add(id, id + 10));
  EXPECT_FALSE(map.add(10, 30));
  EXPECT_FALSE(map.add(kNoObjId, 5));
  TObjId found = 0;
  ASSERT_TRUE(map.lookup(11, found));
  EXPECT_EQ(found, 21u);
  EXPECT_FALSE(map.lookup(99, found));
  EXPECT_EQ(idsOf(map.remap(TObjIds{10, 12, 99})), (svy_vector<TObjId>{20, 22, 99}));
  CObjId2ObjIdMap back;
  ASSERT_TRUE(map.getInverse(back));
  for (const auto& pair : map) EXPECT_EQ(back.remap(pair.second), pair.first);
  EXPECT_TRUE(map.set(11, 22));
  EXPECT_FALSE(map.getInverse(back));
  EXPECT_TRUE(map.erase(11));
  EXPECT_EQ(map.size(), 2u);
}

TEST(ObjName, NextInANumberedSeries) {
  const struct { const wchar_t *name, *next; } cases[] = {
      {L"P009", L"P010"}, {L"7", L"8"}, {L"A99", L"A100"}, {L"Corner", L"Corner1"}, {L"", L"1"}, {L"X-0999", L"X-1000"}};
  for (const auto& c : cases) EXPECT_EQ(ObjName(c.name).getNext(), ObjName(c.next)) << ObjName(c.name).get().ToNarrow();
  EXPECT_EQ(ObjName(L"Fence").compareNoCase(ObjName(L"FENCE")), 0);
  EXPECT_NE(ObjName(L"Fence"), ObjName(L"FENCE"));
  EXPECT_LT(ObjName(L"A10"), ObjName(L"B1"));
}

}  // namespace
