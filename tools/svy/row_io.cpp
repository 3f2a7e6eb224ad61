#include "row_io.h"

#include <CLI/CLI.hpp>
#include <nlohmann/json.hpp>

#include <algorithm>
#include <cctype>
#include <cerrno>
#include <charconv>
#include <cmath>
#include <cstdio>
#include <cstring>
#include <fstream>
#include <iostream>
#include <system_error>
#include <utility>

namespace svy_tool {

namespace {

// 17 significant digits read back to the same double (DBL_DECIMAL_DIG).
constexpr int kRoundTripDigits = 17;
// Widest fixed-point text we write: 309 integer digits of DBL_MAX, the point and up to 17 decimals.
constexpr std::size_t kNumberBufferSize = 400;
constexpr int kMaxDecimals = 17;
// A byte-order mark that editors on some systems put at the start of a UTF-8 file.
constexpr char kUtf8ByteOrderMark[] = "\xEF\xBB\xBF";
// Input echoed in a message is cut after this many bytes: a field of a megabyte still gives a short line.
constexpr std::size_t kMaxEchoBytes = 40;

bool isBlank(char c) { return c == ' ' || c == '\t' || c == '\r' || c == '\n' || c == '\f' || c == '\v'; }

std::string trim(const std::string& text) {
  std::size_t first = 0;
  std::size_t last = text.size();
  while (first < last && isBlank(text[first])) ++first;
  while (last > first && isBlank(text[last - 1])) --last;
  return text.substr(first, last - first);
}

bool equalNoCase(const std::string& a, const std::string& b) {
  return a.size() == b.size() && std::equal(a.begin(), a.end(), b.begin(), [](char x, char y) {
           return std::tolower(static_cast<unsigned char>(x)) == std::tolower(static_cast<unsigned char>(y));
         });
}

// Splits one CSV line: commas separate fields, double quotes protect commas, "" inside quotes is a quote.
// Sets unclosed when the line ends inside quotes.
std::vector<std::string> splitCsv(const std::string& line, bool& unclosed) {
  std::vector<std::string> fields;
  std::string field;
  bool quoted = false;
  bool wasQuoted = false;
  for (std::size_t i = 0; i < line.size(); ++i) {
    const char c = line[i];
    if (quoted) {
      if (c == '"' && i + 1 < line.size() && line[i + 1] == '"') {
        field += '"';
        ++i;
      } else if (c == '"') {
        quoted = false;
      } else {
        field += c;
      }
    } else if (c == '"' && trim(field).empty()) {
      field.clear();
      quoted = true;
      wasQuoted = true;
    } else if (c == ',') {
      fields.push_back(wasQuoted ? field : trim(field));
      field.clear();
      wasQuoted = false;
    } else if (!(wasQuoted && isBlank(c))) {
      field += c;
    }
  }
  fields.push_back(wasQuoted ? field : trim(field));
  unclosed = quoted;
  return fields;
}

bool isContentLine(const std::string& line) {
  for (char c : line) {
    if (!isBlank(c)) return c != '#';
  }
  return false;
}

std::string quoteCsv(const std::string& text) {
  if (text.find_first_of(",\"\n\r") == std::string::npos && trim(text) == text) return text;
  std::string quoted = "\"";
  for (char c : text) {
    if (c == '"') quoted += '"';
    quoted += c;
  }
  return quoted + '"';
}

std::string plural(std::size_t count, const char* singular, const char* pluralForm) {
  return count == 1 ? singular : pluralForm;
}

// "expected 4 numbers, got 3" / "expected 2 to 3 numbers, got 1" / "expected 1 field, got 2".
std::string fieldCountMessage(const RowFormat& format, std::size_t got) {
  const std::size_t most = format.inputs.size();
  const std::size_t least = format.requiredInputs == 0 ? most : std::min(format.requiredInputs, most);
  const char* one = format.numericInput ? "number" : "field";
  const char* many = format.numericInput ? "numbers" : "fields";
  std::string message = "expected " + std::to_string(least);
  if (least != most) message += " to " + std::to_string(most);
  return message + " " + plural(most, one, many) + ", got " + std::to_string(got);
}

bool fieldCountFits(const RowFormat& format, std::size_t count) {
  const std::size_t most = format.inputs.size();
  const std::size_t least = format.requiredInputs == 0 ? most : std::min(format.requiredInputs, most);
  return count >= least && count <= most;
}

}  // namespace

bool parseNumber(const std::string& text, double& value) {
  const std::string body = trim(text);
  const char* first = body.data();
  const char* last = body.data() + body.size();
  // One optional sign; from_chars takes only '-', and also reads "inf" and "nan", which are refused here.
  if (first != last && (*first == '+' || *first == '-')) ++first;
  if (first == last || !(std::isdigit(static_cast<unsigned char>(*first)) || *first == '.')) return false;
  const bool negative = body[0] == '-';
  double parsed = 0.0;
  const auto result = std::from_chars(first, last, parsed, std::chars_format::general);
  if (result.ec != std::errc() || result.ptr != last || !std::isfinite(parsed)) return false;
  value = negative ? -parsed : parsed;
  return true;
}

std::string formatNumber(double value, int decimals) {
  if (std::isnan(value)) return "nan";
  if (std::isinf(value)) return value > 0.0 ? "inf" : "-inf";
  // to_chars writes the C locale's form whatever locale the process runs in ("%.17g" / "%.*f" otherwise).
  char buffer[kNumberBufferSize];
  const auto result = decimals < 0
                          ? std::to_chars(buffer, buffer + sizeof buffer, value, std::chars_format::general,
                                          kRoundTripDigits)
                          : std::to_chars(buffer, buffer + sizeof buffer, value, std::chars_format::fixed,
                                          std::min(decimals, kMaxDecimals));
  std::string text(buffer, result.ptr);
  if (decimals < 0) return text;
  if (text[0] == '-' && text.find_first_not_of("0.", 1) == std::string::npos) text.erase(0, 1);
  return text;
}

double shownValue(double value, int decimals, const OutputOptions& options) {
  double shown = value;
  if (!options.fullPrecision && std::isfinite(value)) parseNumber(formatNumber(value, decimals), shown);
  return shown;
}

OutputOptions outputOptionsFor(const CLI::App& command) {
  const CLI::App* root = &command;
  while (root->get_parent() != nullptr) root = root->get_parent();
  OutputOptions options;
  options.json = root->count("--json") > 0;
  options.fullPrecision = root->count("--full-precision") > 0;
  return options;
}

CLI::Option* requireNumberText(CLI::Option* option) {
  return option->check(CLI::Validator(
      [](const std::string& text) {
        double value = 0.0;
        return parseNumber(text, value) ? std::string() : "expected a number, got " + quoteForMessage(text);
      },
      "NUMBER"));
}

std::shared_ptr<std::string> addInputArgument(CLI::App& verb) {
  auto path = std::make_shared<std::string>();
  verb.add_option("file", *path, "CSV input file (default: standard input)");
  return path;
}

void finishVerb(int status) {
  if (status != kExitOk) throw CLI::RuntimeError(status);
}

RowReader::RowReader(std::istream& in, std::vector<std::string> inputNames, bool numericInput)
    : in_(in), inputNames_(std::move(inputNames)), numericInput_(numericInput) {}

bool RowReader::isHeader(const std::vector<std::string>& fields) const {
  if (fields.size() == inputNames_.size() &&
      std::equal(fields.begin(), fields.end(), inputNames_.begin(), equalNoCase)) {
    return true;
  }
  // Otherwise, for numbers, a line of names: every field starts with a letter. A mistyped first number such
  // as "1O" is therefore reported as a bad row instead of being skipped as a header.
  return numericInput_ && std::all_of(fields.begin(), fields.end(), [](const std::string& f) {
           return !f.empty() && (std::isalpha(static_cast<unsigned char>(f[0])) || f[0] == '_');
         });
}

bool RowReader::next(InputRow& row) {
  std::string line;
  while (std::getline(in_, line)) {
    ++lineNumber_;
    if (lineNumber_ == 1 && line.rfind(kUtf8ByteOrderMark, 0) == 0) line.erase(0, sizeof kUtf8ByteOrderMark - 1);
    if (!isContentLine(line)) continue;
    bool unclosedQuote = false;
    std::vector<std::string> fields = splitCsv(line, unclosedQuote);
    const bool first = !seenContent_;
    seenContent_ = true;
    if (first && isHeader(fields)) continue;
    row.lineNumber = lineNumber_;
    row.fields = std::move(fields);
    row.unclosedQuote = unclosedQuote;
    row.numbers.clear();
    return true;
  }
  return false;
}

std::unique_ptr<std::istream> openInput(const std::string& path, std::string& error) {
  if (path.empty() || path == "-") {
    // A non-owning view of stdin, so that callers hold every input the same way.
    auto in = std::make_unique<std::istream>(std::cin.rdbuf());
    return in;
  }
  auto file = std::make_unique<std::ifstream>(path);
  if (!*file) {
    error = "cannot open '" + path + "': " + std::strerror(errno);
    return nullptr;
  }
  return file;
}

RowWriter::RowWriter(std::ostream& out, std::vector<Column> columns, OutputOptions options)
    : out_(out), columns_(std::move(columns)), options_(options) {}

RowWriter::~RowWriter() { finish(); }

void RowWriter::setJsonEnvelope(std::vector<JsonGroup> groups, std::string rowsKey) {
  envelopeGroups_ = std::move(groups);
  envelopeRowsKey_ = std::move(rowsKey);
}

void RowWriter::start() {
  if (started_) return;
  started_ = true;
  if (options_.json) {
    if (!envelopeRowsKey_.empty()) {
      out_ << '{';
      for (const JsonGroup& group : envelopeGroups_)
        out_ << nlohmann::json(group.name).dump() << ':' << jsonObject(group.columns, group.cells) << ',';
      out_ << nlohmann::json(envelopeRowsKey_).dump() << ':';
    }
    out_ << '[';
    return;
  }
  for (std::size_t i = 0; i < columns_.size(); ++i) out_ << (i ? "," : "") << quoteCsv(columns_[i].name);
  out_ << '\n';
}

std::string RowWriter::csvCell(const Cell& cell, const Column& column) const {
  if (const auto* text = std::get_if<std::string>(&cell)) return quoteCsv(*text);
  return formatNumber(std::get<double>(cell), options_.fullPrecision ? -1 : column.decimals);
}

void RowWriter::write(const std::vector<Cell>& cells) {
  start();
  const std::size_t count = std::min(cells.size(), columns_.size());
  if (options_.json) {
    out_ << (rowsWritten_ ? ",\n" : "\n") << jsonObject(columns_, cells);
  } else {
    for (std::size_t i = 0; i < count; ++i) out_ << (i ? "," : "") << csvCell(cells[i], columns_[i]);
    out_ << '\n';
  }
  ++rowsWritten_;
}

std::string RowWriter::jsonObject(const std::vector<Column>& columns, const std::vector<Cell>& cells) const {
  nlohmann::ordered_json object = nlohmann::ordered_json::object();
  const std::size_t count = std::min(cells.size(), columns.size());
  for (std::size_t i = 0; i < count; ++i) {
    const Column& column = columns[i];
    if (const auto* text = std::get_if<std::string>(&cells[i])) {
      object[column.name] = *text;
      continue;
    }
    // The rounded value, so that JSON and CSV agree; JSON gives it back in its shortest exact form.
    object[column.name] = shownValue(std::get<double>(cells[i]), column.decimals, options_);
  }
  // Text echoed from the input may not be valid UTF-8 (a file in a legacy code page): such bytes are
  // written as U+FFFD instead of failing the whole output.
  return object.dump(-1, ' ', false, nlohmann::ordered_json::error_handler_t::replace);
}

void RowWriter::finish() {
  if (finished_) return;
  start();
  finished_ = true;
  if (options_.json) out_ << (rowsWritten_ ? "\n]" : "]") << (envelopeRowsKey_.empty() ? "\n" : "}\n");
  out_.flush();
}

std::string quoteForMessage(const std::string& text) {
  if (text.size() <= kMaxEchoBytes) return "'" + text + "'";
  // Cut before a UTF-8 continuation byte (10xxxxxx) never inside a character.
  std::size_t cut = kMaxEchoBytes;
  while (cut > 0 && (static_cast<unsigned char>(text[cut]) & 0xC0) == 0x80) --cut;
  return "'" + text.substr(0, cut) + "...'";
}

void reportBadRow(std::size_t lineNumber, const std::string& message) {
  // Control bytes of the input (NUL, a lone carriage return, escapes) are shown as \xNN, so that the
  // message stays one printable line.
  std::string shown;
  shown.reserve(message.size());
  for (const char c : message) {
    const auto byte = static_cast<unsigned char>(c);
    if (byte < 0x20 || byte == 0x7F) {
      char escaped[8];
      std::snprintf(escaped, sizeof escaped, "\\x%02X", byte);
      shown += escaped;
    } else {
      shown += c;
    }
  }
  std::cerr << "svy: line " << lineNumber << ": " << shown << '\n';
}

bool checkRow(const RowFormat& format, InputRow& row, std::string& error) {
  if (row.unclosedQuote) {
    error = "a double quote is not closed";
    return false;
  }
  // The library reads text up to a NUL byte: "12\0x" would pass as "12".
  for (const std::string& field : row.fields) {
    if (field.find('\0') != std::string::npos) {
      error = "a field holds a NUL byte";
      return false;
    }
  }
  if (!fieldCountFits(format, row.fields.size())) {
    error = fieldCountMessage(format, row.fields.size());
    return false;
  }
  row.numbers.clear();
  if (!format.numericInput) return true;
  row.numbers.resize(row.fields.size());
  for (std::size_t i = 0; i < row.fields.size(); ++i) {
    if (!parseNumber(row.fields[i], row.numbers[i])) {
      error = format.inputs[i] + ": " + quoteForMessage(row.fields[i]) + " is not a number";
      return false;
    }
  }
  return true;
}

bool parseNumberList(const std::string& text, std::size_t count, std::vector<double>& values) {
  bool unclosedQuote = false;
  const std::vector<std::string> fields = splitCsv(text, unclosedQuote);
  std::vector<double> parsed(fields.size());
  if (fields.size() != count || unclosedQuote) return false;
  for (std::size_t i = 0; i < fields.size(); ++i) {
    if (!parseNumber(fields[i], parsed[i])) return false;
  }
  values = std::move(parsed);
  return true;
}

int readAllRows(const std::string& inputPath, const RowFormat& format, const RowTaker& take) {
  std::string error;
  const std::unique_ptr<std::istream> in = openInput(inputPath, error);
  if (!in) {
    std::cerr << "svy: " << error << '\n';
    return kExitUsage;
  }
  RowReader reader(*in, format.inputs, format.numericInput);
  InputRow row;
  int status = kExitOk;
  while (reader.next(row)) {
    error.clear();
    if (!checkRow(format, row, error) || !take(row, error)) {
      reportBadRow(row.lineNumber, error.empty() ? "no result" : error);
      status = kExitBadRows;
    }
  }
  return status;
}

int runMultiRows(std::istream& in, std::ostream& out, const RowFormat& format, const OutputOptions& options,
                 const MultiRowHandler& handler) {
  RowReader reader(in, format.inputs, format.numericInput);
  RowWriter writer(out, format.outputs, options);
  int status = kExitOk;
  InputRow row;
  std::vector<std::vector<Cell>> rows;
  std::string error;
  while (reader.next(row)) {
    rows.clear();
    error.clear();
    if (!checkRow(format, row, error) || !handler(row, rows, error)) {
      reportBadRow(row.lineNumber, error.empty() ? "no result" : error);
      status = kExitBadRows;
      continue;
    }
    for (const std::vector<Cell>& cells : rows) writer.write(cells);
  }
  writer.finish();
  return status;
}

int runMultiRows(const std::string& inputPath, const RowFormat& format, const OutputOptions& options,
                 const MultiRowHandler& handler) {
  std::string error;
  const std::unique_ptr<std::istream> in = openInput(inputPath, error);
  if (!in) {
    std::cerr << "svy: " << error << '\n';
    return kExitUsage;
  }
  return runMultiRows(*in, std::cout, format, options, handler);
}

namespace {

// A one-row handler seen as a handler of several rows.
MultiRowHandler asMultiRow(const RowHandler& handler) {
  return [&handler](const InputRow& row, std::vector<std::vector<Cell>>& out, std::string& error) {
    out.emplace_back();
    return handler(row, out.back(), error);
  };
}

}  // namespace

int runRows(std::istream& in, std::ostream& out, const RowFormat& format, const OutputOptions& options,
            const RowHandler& handler) {
  return runMultiRows(in, out, format, options, asMultiRow(handler));
}

int runRows(const std::string& inputPath, const RowFormat& format, const OutputOptions& options,
            const RowHandler& handler) {
  return runMultiRows(inputPath, format, options, asMultiRow(handler));
}

}  // namespace svy_tool
