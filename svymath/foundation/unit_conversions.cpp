#include "svymath/foundation/unit_conversions.h"

#include <cmath>

#include "svymath/foundation/constants.h"
#include "svyutils/round_prec.h"

namespace {

namespace units = svy_math::units;

double byFoot(double value, bool usSurvey, double usFactor, double intFactor) {
  return value * (usSurvey ? usFactor : intFactor);
}

// Digits of the packed feet-inches-eighths form: thousandths are eighths, hundredths and tenths inches.
constexpr double kPackedFeetScale = 1000.0;
constexpr double kPackedInchDigit = 10.0;

}  // namespace

double Meter2Chain(double m, bool us) { return byFoot(m, us, units::kMetreToUsChain, units::kMetreToIntChain); }
double Chain2Meter(double c, bool us) { return byFoot(c, us, units::kUsChainToMetre, units::kIntChainToMetre); }
double SqrMeter2SqrFeet(double a, bool us) {
  return byFoot(a, us, units::kSqMetreToUsSqFoot, units::kSqMetreToIntSqFoot);
}
double SqureMeter2SqureChain(double a, bool us) {
  return byFoot(a, us, units::kSqMetreToUsSqChain, units::kSqMetreToIntSqChain);
}
double SqureChains2SqureMeters(double a, bool us) {
  return byFoot(a, us, units::kUsSqChainToSqMetre, units::kIntSqChainToSqMetre);
}
double SqureChains2Acres(double a, bool us) { return byFoot(a, us, units::kUsSqChainToAcre, units::kIntSqChainToAcre); }
double CubicMeter2CubicYards(double v, bool us) {
  return byFoot(v, us, units::kCuMetreToUsCuYard, units::kCuMetreToIntCuYard);
}
double CubicMeter2CubicFeets(double v, bool us) {
  return byFoot(v, us, units::kCuMetreToUsCuFoot, units::kCuMetreToIntCuFoot);
}
double CubicMeter2CubicChain(double v, bool us) {
  return byFoot(v, us, units::kCuMetreToUsCuChain, units::kCuMetreToIntCuChain);
}

double Meter2USFeet(double m) { return m * units::kMetreToUsFoot; }
double USFeet2Meter(double f) { return f * units::kUsFootToMetre; }
double Meter2IFeet(double m) { return m / units::kIntFootToMetre; }
double IFeet2Meter(double f) { return f * units::kIntFootToMetre; }

double hPaTommHg(double p) { return p * units::kHpaToMmHg; }
double mmHgTohPa(double p) { return p * units::kMmHgToHpa; }
double hPaToinHg(double p) { return p * units::kHpaToInHg; }
double inHgTohPa(double p) { return p * units::kInHgToHpa; }

double CelsiusToFahrenheit(double t) { return t * units::kFahrenheitPerCelsius + units::kFahrenheitAtZeroCelsius; }
double FahrenheitToCelsius(double t) { return (t - units::kFahrenheitAtZeroCelsius) / units::kFahrenheitPerCelsius; }

double Meter2FFFII(double metres, bool usSurvey) {
  const double feet = byFoot(metres, usSurvey, units::kMetreToUsFootPacked, units::kMetreToIntFootPacked);
  const double eighths = svy::math::round_prec(feet * units::kEighthsPerFoot, 0);
  const double n = std::trunc(std::fabs(eighths));
  const double wholeFeet = std::floor(n / units::kEighthsPerFoot);
  const double rest = n - units::kEighthsPerFoot * wholeFeet;
  const double inches = std::floor(rest / units::kEighthsPerInch);
  const double eighthsOfInch = std::fmod(n, units::kEighthsPerInch);
  const double packed = wholeFeet + (kPackedInchDigit * inches + eighthsOfInch) / kPackedFeetScale;
  return eighths < 0.0 ? -packed : packed;
}

double FFFII2Meter(double packed, bool usSurvey) {
  const double digits = svy::math::round_prec(packed * kPackedFeetScale, 0);
  const double n = std::fabs(digits);
  double wholeFeet = std::floor(n / kPackedFeetScale);
  const double rest = std::fmod(n, kPackedFeetScale);
  double inches = std::floor(rest / kPackedInchDigit);
  double eighths = std::fmod(rest, kPackedInchDigit);
  if (eighths >= units::kEighthsPerInch) {
    eighths -= units::kEighthsPerInch;
    inches += 1.0;
  }
  if (inches >= units::kInchesPerFoot) {
    wholeFeet += std::floor(inches / units::kInchesPerFoot);
    inches = std::fmod(inches, units::kInchesPerFoot);
  }
  double feet = wholeFeet + (units::kEighthsPerInch * inches + eighths) / units::kEighthsPerFoot;
  if (digits < 0.0) feet = -feet;
  return byFoot(feet, usSurvey, units::kUsFootToMetre, units::kIntFootToMetre);
}
