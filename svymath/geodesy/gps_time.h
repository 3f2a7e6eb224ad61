#pragma once
// GPS time: week number and seconds of week against calendar date and time of day.
//
// All conversions go through a day count on the Modified Julian Date (MJD) scale. The GPS epoch,
// 6 January 1980 00:00:00, is MJD 44244; 1 January 1901 is MJD 15385. Every year divisible by 4 is
// taken as a leap year, which is the Gregorian rule between 1901 and 2099: the functions are valid for
// dates from 1901-01-01 to 2099-12-31. No time zone and no leap seconds are applied (GPS time is a
// continuous scale; a caller that holds UTC adds the GPS-UTC offset itself).
//
// Dates and times are not validated: a day 0 or 32, an hour of 25 or a year outside the valid range gives a
// meaningless result. Only inputs that would leave the arithmetic undefined are refused: a month outside
// 1..12 gives NaN seconds of week (and day of year 0, as does a day beyond the int range); a GPS time that is not finite or falls before 1901
// gives zero calendar fields and NaN seconds; a week number beyond 32 bits gives week 0 and NaN seconds.
// Before the epoch the week is truncated toward zero, so the seconds of week are negative there.
#include "svymath/foundation/export.h"

namespace svy_math {

// Calendar date and time of day (seconds may carry a fraction) to GPS week and seconds of week [s].
SVYMATH_API void ymdhms_to_gps(int year, int month, int day, int hour, int minute, double second, int* week,
                               double* secondsOfWeek);
// The same with the date given as a day of the year (1 January is day 1).
SVYMATH_API void ydhms_to_gps(int year, int dayOfYear, int hour, int minute, double second, int* week,
                              double* secondsOfWeek);
// GPS week and seconds of week [s] to calendar date and time of day.
SVYMATH_API void gps_to_ymdhms(int week, double secondsOfWeek, int* year, int* month, int* day, int* hour,
                               int* minute, double* second);
// GPS week and seconds of week [s] to year, day of the year and time of day.
SVYMATH_API void gps_to_ydhms(int week, double secondsOfWeek, int* year, int* dayOfYear, int* hour,
                              int* minute, double* second);
// Day of the year (1 January is day 1) of a calendar date.
SVYMATH_API void mday_to_yday(int year, int month, int day, int* dayOfYear);

}  // namespace svy_math

using svy_math::gps_to_ydhms;
using svy_math::gps_to_ymdhms;
using svy_math::mday_to_yday;
using svy_math::ydhms_to_gps;
using svy_math::ymdhms_to_gps;
