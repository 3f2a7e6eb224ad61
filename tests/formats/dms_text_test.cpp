#include "svymath/formats/dms_text.h"

#include <gtest/gtest.h>

namespace {

using svy_text::CSvyString;

TEST(CheckValidDMSVal, AcceptsOnlyWellFormedFieldsWithinTheLimits) {
  struct {
    const wchar_t* text;
    const wchar_t* maxDegrees;
    bool allowMax, valid;
  } const cases[] = {
      {L"360.0000", L"360", true, true},  {L"360.0000", L"360", false, false}, {L"360.0001", L"360", true, false},
      {L"359.59599", L"360", false, true},
      {L"0360", L"360", true, false},  // longer than the maximum
      {L"036", L"360", false, true},   // shorter: compared as text
      {L"90.0030", L"90", true, false},
      {L"45.5", L"360", false, true},  // one digit of minutes is its tens: 50
      {L"45.6", L"360", false, false},    {L"45.3060", L"360", false, false}, {L"45.306", L"360", false, false},
      {L"45.305", L"360", false, true},
      {L"45.30159999", L"360", false, true},  // digits after the seconds
      {L"-45.3015", L"360", false, true}, {L"  45,3015\t", L"360", false, true}, {L"45-", L"360", false, false},
      {L"45,30,15", L"360", false, false}, {L"45 30", L"360", false, false},   {L"+45", L"360", false, false},
      {L"   ", L"360", false, false},
      {L"-", L"360", false, true}};  // no fields at all: nothing out of range
  for (const auto& c : cases) {
    SCOPED_TRACE(CSvyString(c.text).ToNarrow());
    EXPECT_EQ(CheckValidDMSVal(CSvyString(c.text), CSvyString(c.maxDegrees), c.allowMax), c.valid);
  }
}

}  // namespace
