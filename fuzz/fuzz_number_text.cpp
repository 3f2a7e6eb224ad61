// Number text and rounding: the locale-independent readers and the user-number predicates on any text,
// the fixed-point writer and round_prec on any double, each written number read back.
#include "fuzz_support.h"

#include "svymath/formats/number_predicates.h"
#include "svymath/formats/round_double.h"
#include "svyutils/round_prec.h"
#include "svyutils/svy_number_text.h"

#include <cmath>
#include <cstdlib>

namespace {
// Above this, rounding to a large power of ten may carry past the largest double.
constexpr double kNearLargestDouble = 1e307;
}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size) {
  FuzzedDataProvider data(bytes, size);
  const double number = svy_fuzz::rawDouble(data);
  const int decimals = data.ConsumeIntegralInRange(-400, 400);
  svy_text::CSvyString text(data.ConsumeRemainingBytesAsString().c_str());

  int whole = 0;
  double value = 0.0;
  svy_formats::StringToInt(text, whole);
  // A successful parse is always finite.
  if (svy_formats::StringToDouble(text, value) && !std::isfinite(value)) std::abort();
  if (svy_formats::String2Double(text, value) && !std::isfinite(value)) std::abort();
  svy_formats::str_to_float(text);
  svy_formats::is_str_int(text);
  svy_formats::is_str_double(text);
  svy_formats::is_str_notempty_double(text);
  svy_formats::ReplaceCommasWithDecPt(text);

  // Rounding is idempotent, and the text of a rounded finite number reads back to a finite number.
  const double rounded = svy::math::round_prec(number, decimals);
  if (std::isfinite(number) != std::isfinite(rounded)) std::abort();
  if (std::isfinite(rounded) && svy::math::round_prec(rounded, decimals) != rounded) std::abort();
  svy_formats::RoundDouble(number, decimals);
  const svy_text::CSvyString written = svy_formats::DoubleToString(number, decimals);
  double back = 0.0;
  // Rounding to a power of ten can carry a number within one unit of that power of the largest double past
  // it (1.79769e308 to 10^304 is 1.7977e308): that text is written, but no double reads it back.
  const bool carriesPastLargest = std::fabs(number) > kNearLargestDouble;
  if (std::isfinite(number) && !carriesPastLargest && !svy_formats::StringToDouble(written, back)) std::abort();
  return 0;
}
