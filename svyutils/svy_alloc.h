#pragma once
// The allocator behind every model class's operator new: plain heap blocks, so memory from it can be
// released by svy_operator_delete only. It throws std::bad_alloc when memory is exhausted, like new.
#include <cstddef>

#include "svyutils/svyutils_export.h"

SVYUTILS_API void* svy_operator_new(std::size_t size);
SVYUTILS_API void svy_operator_delete(void* block) noexcept;
