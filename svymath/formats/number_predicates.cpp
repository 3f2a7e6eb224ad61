#include "svymath/formats/number_predicates.h"

#include "svymath/foundation/constants.h"
#include "svyutils/svy_number_text.h"

namespace svy_formats {

bool String2Double(const svy_text::CSvyString& text, double& value) {
  svy_text::CSvyString work(text);
  ReplaceCommasWithDecPt(work);
  return StringToDouble(work, value);
}

double str_to_float(const svy_text::CSvyString& text) {
  double value = svy_math::undefinedValue();
  String2Double(text, value);
  return value;
}

bool is_str_int(const svy_text::CSvyString& text) {
  int value = 0;
  return StringToInt(text, value);
}

bool is_str_double(const svy_text::CSvyString& text) {
  return svy_text::CSvyString(text).Trim().IsEmpty() || is_str_notempty_double(text);
}

bool is_str_notempty_double(const svy_text::CSvyString& text) {
  double value = 0.0;
  return String2Double(text, value);
}

}  // namespace svy_formats
