#include "svymath/formats/sign_strings.h"

namespace svy_formats {

svy_text::CSvyString DecimalSignString() { return svy_text::CSvyString(L"."); }

svy_text::CSvyString ThousandSignString() { return svy_text::CSvyString(L","); }

svy_text::CSvyString DegreeSignString() { return svy_text::CSvyString(L"\u00B0"); }

}  // namespace svy_formats
