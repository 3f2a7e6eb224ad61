#include "svymath/formats/dms_text.h"

#include <gtest/gtest.h>

namespace {

using svy_text::CSvyString;

struct TDmsCase {
  const wchar_t* text;
  const wchar_t* maxDegrees;
  bool allowMax;
  bool valid;
};

class CheckValidDmsTable : public ::testing::TestWithParam<TDmsCase> {};

TEST_P(CheckValidDmsTable, AcceptsOnlyWellFormedFieldsWithinTheLimits) {
  const TDmsCase& c = GetParam();
  EXPECT_EQ(CheckValidDMSVal(CSvyString(c.text), CSvyString(c.maxDegrees), c.allowMax), c.valid);
}

INSTANTIATE_TEST_SUITE_P(
    Limits, CheckValidDmsTable,
    ::testing::Values(TDmsCase{L"360.0000", L"360", true, true}, TDmsCase{L"360.0000", L"360", false, false},
                      TDmsCase{L"360.0001", L"360", true, false}, TDmsCase{L"360.01", L"360", true, false},
                      TDmsCase{L"360", L"360", true, true}, TDmsCase{L"360.", L"360", true, true},
                      TDmsCase{L"359.5959", L"360", false, true}, TDmsCase{L"359.59599", L"360", false, true},
                      TDmsCase{L"361", L"360", true, false}, TDmsCase{L"400.0000", L"360", true, false},
                      TDmsCase{L"0360", L"360", true, false},  // longer than the maximum
                      TDmsCase{L"036", L"360", false, true},   // shorter: compared as text
                      TDmsCase{L"90.0000", L"90", true, true}, TDmsCase{L"90.0030", L"90", true, false},
                      TDmsCase{L"89.5959", L"90", false, true}, TDmsCase{L"100", L"90", true, false}));

INSTANTIATE_TEST_SUITE_P(
    Fields, CheckValidDmsTable,
    ::testing::Values(TDmsCase{L"45.3015", L"360", false, true}, TDmsCase{L"45.6000", L"360", false, false},
                      TDmsCase{L"45.5", L"360", false, true},   // one digit of minutes is its tens: 50
                      TDmsCase{L"45.6", L"360", false, false},  // 60 minutes
                      TDmsCase{L"45.3060", L"360", false, false}, TDmsCase{L"45.306", L"360", false, false},
                      TDmsCase{L"45.305", L"360", false, true}, TDmsCase{L"45.5959", L"360", false, true},
                      TDmsCase{L"45.30159999", L"360", false, true},  // digits after the seconds unchecked
                      TDmsCase{L"45.", L"360", false, true}, TDmsCase{L"45", L"360", false, true},
                      TDmsCase{L".3000", L"360", false, true}));

INSTANTIATE_TEST_SUITE_P(
    Characters, CheckValidDmsTable,
    ::testing::Values(TDmsCase{L"-45.3015", L"360", false, true}, TDmsCase{L"45,3015", L"360", false, true},
                      TDmsCase{L"  45.3015\t", L"360", false, true}, TDmsCase{L"--45", L"360", false, false},
                      TDmsCase{L"45-", L"360", false, false}, TDmsCase{L"45.30.15", L"360", false, false},
                      TDmsCase{L"45,30,15", L"360", false, false}, TDmsCase{L"4a.00", L"360", false, false},
                      TDmsCase{L"45 30", L"360", false, false}, TDmsCase{L"+45", L"360", false, false},
                      TDmsCase{L"", L"360", false, false}, TDmsCase{L"   ", L"360", false, false},
                      TDmsCase{L"-", L"360", false, true},  // no fields at all: nothing out of range
                      TDmsCase{L".", L"360", false, true}));

}  // namespace
