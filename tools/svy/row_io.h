#pragma once
// Row input and output shared by every svy verb.
//
// Input: CSV rows from a file, or from stdin when the path is empty or "-". A UTF-8 byte-order mark at the
// start is skipped, and so is the carriage return of CRLF line ends. Blank lines and lines whose first
// non-blank character is '#' are skipped; fields are trimmed; double-quoted fields may hold commas ("" is a
// quote). The first content line is taken as a header and skipped when its fields equal the verb's input
// column names (any case), or, for numeric input, when every field starts with a letter (a line of names). Line numbers count
// every physical line from 1, so that a message points at the line a user sees in an editor.
//
// Output: a CSV header line and one line per row, or with --json one JSON array of objects keyed by column
// name. Numbers are written with the decimals of their column, or with 17 significant digits under
// --full-precision so that they read back to the same double. NaN is written as "nan" (JSON null).
//
// Bad rows: one line on stderr, "svy: line 7: expected 4 numbers, got 3"; the good rows still come out and
// the exit status is non-zero once all rows are written.
//
// Numbers are read and written in the C locale's form (a '.' decimal point) whatever the user's locale.
//
// A verb normally needs only addInputArgument(), outputOptionsFor() and runRows():
//
//   CLI::App* verb = family->add_subcommand("hypot", "Distance from the origin");
//   std::shared_ptr<std::string> input = svy_tool::addInputArgument(*verb);
//   verb->callback([verb, input] {
//     const svy_tool::RowFormat format{{"n", "e"}, true, {{"distance", 3}}};
//     svy_tool::finishVerb(svy_tool::runRows(*input, format, svy_tool::outputOptionsFor(*verb),
//         [](const svy_tool::InputRow& row, std::vector<svy_tool::Cell>& out, std::string& error) {
//           out = {std::hypot(row.numbers[0], row.numbers[1])};  // or: error = "why"; return false;
//           return true;
//         }));
//   });
//
// Verbs whose input rows give several output rows each (intersections with two solutions) use
// runMultiRows(). Verbs that read all rows before writing (fits, totals, traverses) use RowReader and
// RowWriter directly.

#include <cstddef>
#include <functional>
#include <istream>
#include <memory>
#include <ostream>
#include <string>
#include <variant>
#include <vector>

namespace CLI {
class App;
class Option;
}

namespace svy_tool {

// Process exit statuses of the tool.
inline constexpr int kExitOk = 0;
inline constexpr int kExitBadRows = 1;  // some rows could not be processed; the others were written
inline constexpr int kExitUsage = 2;    // bad options, unknown unit, unreadable input file

// Output form chosen by the global options --json and --full-precision.
struct OutputOptions {
  bool json = false;
  bool fullPrecision = false;
};

// Reads the global options from the root of the command a verb belongs to.
OutputOptions outputOptionsFor(const CLI::App& command);

// Makes a number option read its text as rows are read (parseNumber): "nan", "inf", hexadecimal and values
// beyond the range of double are refused with "--radius: expected a number, got 'nan'". Returns the option.
CLI::Option* requireNumberText(CLI::Option* option);

// Adds the optional positional input file to a verb ("-" or nothing: stdin) and returns where its value goes;
// the verb's callback keeps the returned pointer (and so the string) alive by capturing it.
std::shared_ptr<std::string> addInputArgument(CLI::App& verb);

// Ends a verb's callback with the status of runRows(): a non-zero status leaves the command with it.
void finishVerb(int status);

// One output column: its name in the header (and the JSON key), and the decimals its numbers are written
// with when --full-precision is not given. Text cells ignore the decimals.
struct Column {
  std::string name;
  int decimals = 3;
};

// One output value.
using Cell = std::variant<double, std::string>;

// One content line of the input.
struct InputRow {
  std::size_t lineNumber = 0;       // 1-based physical line in the input
  std::vector<std::string> fields;  // trimmed, unquoted
  bool unclosedQuote = false;       // a double quote opened and not closed: the fields are not trustworthy
  std::vector<double> numbers;      // the fields as numbers, filled by runRows() for numeric input
};

// Parses a whole text as a finite number in the C locale's form (optional sign, digits, '.', exponent).
// Surrounding blanks are allowed; anything else makes it fail.
bool parseNumber(const std::string& text, double& value);

// Formats a number with fixed decimals ("-0.000" becomes "0.000") or, when decimals < 0, with 17 significant
// digits; NaN gives "nan" and infinities "inf" / "-inf".
std::string formatNumber(double value, int decimals);

// The value a number is written as: rounded to the column's decimals (as the CSV shows it), or unchanged
// under --full-precision or when it is not finite. Verbs that write a JSON document of their own shape use it
// so that their numbers agree with the CSV.
double shownValue(double value, int decimals, const OutputOptions& options);

// Reads content lines; see the header rules at the top of this file.
class RowReader {
 public:
  // Reads from the stream, which must outlive the reader.
  RowReader(std::istream& in, std::vector<std::string> inputNames, bool numericInput);

  // Next content row, skipping blanks, comments and a recognised header; false at the end of the input.
  bool next(InputRow& row);

 private:
  bool isHeader(const std::vector<std::string>& fields) const;

  std::istream& in_;
  std::vector<std::string> inputNames_;
  bool numericInput_;
  std::size_t lineNumber_ = 0;
  bool seenContent_ = false;
};

// Opens the input named on the command line: a file, or stdin for "" and "-". On failure returns null and
// sets the message ("cannot open 'x': No such file or directory").
std::unique_ptr<std::istream> openInput(const std::string& path, std::string& error);

// A named group of values that a verb writes beside its rows in JSON: "name": {"column": value, ...}.
struct JsonGroup {
  std::string name;
  std::vector<Column> columns;
  std::vector<Cell> cells;
};

// Writes rows as CSV or as a JSON array. The header (CSV) or the opening bracket (JSON) is written with the
// first row or at finish(), so that an empty input still gives a well-formed output.
class RowWriter {
 public:
  RowWriter(std::ostream& out, std::vector<Column> columns, OutputOptions options);
  ~RowWriter();
  RowWriter(const RowWriter&) = delete;
  RowWriter& operator=(const RowWriter&) = delete;

  // With --json, writes one object instead of the array: the groups first, then the rows as an array under
  // rowsKey ({"misclosure": {...}, "points": [...]}). Call before the first row; CSV output ignores it.
  void setJsonEnvelope(std::vector<JsonGroup> groups, std::string rowsKey);

  // Writes one row; cells must match the columns in number.
  void write(const std::vector<Cell>& cells);
  // Closes the output (the JSON array's bracket); called by the destructor when not called before.
  void finish();

 private:
  void start();
  std::string csvCell(const Cell& cell, const Column& column) const;
  // One JSON object of the cells keyed by the columns' names, numbers rounded as in CSV.
  std::string jsonObject(const std::vector<Column>& columns, const std::vector<Cell>& cells) const;

  std::ostream& out_;
  std::vector<Column> columns_;
  OutputOptions options_;
  std::size_t rowsWritten_ = 0;
  bool started_ = false;
  bool finished_ = false;
  std::vector<JsonGroup> envelopeGroups_;
  std::string envelopeRowsKey_;  // empty: a plain array
};

// Input text for a message, in single quotes and cut to a few dozen bytes ("'1111111...'").
std::string quoteForMessage(const std::string& text);

// Reports a bad row on stderr: "svy: line 7: <message>", control bytes shown as \xNN.
void reportBadRow(std::size_t lineNumber, const std::string& message);

// The shape of a row-by-row verb: input column names (for the header and the messages), how many of them a
// row must have at least (the rest are optional; 0 means all), whether they are numbers, and the outputs.
struct RowFormat {
  std::vector<std::string> inputs;
  bool numericInput = true;
  std::vector<Column> outputs;
  std::size_t requiredInputs = 0;
};

// Checks a row against the format: its field count and, for numeric input, that every field is a number
// (filling row.numbers). On failure sets the bad-row message ("expected 2 numbers, got 3") and returns false.
// runRows() applies it to every row; verbs that read all rows first call it themselves.
bool checkRow(const RowFormat& format, InputRow& row, std::string& error);

// Parses an option value of comma-separated numbers ("5000,2000" for N,E) into exactly `count` numbers.
bool parseNumberList(const std::string& text, std::size_t count, std::vector<double>& values);

// Computes one row: fills the output cells and returns true, or sets the message and returns false.
using RowHandler = std::function<bool(const InputRow& row, std::vector<Cell>& out, std::string& error)>;

// Reads every row of the input, checks its field count (and numbers, for numeric input), calls the handler,
// writes the good rows to stdout and reports the bad ones. Returns kExitOk, kExitBadRows or kExitUsage.
int runRows(const std::string& inputPath, const RowFormat& format, const OutputOptions& options,
            const RowHandler& handler);

// The same over given streams, for callers that already hold them.
int runRows(std::istream& in, std::ostream& out, const RowFormat& format, const OutputOptions& options,
            const RowHandler& handler);

// Takes one good input row of a verb that reads all rows before writing; returns false with a message to
// report the row as bad instead.
using RowTaker = std::function<bool(const InputRow& row, std::string& error)>;

// Reads every row of the input, checks each against the format and hands the good ones to `take`; bad rows
// are reported. Returns kExitOk, kExitBadRows when a row was reported, or kExitUsage when the input cannot
// be opened (also reported).
int readAllRows(const std::string& inputPath, const RowFormat& format, const RowTaker& take);

// Computes the output rows of one input row (any number, each matching the output columns), or sets the
// message and returns false.
using MultiRowHandler =
    std::function<bool(const InputRow& row, std::vector<std::vector<Cell>>& out, std::string& error)>;

// runRows() for verbs that give several output rows (or none) per input row.
int runMultiRows(const std::string& inputPath, const RowFormat& format, const OutputOptions& options,
                 const MultiRowHandler& handler);
int runMultiRows(std::istream& in, std::ostream& out, const RowFormat& format, const OutputOptions& options,
                 const MultiRowHandler& handler);

}  // namespace svy_tool
