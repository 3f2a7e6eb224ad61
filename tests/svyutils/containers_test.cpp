#include <gtest/gtest.h>

#include <list>
#include <random>
#include <string>
#include <vector>

#include "svyutils/svy_containers.h"

namespace {

using svy_templ::CSvyArray;

TEST(SvyArray, EditsLikeAVectorOverRandomOperations) {
  std::mt19937 random(3);
  std::uniform_int_distribution<int> op(0, 5);
  std::uniform_int_distribution<int> index(-2, 12);
  CSvyArray<std::string> array;
  std::vector<std::string> model;
  for (int step = 0; step < 4000; ++step) {
    const int i = index(random);
    const std::string item = "p" + std::to_string(step);
    const bool inside = i >= 0 && i < static_cast<int>(model.size());
    switch (op(random)) {
      case 0:
      case 1:
        EXPECT_EQ(array.Add(item), static_cast<int>(model.size()));
        model.push_back(item);
        break;
      case 2: {
        const bool ok = i >= 0 && i <= static_cast<int>(model.size());
        EXPECT_EQ(array.InsertAt(i, item, 2), ok);
        if (ok) model.insert(model.begin() + i, 2, item);
        break;
      }
      case 3: {
        const bool ok = i >= 0 && i + 2 <= static_cast<int>(model.size());
        EXPECT_EQ(array.RemoveAt(i, 2), ok);
        if (ok) model.erase(model.begin() + i, model.begin() + i + 2);
        break;
      }
      case 4:
        EXPECT_EQ(array.SetAt(i, item), inside);
        if (inside) model[static_cast<std::size_t>(i)] = item;
        break;
      default:
        if (model.size() > 20) {
          array.RemoveAll();
          model.clear();
        }
        break;
    }
    ASSERT_EQ(array.GetSize(), static_cast<int>(model.size()));
  }
  for (int i = 0; i < array.GetSize(); ++i) EXPECT_EQ(array[i], model[static_cast<std::size_t>(i)]);
}

TEST(SvyArray, SizesAppendsAndCopies) {
  CSvyArray<double> array;
  EXPECT_TRUE(array.IsEmpty());
  EXPECT_EQ(array.GetUpperBound(), -1);
  array.SetSize(3);
  EXPECT_EQ(array.GetAt(2), 0.0);
  array[1] = 1.5;
  array.ElementAt(2) = 2.5;
  CSvyArray<double> other;
  other.Add(9.0);
  EXPECT_EQ(other.Append(array), 1);
  EXPECT_EQ(other.GetCount(), 4);
  EXPECT_EQ(other.GetData()[3], 2.5);
  array.Copy(other);
  double sum = 0.0;
  for (double v : array) sum += v;
  EXPECT_EQ(sum, 13.0);
  array.SetSize(-1);
  EXPECT_TRUE(array.IsEmpty());
  EXPECT_FALSE(array.InsertAt(0, 1.0, -1));
  EXPECT_FALSE(array.RemoveAt(0, -1));
}

TEST(SvyContainers, AllocatorServesVectorsAndLists) {
  svy_vector<std::string> names;
  for (int i = 0; i < 1000; ++i) names.push_back(std::string(40, static_cast<char>('a' + i % 26)));
  names.erase(names.begin(), names.begin() + 500);
  EXPECT_EQ(names.size(), 500U);
  EXPECT_EQ(names.front()[0], 'a' + 500 % 26);

  svy_list<int> chain{3, 1, 2};
  chain.sort();  // list nodes are a rebound allocator of the element allocator
  EXPECT_EQ(std::vector<int>(chain.begin(), chain.end()), (std::vector<int>{1, 2, 3}));
  svy_list<int> other;
  other.splice(other.end(), chain);  // splicing needs equal allocators
  EXPECT_TRUE(chain.empty());
  EXPECT_EQ(other.size(), 3U);

  EXPECT_TRUE(svy_mem::svy_dl_allocator<int>() == svy_mem::svy_dl_allocator<double>());
  svy_mem::svy_dl_allocator<double> allocator;
  EXPECT_THROW(allocator.allocate(static_cast<std::size_t>(-1) / 4), std::bad_array_new_length);
}

}  // namespace
