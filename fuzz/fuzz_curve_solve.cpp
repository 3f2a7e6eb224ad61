// svy curve solve: the radius (or a degree of curve) and one more quantity, as option text the command
// parses, then the curve formulas it calls, also with raw doubles (NaN, infinities, 1e300).
#include "fuzz_support.h"

#include "row_io.h"
#include "svymath/curves/curve_formulas.h"

#include <cmath>
#include <cstdlib>

namespace {

const char* const kRadiusOptions[] = {"--radius", "--deg-arc", "--deg-chord"};
const char* const kQuantityOptions[] = {"--delta",   "--length",   "--chord",
                                        "--tangent", "--external", "--mid-ordinate"};

// Every formula the command chains, from either side; none may trap, whatever the numbers.
void allFormulas(double value, double radius) {
  const double deltas[] = {value, GetDeltaFromLength(value, radius), GetDeltaFromChordLength(value, radius),
                           GetDeltaFromTangent(value, radius), GetDeltaFromExternal(value, radius),
                           GetDeltaFromMidOrd(value, radius)};
  for (const double delta : deltas) {
    GetLengthFromDelta(delta, radius);
    GetChordLenFromDelta(delta, radius);
    GetTangentFromDelta(delta, radius);
    GetExternalFromDelta(delta, radius);
    GetMidOrdFromDelta(delta, radius);
  }
  GetRadiusFromDegOfCurve(value);
  GetRadiusFromDegOfChord(value);
  GetDegOfCurveFromRadius(radius);
  GetDegOfChordFromRadius(radius);
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size) {
  FuzzedDataProvider data(bytes, size);
  allFormulas(svy_fuzz::rawDouble(data), svy_fuzz::rawDouble(data));

  std::vector<std::string> args{"curve", "solve"};
  args.push_back(kRadiusOptions[data.ConsumeIntegralInRange<std::size_t>(0, std::size(kRadiusOptions) - 1)]);
  args.push_back(data.ConsumeRandomLengthString(32));
  args.push_back(kQuantityOptions[data.ConsumeIntegralInRange<std::size_t>(0, std::size(kQuantityOptions) - 1)]);
  args.push_back(data.ConsumeRandomLengthString(32));
  if (data.ConsumeBool()) args.push_back("--json");
  if (data.ConsumeBool()) args.push_back("--full-precision");
  const int status = svy_fuzz::runSvy(args, std::string());
  if (status != svy_tool::kExitOk && status != svy_tool::kExitUsage) std::abort();
  return 0;
}
