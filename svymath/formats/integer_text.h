#pragma once
// Integers in other bases: the bits of a mask as text, and the digits of a number written in one base
// re-read in another (as packed fields such as "1011" for a mask are often keyed in).
#include <cstdint>

#include "svymath/foundation/export.h"
#include "svyutils/svy_string.h"

namespace svy_formats {

// The bits of value, most significant first, zero-padded on the left to at least `width` digits and never
// cut: bin_to_str(5, 8) is "00000101", bin_to_str(5, 0) is "101", bin_to_str(0, 0) is "0". Widths beyond
// 64 count as 64. A negative int converts to its two's complement in 64 bits, so pass the unsigned type of
// the mask's own width (std::uint32_t(-1) gives 32 ones).
SVYMATH_API svy_text::CSvyString bin_to_str(std::uint64_t value, int width);

// Re-reads the decimal digits of value as the digits of a number in base fromBase and writes that number's
// digits in base toBase as the decimal digits of result: int_to_int(101, 2, 10, r) gives r = 5,
// int_to_int(5, 10, 2, r) gives r = 101, int_to_int(777, 8, 10, r) gives 511. The sign is carried over.
// Bases run from 2 to 10 (the digits must be decimal digits). Returns false, result untouched, for a base
// outside 2..10, a digit not below fromBase, or a result beyond the range of long long.
SVYMATH_API bool int_to_int(long long value, int fromBase, int toBase, long long& result);

}  // namespace svy_formats
