#include <gtest/gtest.h>

#include <algorithm>
#include <list>
#include <random>
#include <string>
#include <vector>

#include "svyutils/svy_containers.h"

namespace {

// Random edits agree with a vector used as the model; edits outside the array fail and change nothing.
TEST(SvyArray, EditsLikeAVectorOverRandomOperations) {
  std::mt19937 random(3);
  std::uniform_int_distribution<int> op(0, 5), index(-2, 12);
  svy_templ::CSvyArray<std::string> array;
  std::vector<std::string> model;
  for (int step = 0; step < 4000; ++step) {
    const int i = index(random), size = static_cast<int>(model.size());
    const std::string item = "p" + std::to_string(step);
    const auto at = model.begin() + std::max(0, std::min(i, size));
    const int choice = op(random);
    const bool inserts = i >= 0 && i <= size, removes = i >= 0 && i + 2 <= size, sets = i >= 0 && i < size;
    if (choice <= 1) {
      EXPECT_EQ(array.Add(item), size);
      model.push_back(item);
    } else if (choice == 2) {
      EXPECT_EQ(array.InsertAt(i, item, 2), inserts);
      if (inserts) model.insert(at, 2, item);
    } else if (choice == 3) {
      EXPECT_EQ(array.RemoveAt(i, 2), removes);
      if (removes) model.erase(at, at + 2);
    } else if (choice == 4) {
      EXPECT_EQ(array.SetAt(i, item), sets);
      if (sets) *at = item;
    } else if (size > 20) {
      array.RemoveAll();
      model.clear();
    }
    ASSERT_EQ(array.GetSize(), static_cast<int>(model.size()));
  }
  for (int i = 0; i < array.GetSize(); ++i) EXPECT_EQ(array[i], model[static_cast<std::size_t>(i)]);
  // Grown elements are zero; Append returns the index of the first appended one; a negative size or count
  // empties or fails.
  svy_templ::CSvyArray<double> numbers, other;
  numbers.SetSize(3);
  numbers[1] = 1.5;
  other.Add(9.0);
  EXPECT_EQ(other.Append(numbers), 1);
  numbers.Copy(other);
  EXPECT_EQ(std::vector<double>(numbers.begin(), numbers.end()), (std::vector<double>{9.0, 0.0, 1.5, 0.0}));
  numbers.SetSize(-1);
  EXPECT_TRUE(numbers.IsEmpty() && !numbers.InsertAt(0, 1.0, -1) && !numbers.RemoveAt(0, -1));
}

// Vectors and lists (whose nodes use a rebound allocator, equal for splicing) are served; absurd sizes throw.
TEST(SvyContainers, AllocatorServesVectorsAndLists) {
  svy_vector<std::string> names;
  for (int i = 0; i < 1000; ++i) names.push_back(std::string(40, static_cast<char>('a' + i % 26)));
  names.erase(names.begin(), names.begin() + 500);
  EXPECT_TRUE(names.size() == 500U && names.front()[0] == 'a' + 500 % 26);
  svy_list<int> chain{3, 1, 2}, other;
  chain.sort();
  other.splice(other.end(), chain);
  EXPECT_TRUE(chain.empty());
  EXPECT_EQ(std::vector<int>(other.begin(), other.end()), (std::vector<int>{1, 2, 3}));
  EXPECT_TRUE(svy_mem::svy_dl_allocator<int>() == svy_mem::svy_dl_allocator<double>());
  EXPECT_THROW(svy_mem::svy_dl_allocator<double>().allocate(static_cast<std::size_t>(-1) / 4),
               std::bad_array_new_length);
}

}  // namespace
