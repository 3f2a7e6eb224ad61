#include <gtest/gtest.h>

#include <algorithm>
#include <list>
#include <random>
#include <string>
#include <vector>

#include "svyutils/svy_containers.h"

namespace {

using svy_templ::CSvyArray;

// Random edits agree with a vector used as the model; edits outside the array fail and change nothing.
TEST(SvyArray, EditsLikeAVectorOverRandomOperations) {
  std::mt19937 random(3);
  std::uniform_int_distribution<int> op(0, 5);
  std::uniform_int_distribution<int> index(-2, 12);
  CSvyArray<std::string> array;
  std::vector<std::string> model;
  for (int step = 0; step < 4000; ++step) {
    const int i = index(random), size = static_cast<int>(model.size());
    const std::string item = "p" + std::to_string(step);
    const auto at = model.begin() + std::max(0, std::min(i, size));
    switch (op(random)) {
      case 0:
      case 1:
        EXPECT_EQ(array.Add(item), size);
        model.push_back(item);
        break;
      case 2:
        EXPECT_EQ(array.InsertAt(i, item, 2), i >= 0 && i <= size);
        if (i >= 0 && i <= size) model.insert(at, 2, item);
        break;
      case 3:
        EXPECT_EQ(array.RemoveAt(i, 2), i >= 0 && i + 2 <= size);
        if (i >= 0 && i + 2 <= size) model.erase(at, at + 2);
        break;
      case 4:
        EXPECT_EQ(array.SetAt(i, item), i >= 0 && i < size);
        if (i >= 0 && i < size) *at = item;
        break;
      default:
        if (size > 20) {
          array.RemoveAll();
          model.clear();
        }
    }
    ASSERT_EQ(array.GetSize(), static_cast<int>(model.size()));
  }
  for (int i = 0; i < array.GetSize(); ++i) EXPECT_EQ(array[i], model[static_cast<std::size_t>(i)]);
  // Grown elements are zero; Append returns the index of the first appended one; a negative size or count
  // empties or fails.
  CSvyArray<double> numbers, other;
  numbers.SetSize(3);
  numbers[1] = 1.5;
  other.Add(9.0);
  EXPECT_EQ(other.Append(numbers), 1);
  numbers.Copy(other);
  EXPECT_EQ(std::vector<double>(numbers.begin(), numbers.end()), (std::vector<double>{9.0, 0.0, 1.5, 0.0}));
  numbers.SetSize(-1);
  EXPECT_TRUE(numbers.IsEmpty());
  EXPECT_FALSE(numbers.InsertAt(0, 1.0, -1));
  EXPECT_FALSE(numbers.RemoveAt(0, -1));
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
