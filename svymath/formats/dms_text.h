#pragma once
// Validation of packed DDD.MMSS angle text typed by a user: degrees, a point, two digits of minutes, two
// digits of seconds and optional further decimals of seconds ("45.3015", "359.5959", "-12.05").
#include "svymath/foundation/export.h"
#include "svyutils/svy_string.h"

// True when text is an acceptable DDD.MMSS value not above maxDegrees (degrees as text, e.g. "360").
// Commas count as decimal points, surrounding blanks and one leading '-' are ignored, and every other
// character must be a digit or the one point. Degrees are compared with maxDegrees as text right-aligned
// ("45" against "360" compares " 45"); degrees longer than maxDegrees are rejected. Minutes and seconds
// are the first two and the next two digits after the point, a single digit standing for its tens
// ("45.5" is 45 degrees 50 minutes), each at most 59. At exactly maxDegrees the text is rejected unless
// allowMax is true, and then minutes and seconds must be zero. Digits after the seconds are not checked.
// The check is on the form of the fields, not on their presence: "." and "-" pass.
SVYMATH_API bool CheckValidDMSVal(const svy_text::CSvyString& text, const svy_text::CSvyString& maxDegrees,
                                  bool allowMax);
