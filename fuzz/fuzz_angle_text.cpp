// Angle text: the DMS, DMM and decimal-degree readers and the packed DDD.MMSS check on any text, and the
// writers on any angle, each written text read back by its reader.
#include "fuzz_support.h"

#include "svymath/formats/angle_text.h"
#include "svymath/formats/dms_text.h"

#include <cmath>
#include <cstdlib>

namespace {

// A written angle reads back within half a unit of its last decimal; nine decimals of seconds at most.
constexpr double kSecondsPerDegree = 3600.0;
constexpr double kMinutesPerDegree = 60.0;
// Angles checked for the round trip: far beyond any azimuth, still well inside the writers' int range.
constexpr double kRoundTripLimit = 1e6;

using Writer = svy_text::CSvyString (*)(double, int);
using Reader = bool (*)(const svy_text::CSvyString&, double&);

void roundTrip(Writer write, Reader read, double degrees, int decimals, double unitsPerDegree) {
  const svy_text::CSvyString text = write(degrees, decimals);
  if (!std::isfinite(degrees) || std::fabs(degrees) > kRoundTripLimit) return;
  double back = 0.0;
  if (!read(text, back)) std::abort();
  const int kept = decimals < 0 ? 0 : std::min(decimals, 9);
  const double halfUnit = 0.5 * std::pow(10.0, -kept) / unitsPerDegree;
  if (std::fabs(back - degrees) > halfUnit * (1.0 + 1e-6) + 1e-12 * std::fabs(degrees)) std::abort();
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size) {
  FuzzedDataProvider data(bytes, size);
  const double degrees = svy_fuzz::rawDouble(data);
  const int decimals = data.ConsumeIntegralInRange(-2, 12);
  const bool allowMax = data.ConsumeBool();
  const std::string maxDegrees = data.ConsumeRandomLengthString(8);
  const svy_text::CSvyString text(data.ConsumeRemainingBytesAsString().c_str());

  double value = 0.0;
  svy_formats::ParseDMS(text, value);
  svy_formats::ParseDMM(text, value);
  svy_formats::ParseDegree(text, value);
  svy_formats::StringToDegree(text, value);
  svy_formats::is_str_degree(text);
  svy_formats::is_str_dmm(text);
  CheckValidDMSVal(text, svy_text::CSvyString(maxDegrees.c_str()), allowMax);

  roundTrip(svy_formats::DMSToString, svy_formats::ParseDMS, degrees, decimals, kSecondsPerDegree);
  roundTrip(svy_formats::DMMToString, svy_formats::ParseDMM, degrees, decimals, kMinutesPerDegree);
  roundTrip(svy_formats::DegreeToString, svy_formats::ParseDegree, degrees, decimals, 1.0);
  return 0;
}
