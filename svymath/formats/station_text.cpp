#include "svymath/formats/station_text.h"

#include <climits>
#include <cwchar>

#include "svyutils/svy_number_text.h"

namespace {

// Beyond these quotients the interval count does not fit a 32-bit int.
constexpr double kIntCountUpperLimit = 2147483648.0;
constexpr double kIntCountLowerLimit = -2147483649.0;

// The whole intervals in a quotient, truncated toward zero; INT_MIN for NaN or an out-of-range value.
int truncatedIntervalCount(double quotient) {
  if (!(quotient > kIntCountLowerLimit && quotient < kIntCountUpperLimit)) return INT_MIN;
  return static_cast<int>(quotient);
}

}  // namespace

svy_text::CSvyString StnToString(double station, double interval) {
  const int count = truncatedIntervalCount(station / interval);
  const double remainder = station - count * interval;
  svy_text::CSvyString text;
  text.Format(L"%d+%.2f", count, remainder);
  return text;
}

int StnFromString(const svy_text::CSvyString& text, double& station, double interval) {
  svy_text::CSvyString work(text);
  svy_formats::ReplaceCommasWithDecPt(work);
  const svy_formats::CScopedCLocale cLocale;
  if (work.Find(L'+') < 0) return std::swscanf(work.c_str(), L"%lf", &station) == 1 ? 1 : 0;
  int count = 0;
  double remainder = 0.0;
  if (std::swscanf(work.c_str(), L"%d+%lf", &count, &remainder) != 2) return 0;
  station = count * interval + remainder;
  return 1;
}
