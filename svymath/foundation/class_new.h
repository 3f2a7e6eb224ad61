#pragma once
// Class-level operator new and delete (plain and placement, single and array) routed to the companion
// library's allocator. Put SVY_CLASS_NEW_DELETE in the public part of a class body.
#include <cstddef>

#include "svyutils/svy_alloc.h"

#define SVY_CLASS_NEW_DELETE                                                                  \
  static void* operator new(std::size_t size) { return svy_operator_new(size); }             \
  static void* operator new[](std::size_t size) { return svy_operator_new(size); }           \
  static void operator delete(void* block) noexcept { svy_operator_delete(block); }          \
  static void operator delete[](void* block) noexcept { svy_operator_delete(block); }        \
  static void* operator new(std::size_t, void* where) noexcept { return where; }             \
  static void* operator new[](std::size_t, void* where) noexcept { return where; }           \
  static void operator delete(void*, void*) noexcept {}                                       \
  static void operator delete[](void*, void*) noexcept {}
