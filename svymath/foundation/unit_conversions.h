#pragma once
// Conversions of single values between the library's units (metres, square and cubic metres,
// hectopascals, degrees Celsius) and those of field and display code. Pure functions, no validation.
//
// The boolean of the two-argument conversions selects the foot the unit is based on: true the US survey
// foot (1200/3937 m), false the international foot (0.3048 m). Each multiplies by one fixed factor (see
// constants.h); some pairs are deliberately not exact inverses of each other.
#include "svymath/foundation/export.h"

SVYMATH_API double Meter2Chain(double metres, bool usSurvey);
SVYMATH_API double Chain2Meter(double chains, bool usSurvey);
SVYMATH_API double SqrMeter2SqrFeet(double squareMetres, bool usSurvey);
SVYMATH_API double SqureMeter2SqureChain(double squareMetres, bool usSurvey);
SVYMATH_API double SqureChains2SqureMeters(double squareChains, bool usSurvey);
SVYMATH_API double SqureChains2Acres(double squareChains, bool usSurvey);
SVYMATH_API double CubicMeter2CubicYards(double cubicMetres, bool usSurvey);
SVYMATH_API double CubicMeter2CubicFeets(double cubicMetres, bool usSurvey);
SVYMATH_API double CubicMeter2CubicChain(double cubicMetres, bool usSurvey);

SVYMATH_API double Meter2USFeet(double metres);
SVYMATH_API double USFeet2Meter(double feet);
SVYMATH_API double Meter2IFeet(double metres);
SVYMATH_API double IFeet2Meter(double feet);

SVYMATH_API double hPaTommHg(double hectopascals);
SVYMATH_API double mmHgTohPa(double millimetresOfMercury);
SVYMATH_API double hPaToinHg(double hectopascals);
SVYMATH_API double inHgTohPa(double inchesOfMercury);

SVYMATH_API double CelsiusToFahrenheit(double celsius);
SVYMATH_API double FahrenheitToCelsius(double fahrenheit);

// Packed feet, inches and eighths FFF.IIE: whole feet, then two digits of inches (00-11) and one digit of
// eighths of an inch (0-7); 5 ft 7 3/8 in is 5.073. Packing rounds to the nearest eighth.
SVYMATH_API double Meter2FFFII(double metres, bool usSurvey);
// Unpacking carries out-of-range digits (eighths >= 8 into inches, inches >= 12 into feet).
SVYMATH_API double FFFII2Meter(double packed, bool usSurvey);
