// The row reader and writer on string streams: number text, CSV fields, headers, comments, output forms.
#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <sstream>
#include <string>
#include <tuple>
#include <utility>
#include <vector>

#include "row_io.h"
#include "support/comma_locale.h"

namespace {

using svy_tool::Cell;
using svy_tool::InputRow;
using svy_tool::RowFormat;

TEST(NumberText, PlainDecimalsOnlyAndFullPrecisionReadsBack) {
  const std::pair<const char*, double> good[] = {{"12.5", 12.5}, {" -0.25 ", -0.25}, {"+3", 3.0},
                                                 {".5", 0.5},    {"1e3", 1000.0},    {"6378137", 6378137.0}};
  for (const auto& [text, expected] : good) {
    double value = 0.0;
    EXPECT_TRUE(svy_tool::parseNumber(text, value) && value == expected) << text;
  }
  for (const char* text : {"", "abc", "12,5", "1.2.3", "nan", "-inf", "1e999", "0x10", "+-1", "5 m"}) {
    double value = 0.0;
    EXPECT_FALSE(svy_tool::parseNumber(text, value)) << text;
  }
  for (double v : {0.1, 1.0 / 3.0, -2.718281828459045, 6378137.0000000009, 1e-300, 5e-324,
                   std::numeric_limits<double>::max(), 123456789.12345679}) {
    double back = 0.0;
    EXPECT_TRUE(svy_tool::parseNumber(svy_tool::formatNumber(v, -1), back) && back == v) << v;
  }
  const std::tuple<double, int, const char*> fixed[] = {{1.23456, 3, "1.235"},    {-0.0001, 3, "0.000"},
                                                        {-0.0, 0, "0"},           {-0.0006, 3, "-0.001"},
                                                        {std::nan(""), 3, "nan"}, {-HUGE_VAL, 3, "-inf"}};
  for (const auto& [v, decimals, text] : fixed) EXPECT_EQ(svy_tool::formatNumber(v, decimals), text);
  std::vector<double> values;
  EXPECT_TRUE(svy_tool::parseNumberList("5000.5, -2000", 2, values));
  EXPECT_EQ(values, (std::vector<double>{5000.5, -2000.0}));
  for (const char* text : {"5000.5", "1,2,3", "1,x"}) EXPECT_FALSE(svy_tool::parseNumberList(text, 2, values)) << text;
  EXPECT_EQ(values.size(), 2u);  // untouched on failure
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

// Line number and first field of every row read.
std::string readAll(const std::string& text, std::vector<std::string> names, bool numeric) {
  std::istringstream in(text);
  svy_tool::RowReader reader(in, std::move(names), numeric);
  std::string rows;
  for (InputRow row; reader.next(row);) {
    rows += std::to_string(row.lineNumber) + ":";
    for (const std::string& field : row.fields) rows += "[" + field + "]";
    rows += " ";
  }
  return rows;
}

TEST(RowReader, HeadersCommentsBlanksAndQuotes) {
  const struct {
    const char* text;
    std::vector<std::string> names;
    bool numeric;
    const char* rows;
  } cases[] = {
      {"# lot 7\nN,E\n\n 1 , 2 \r\n   # comment\n3,4\n", {"n", "e"}, true, "4:[1][2] 6:[3][4] "},
      {"northing,easting\n1,2\n", {"n", "e"}, true, "2:[1][2] "},         // a line of names is a header
      {"1O,2\n3,4\n", {"n", "e"}, true, "1:[1O][2] 2:[3][4] "},           // a mistyped number is data
      {"1,2\nn,e\n", {"n", "e"}, true, "1:[1][2] 2:[n][e] "},             // only the first line can be one
      {"1+200.00\n2+000\n", {"text"}, false, "1:[1+200.00] 2:[2+000] "},  // text input: header only by name
      {"TEXT\n1+200.00\n", {"text"}, false, "2:[1+200.00] "},
      {"\"12\"\"30'\", \"a,b\" ,c\n", {"x", "y", "z"}, false, "1:[12\"30'][a,b][c] "},
  };
  for (const auto& c : cases) EXPECT_EQ(readAll(c.text, c.names, c.numeric), c.rows) << c.text;
}

TEST(RowWriter, CsvReadsBackAndJsonRoundsLikeCsvUnlessFullPrecision) {
  std::ostringstream csv;
  {
    svy_tool::RowWriter writer(csv, {{"text", 0}, {"value", 2}}, {});
    writer.write({Cell{std::string("10\"20'")}, Cell{1.0}});
    writer.write({Cell{std::string("a,b")}, Cell{2.344}});
  }
  EXPECT_EQ(csv.str(), "text,value\n\"10\"\"20'\",1.00\n\"a,b\",2.34\n");
  EXPECT_EQ(readAll(csv.str(), {"text", "value"}, false), "2:[10\"20'][1.00] 3:[a,b][2.34] ");
  std::ostringstream rounded, full, text;
  svy_tool::RowWriter(rounded, {{"d", 3}}, {true, false}).write({Cell{1.0 / 3.0}});
  svy_tool::RowWriter(full, {{"d", 3}}, {true, true}).write({Cell{1.0 / 3.0}});
  svy_tool::RowWriter(text, {{"text", 0}}, {true, false}).write({Cell{std::string("1+2\xE9")}});
  EXPECT_EQ(rounded.str(), "[\n{\"d\":0.333}\n]\n");
  EXPECT_EQ(full.str(), "[\n{\"d\":0.3333333333333333}\n]\n");
  EXPECT_EQ(text.str(), "[\n{\"text\":\"1+2\xEF\xBF\xBD\"}\n]\n");  // invalid UTF-8 replaced
}

// Rows through runRows(): field counts (some inputs optional), numbers, and the handler's own refusals.
TEST(RunRows, BadRowsReportedGoodRowsWritten) {
  std::istringstream in("a\n1\n2,3\n-1\nabc\n4\n1,2,3,4\n");
  std::ostringstream out;
  RowFormat format{{"a", "b", "c"}, true, {{"twice", 1}}};
  format.requiredInputs = 1;
  testing::internal::CaptureStderr();
  const int status =
      svy_tool::runRows(in, out, format, {}, [](const InputRow& row, std::vector<Cell>& cells, std::string& error) {
        if (row.numbers[0] < 0.0) {
          error = "negative";
          return false;
        }
        cells = {row.numbers[0] * 2.0 + static_cast<double>(row.numbers.size())};
        return true;
      });
  EXPECT_EQ(testing::internal::GetCapturedStderr(),
            "svy: line 4: negative\n"
            "svy: line 5: a: 'abc' is not a number\n"
            "svy: line 7: expected 1 to 3 numbers, got 4\n");
  EXPECT_EQ(status, svy_tool::kExitBadRows);
  EXPECT_EQ(out.str(), "twice\n3.0\n6.0\n9.0\n");
}

}  // namespace
