// The svy row module: reading CSV rows (quotes, comments, header recognition, line numbers), checking them
// as numbers or text, and writing them back as CSV and as JSON.
#include "fuzz_support.h"

#include "row_io.h"

#include <cstdlib>

namespace {

// A numeric format of four columns with two optional, and a text format of one column.
const svy_tool::RowFormat kNumeric{{"n1", "e1", "n2", "e2"}, true, {{"n1", 4}, {"e1", 4}, {"n2", 4}}, 2};
const svy_tool::RowFormat kText{{"text"}, false, {{"text", 0}, {"length", 3}}};

void readAndWrite(const std::string& input, const svy_tool::RowFormat& format, svy_tool::OutputOptions options) {
  std::istringstream in(input);
  svy_fuzz::NullBuffer sink;
  std::ostream out(&sink);
  std::streambuf* const oldErr = std::cerr.rdbuf(&sink);
  std::size_t lastLine = 0;
  const int status = svy_tool::runRows(in, out, format, options,
      [&lastLine](const svy_tool::InputRow& row, std::vector<svy_tool::Cell>& cells, std::string&) {
        // Rows come in input order, each on a line of its own.
        if (row.lineNumber <= lastLine) std::abort();
        lastLine = row.lineNumber;
        if (row.numbers.empty()) {
          cells = {row.fields[0], static_cast<double>(row.fields[0].size())};
        } else {
          cells = {row.numbers[0], row.numbers[1], row.numbers.size() > 2 ? row.numbers[2] : 0.0};
        }
        return true;
      });
  std::cerr.rdbuf(oldErr);
  if (status != svy_tool::kExitOk && status != svy_tool::kExitBadRows) std::abort();
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size) {
  if (size == 0) return 0;
  // The first byte chooses the output form; the rest is the input text.
  const svy_tool::OutputOptions options{(bytes[0] & 1) != 0, (bytes[0] & 2) != 0};
  const std::string input(reinterpret_cast<const char*>(bytes) + 1, size - 1);
  readAndWrite(input, kNumeric, options);
  readAndWrite(input, kText, options);

  // A number read back from its written form is the same number.
  double value = 0.0;
  if (svy_tool::parseNumber(input, value)) {
    double back = 0.0;
    if (!svy_tool::parseNumber(svy_tool::formatNumber(value, -1), back) || back != value) std::abort();
  }
  std::vector<double> values;
  svy_tool::parseNumberList(input, 2, values);
  return 0;
}
