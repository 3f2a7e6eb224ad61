#pragma once
// Numbers to and from text, independent of the host's locale: the decimal point is always '.', there is
// no digit grouping, whatever setlocale or std::locale::global the host has chosen.
//
// Parsing takes the whole text: blanks (space, tab, line feed, carriage return, vertical tab, form feed)
// may surround the number, anything else after it makes the parse fail. On failure the output is left
// untouched and false is returned.
// - StringToInt: an optional sign and decimal digits, within the range of int ("+12", " -7 ").
// - StringToDouble: an optional sign, digits with an optional '.' and an optional exponent ("1.5",
//   "-.5", "2.", "1e-3"). A comma is not a decimal point here (apply ReplaceCommasWithDecPt first when
//   user text may use one); infinities, NaN, hexadecimal forms and values beyond the range of double are
//   rejected, so a successful parse always gives a finite number.
#include <locale>

#include "svyutils/svy_string.h"
#include "svyutils/svyutils_export.h"

namespace svy_formats {

SVYUTILS_API bool StringToInt(const svy_text::CSvyString& text, int& value);
SVYUTILS_API bool StringToDouble(const svy_text::CSvyString& text, double& value);

// Fixed-point text with `decimals` digits after the point, rounded half away from zero on the decimal
// value the double stands for (2.675 gives "2.68"); a negative count rounds to tens, hundreds, ... and
// prints no point. A result that rounds to zero prints without a minus sign. Non-finite values print as
// "nan", "inf" and "-inf". Counts beyond 17 decimals are treated as 17.
SVYUTILS_API svy_text::CSvyString DoubleToString(double value, int decimals);

// Replaces every ',' of the text with '.', for user text typed with a decimal comma.
SVYUTILS_API void ReplaceCommasWithDecPt(svy_text::CSvyString& text);

// The classic "C" locale, for streams that must format numbers the same way on every host.
SVYUTILS_API const std::locale& GetCLocale();

// While an object of this class lives, the C library functions called on the creating thread
// (swprintf, swscanf, strtod, ...) use the C locale; the thread's previous locale is restored after.
// Other threads are not affected.
class SVYUTILS_API CScopedCLocale {
 public:
  CScopedCLocale();
  ~CScopedCLocale();
  CScopedCLocale(const CScopedCLocale&) = delete;
  CScopedCLocale& operator=(const CScopedCLocale&) = delete;

 private:
  void* previous_;
};

}  // namespace svy_formats
