#pragma once
// Containers whose memory comes from the library's allocator (svy_operator_new), so that blocks
// allocated inside the library are released by it.
#include <cassert>
#include <cstddef>
#include <list>
#include <new>
#include <vector>

#include "svyutils/svy_alloc.h"

namespace svy_mem {

// A standard allocator over svy_operator_new. Stateless: all instances compare equal.
template <class T>
class svy_dl_allocator {
  static_assert(alignof(T) <= __STDCPP_DEFAULT_NEW_ALIGNMENT__,
                "svy_operator_new gives the default new alignment only");

 public:
  using value_type = T;

  svy_dl_allocator() noexcept = default;
  template <class U>
  svy_dl_allocator(const svy_dl_allocator<U>&) noexcept {}  // NOLINT(google-explicit-constructor)

  T* allocate(std::size_t count) {
    if (count > static_cast<std::size_t>(-1) / sizeof(T)) throw std::bad_array_new_length();
    return static_cast<T*>(svy_operator_new(count * sizeof(T)));
  }
  void deallocate(T* block, std::size_t) noexcept { svy_operator_delete(block); }
};

template <class T, class U>
bool operator==(const svy_dl_allocator<T>&, const svy_dl_allocator<U>&) noexcept {
  return true;
}
template <class T, class U>
bool operator!=(const svy_dl_allocator<T>&, const svy_dl_allocator<U>&) noexcept {
  return false;
}

}  // namespace svy_mem

// A contiguous array and a doubly linked list with the library's allocator.
template <class T>
using svy_vector = std::vector<T, svy_mem::svy_dl_allocator<T>>;
template <class T>
using svy_list = std::list<T, svy_mem::svy_dl_allocator<T>>;

namespace svy_templ {

// A small growable array with int indices. Reading with GetAt or operator[] needs an index inside
// [0, GetSize()) (checked by assert in debug builds, like std::vector); the editing methods check their
// index and report an index outside the array by returning false instead of touching memory.
template <class T>
class CSvyArray {
 public:
  CSvyArray() = default;

  int GetSize() const { return static_cast<int>(items_.size()); }
  int GetCount() const { return GetSize(); }
  int GetUpperBound() const { return GetSize() - 1; }
  bool IsEmpty() const { return items_.empty(); }

  // Resizes to newSize elements (new ones value-initialised); a negative size empties the array.
  void SetSize(int newSize) { items_.resize(newSize > 0 ? static_cast<std::size_t>(newSize) : 0U); }

  const T& GetAt(int index) const { return items_[checked(index)]; }
  T& ElementAt(int index) { return items_[checked(index)]; }
  const T& operator[](int index) const { return items_[checked(index)]; }
  T& operator[](int index) { return items_[checked(index)]; }
  const T* GetData() const { return items_.data(); }
  T* GetData() { return items_.data(); }

  bool SetAt(int index, const T& item) {
    if (!inside(index)) return false;
    items_[static_cast<std::size_t>(index)] = item;
    return true;
  }
  // Appends item and returns its index.
  int Add(const T& item) {
    items_.push_back(item);
    return GetSize() - 1;
  }
  // Appends every element of other and returns the index of the first one appended.
  int Append(const CSvyArray& other) {
    const int first = GetSize();
    items_.insert(items_.end(), other.items_.begin(), other.items_.end());
    return first;
  }
  void Copy(const CSvyArray& other) { items_ = other.items_; }
  // Inserts count copies of item before index; index == GetSize() appends.
  bool InsertAt(int index, const T& item, int count = 1) {
    if (index < 0 || index > GetSize() || count < 0) return false;
    items_.insert(items_.begin() + index, static_cast<std::size_t>(count), item);
    return true;
  }
  // Removes count elements from index; the whole range must lie inside the array.
  bool RemoveAt(int index, int count = 1) {
    if (index < 0 || count < 0 || index > GetSize() - count) return false;
    items_.erase(items_.begin() + index, items_.begin() + index + count);
    return true;
  }
  void RemoveAll() { items_.clear(); }

  auto begin() { return items_.begin(); }
  auto end() { return items_.end(); }
  auto begin() const { return items_.begin(); }
  auto end() const { return items_.end(); }

 private:
  bool inside(int index) const { return index >= 0 && index < GetSize(); }
  std::size_t checked(int index) const {
    assert(inside(index));
    return static_cast<std::size_t>(index);
  }

  svy_vector<T> items_;
};

}  // namespace svy_templ
