#include "svyutils/svy_alloc.h"

#include <new>

void* svy_operator_new(std::size_t size) { return ::operator new(size == 0 ? 1 : size); }

void svy_operator_delete(void* block) noexcept { ::operator delete(block); }
