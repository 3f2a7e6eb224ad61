// Bearings: any azimuth (NaN, infinities, 1e300 included) and any count of decimals gives either no text
// (non-finite azimuths only) or a quadrant bearing "N|S dd°mm'ss\" E|W" with minutes and seconds below 60.
#include "fuzz_support.h"

#include "svymath/formats/bearing_text.h"

#include <cmath>
#include <cstdlib>
#include <cwchar>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size) {
  FuzzedDataProvider data(bytes, size);
  const double azimuth = svy_fuzz::rawDouble(data);
  const int decimals = data.ConsumeIntegral<int>();
  const std::string text = svy_formats::DegreeToBearing(azimuth, decimals).ToNarrow();
  if (text.empty() != !std::isfinite(azimuth)) std::abort();
  if (text.empty()) return 0;
  const char first = text.front();
  const char last = text.back();
  if ((first != 'N' && first != 'S') || (last != 'E' && last != 'W')) std::abort();
  // The fields after the degree sign (U+00B0, two bytes in UTF-8) and the minute mark.
  const std::size_t degreeSign = text.find("\xC2\xB0");
  const std::size_t minuteMark = text.find('\'');
  if (degreeSign == std::string::npos || minuteMark == std::string::npos) std::abort();
  const double degrees = std::atof(text.c_str() + 2);
  const double minutes = std::atof(text.c_str() + degreeSign + 2);
  const double seconds = std::atof(text.c_str() + minuteMark + 1);
  if (!(degrees >= 0.0 && degrees <= 90.0 && minutes < 60.0 && seconds < 60.0)) std::abort();
  return 0;
}
