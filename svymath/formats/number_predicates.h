#pragma once
// Numbers typed by users: a decimal comma is accepted as the decimal point, blanks may surround the
// number, and anything else after it makes the text no number (see svy_formats::StringToDouble).
#include "svymath/foundation/export.h"
#include "svyutils/svy_string.h"

namespace svy_formats {

// Reads a user number; false (value untouched) when the text is no number.
SVYMATH_API bool String2Double(const svy_text::CSvyString& text, double& value);
// The user number, or the undefined value (NaN) when the text is no number.
SVYMATH_API double str_to_float(const svy_text::CSvyString& text);

// Whole numbers within the range of int, with an optional sign.
SVYMATH_API bool is_str_int(const svy_text::CSvyString& text);
// A user number, or a blank text (an optional field left empty).
SVYMATH_API bool is_str_double(const svy_text::CSvyString& text);
// A user number; blank text is rejected.
SVYMATH_API bool is_str_notempty_double(const svy_text::CSvyString& text);

}  // namespace svy_formats
