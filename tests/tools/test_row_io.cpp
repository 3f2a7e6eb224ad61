// The row reader and writer on string streams: number text, CSV fields, headers, comments, output forms.
#include "row_io.h"

#include "support/comma_locale.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <sstream>

namespace {

using svy_tool::Cell;
using svy_tool::InputRow;
using svy_tool::RowFormat;

struct NumberText {
  const char* text;
  bool ok;
  double value;
};

class ParseNumber : public ::testing::TestWithParam<NumberText> {};

TEST_P(ParseNumber, AcceptsPlainDecimalsOnly) {
  const NumberText& c = GetParam();
  double value = -999.0;
  EXPECT_EQ(svy_tool::parseNumber(c.text, value), c.ok) << c.text;
  if (c.ok) {
    EXPECT_EQ(value, c.value) << c.text;
  }
}

INSTANTIATE_TEST_SUITE_P(
    Texts, ParseNumber,
    ::testing::Values(NumberText{"12.5", true, 12.5}, NumberText{" -0.25 ", true, -0.25},
                      NumberText{"+3", true, 3.0}, NumberText{".5", true, 0.5}, NumberText{"1e3", true, 1000.0},
                      NumberText{"6378137", true, 6378137.0}, NumberText{"", false, 0.0},
                      NumberText{"abc", false, 0.0}, NumberText{"12,5", false, 0.0},
                      NumberText{"1.2.3", false, 0.0}, NumberText{"nan", false, 0.0},
                      NumberText{"-inf", false, 0.0}, NumberText{"1e999", false, 0.0},
                      NumberText{"0x10", false, 0.0}, NumberText{"+-1", false, 0.0},
                      NumberText{"5 m", false, 0.0}));

TEST(FormatNumber, FullPrecisionReadsBackExactly) {
  const double values[] = {0.1, 1.0 / 3.0, -2.718281828459045, 6378137.0000000009, 1e-300, 5e-324,
                           std::numeric_limits<double>::max(), 123456789.12345679};
  for (double v : values) {
    double back = 0.0;
    ASSERT_TRUE(svy_tool::parseNumber(svy_tool::formatNumber(v, -1), back)) << v;
    EXPECT_EQ(back, v);
  }
}

TEST(FormatNumber, FixedDecimalsRoundAndDropNegativeZero) {
  EXPECT_EQ(svy_tool::formatNumber(1.23456, 3), "1.235");
  EXPECT_EQ(svy_tool::formatNumber(-0.0001, 3), "0.000");
  EXPECT_EQ(svy_tool::formatNumber(-0.0, 0), "0");
  EXPECT_EQ(svy_tool::formatNumber(-0.0006, 3), "-0.001");
  EXPECT_EQ(svy_tool::formatNumber(std::nan(""), 3), "nan");
  EXPECT_EQ(svy_tool::formatNumber(-HUGE_VAL, 3), "-inf");
}

TEST(NumberText, IndependentOfTheProcessLocale) {
  const svy_test::CDecimalCommaCLocale comma;
  if (!comma.active()) GTEST_SKIP() << "no decimal-comma locale installed";
  double value = 0.0;
  EXPECT_TRUE(svy_tool::parseNumber("1234.5", value));
  EXPECT_EQ(value, 1234.5);
  EXPECT_FALSE(svy_tool::parseNumber("1234,5", value));
  EXPECT_EQ(svy_tool::formatNumber(1234.5, 2), "1234.50");
  EXPECT_EQ(svy_tool::formatNumber(0.1, -1), "0.10000000000000001");
}

std::vector<InputRow> readAll(const std::string& text, std::vector<std::string> names, bool numeric) {
  std::istringstream in(text);
  svy_tool::RowReader reader(in, std::move(names), numeric);
  std::vector<InputRow> rows;
  InputRow row;
  while (reader.next(row)) rows.push_back(row);
  return rows;
}

TEST(RowReader, SkipsBlanksCommentsAndHeaderKeepingLineNumbers) {
  const auto rows = readAll("# survey of lot 7\nN,E\n\n 1 , 2 \r\n   # inline comment line\n3,4\n", {"n", "e"}, true);
  ASSERT_EQ(rows.size(), 2u);
  EXPECT_EQ(rows[0].lineNumber, 4u);
  EXPECT_EQ(rows[0].fields, (std::vector<std::string>{"1", "2"}));
  EXPECT_EQ(rows[1].lineNumber, 6u);
}

TEST(RowReader, NumericHeaderRecognisedByItsTextEvenWithOtherNames) {
  const auto rows = readAll("northing,easting\n1,2\n", {"n", "e"}, true);
  ASSERT_EQ(rows.size(), 1u);
  EXPECT_EQ(rows[0].lineNumber, 2u);
}

TEST(RowReader, MistypedFirstNumberIsDataNotAHeader) {
  const auto rows = readAll("1O,2\n3,4\n", {"n", "e"}, true);
  ASSERT_EQ(rows.size(), 2u);
  EXPECT_EQ(rows[0].fields[0], "1O");
}

TEST(RowReader, OnlyTheFirstContentLineCanBeAHeader) {
  const auto rows = readAll("1,2\nn,e\n", {"n", "e"}, true);
  ASSERT_EQ(rows.size(), 2u);
  EXPECT_EQ(rows[1].fields[0], "n");
}

TEST(RowReader, TextInputHeaderOnlyByName) {
  // Station texts are not numbers; a first row of them is data, not a header.
  const auto rows = readAll("1+200.00\n2+000\n", {"text"}, false);
  ASSERT_EQ(rows.size(), 2u);
  EXPECT_EQ(readAll("TEXT\n1+200.00\n", {"text"}, false).size(), 1u);
}

TEST(RowReader, QuotedFieldsKeepCommasAndQuotes) {
  const auto rows = readAll("\"12\"\"30'\", \"a,b\" ,c\n", {"x", "y", "z"}, false);
  ASSERT_EQ(rows.size(), 1u);
  EXPECT_EQ(rows[0].fields, (std::vector<std::string>{"12\"30'", "a,b", "c"}));
}

TEST(RowWriter, QuotedCsvTextReadsBack) {
  std::ostringstream csv;
  {
    svy_tool::RowWriter writer(csv, {{"text", 0}, {"value", 2}}, {});
    writer.write({Cell{std::string("10\"20'")}, Cell{1.0}});
    writer.write({Cell{std::string("a,b")}, Cell{2.344}});
  }
  EXPECT_EQ(csv.str(), "text,value\n\"10\"\"20'\",1.00\n\"a,b\",2.34\n");
  const auto rows = readAll(csv.str(), {"text", "value"}, false);
  ASSERT_EQ(rows.size(), 2u);
  EXPECT_EQ(rows[0].fields[0], "10\"20'");
  EXPECT_EQ(rows[1].fields[0], "a,b");
}

TEST(RowWriter, JsonRoundsLikeCsvUnlessFullPrecision) {
  std::ostringstream rounded;
  std::ostringstream full;
  svy_tool::RowWriter(rounded, {{"d", 3}}, {true, false}).write({Cell{1.0 / 3.0}});
  svy_tool::RowWriter(full, {{"d", 3}}, {true, true}).write({Cell{1.0 / 3.0}});
  EXPECT_EQ(rounded.str(), "[\n{\"d\":0.333}\n]\n");
  EXPECT_EQ(full.str(), "[\n{\"d\":0.3333333333333333}\n]\n");
}

TEST(RowWriter, JsonReplacesInvalidUtf8InEchoedText) {
  std::ostringstream json;
  svy_tool::RowWriter(json, {{"text", 0}}, {true, false}).write({Cell{std::string("1+2\xE9")}});
  EXPECT_EQ(json.str(), "[\n{\"text\":\"1+2\xEF\xBF\xBD\"}\n]\n");
}

// Counts rows through runRows() with a handler that doubles a number and refuses negatives.
TEST(RunRows, BadRowsReportedGoodRowsWritten) {
  std::istringstream in("x\n1\n2,3\n-1\nabc\n4\n");
  std::ostringstream out;
  const RowFormat format{{"x"}, true, {{"twice", 1}}};
  testing::internal::CaptureStderr();
  const int status = svy_tool::runRows(in, out, format, {}, [](const InputRow& row, std::vector<Cell>& cells,
                                                                 std::string& error) {
    if (row.numbers[0] < 0.0) {
      error = "negative";
      return false;
    }
    cells = {row.numbers[0] * 2.0};
    return true;
  });
  const std::string err = testing::internal::GetCapturedStderr();
  EXPECT_EQ(status, svy_tool::kExitBadRows);
  EXPECT_EQ(out.str(), "twice\n2.0\n8.0\n");
  EXPECT_EQ(err, "svy: line 3: expected 1 number, got 2\n"
                 "svy: line 4: negative\n"
                 "svy: line 5: x: 'abc' is not a number\n");
}

TEST(ParseNumberList, ExactlyTheGivenCount) {
  std::vector<double> values;
  EXPECT_TRUE(svy_tool::parseNumberList("5000.5, -2000", 2, values));
  EXPECT_EQ(values, (std::vector<double>{5000.5, -2000.0}));
  EXPECT_FALSE(svy_tool::parseNumberList("5000.5", 2, values));
  EXPECT_FALSE(svy_tool::parseNumberList("1,2,3", 2, values));
  EXPECT_FALSE(svy_tool::parseNumberList("1,x", 2, values));
  EXPECT_EQ(values.size(), 2u);  // untouched on failure
}

TEST(RunRows, OptionalTrailingInputs) {
  std::istringstream in("1\n1,2\n1,2,3,4\n");
  std::ostringstream out;
  RowFormat format{{"a", "b", "c"}, true, {{"count", 0}}};
  format.requiredInputs = 1;
  testing::internal::CaptureStderr();
  const int status = svy_tool::runRows(in, out, format, {}, [](const InputRow& row, std::vector<Cell>& cells,
                                                                 std::string&) {
    cells = {static_cast<double>(row.numbers.size())};
    return true;
  });
  EXPECT_EQ(testing::internal::GetCapturedStderr(), "svy: line 3: expected 1 to 3 numbers, got 4\n");
  EXPECT_EQ(status, svy_tool::kExitBadRows);
  EXPECT_EQ(out.str(), "count\n1\n2\n");
}

}  // namespace
