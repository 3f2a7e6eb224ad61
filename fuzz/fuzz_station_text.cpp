// Station text: reading any text at any interval, and writing any chainage then reading it back.
#include "fuzz_support.h"

#include "svymath/formats/station_text.h"

#include <climits>
#include <cmath>
#include <cstdlib>

// Station text keeps two decimals of the remainder: a written station reads back within half a centimetre,
// plus the rounding of the text's arithmetic at large chainages.
constexpr double kTextResolution = 0.005;
constexpr double kRelativeSlack = 1e-12;
// Chainages checked for the round trip: a million kilometres is beyond any road.
constexpr double kRoundTripLimit = 1e9;

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size) {
  FuzzedDataProvider data(bytes, size);
  const double interval = svy_fuzz::rawDouble(data);
  const double chainage = svy_fuzz::rawDouble(data);
  const std::string text = data.ConsumeRemainingBytesAsString();

  double station = 0.0;
  StnFromString(svy_text::CSvyString(text.c_str()), station, interval);

  // Round trip where the count of intervals fits the text's 32-bit integer.
  if (interval == 0.0 || !std::isfinite(interval) || !std::isfinite(chainage)) return 0;
  const double count = std::trunc(chainage / interval);
  if (!(std::fabs(count) < static_cast<double>(INT_MAX))) {
    StnToString(chainage, interval);
    return 0;
  }
  double back = 0.0;
  const svy_text::CSvyString written = StnToString(chainage, interval);
  if (StnFromString(written, back, interval) != 1) std::abort();
  const double slack = kTextResolution + kRelativeSlack * (std::fabs(chainage) + std::fabs(interval));
  if (std::isfinite(back) && std::fabs(back - chainage) > slack && std::fabs(chainage) < kRoundTripLimit) std::abort();
  return 0;
}
