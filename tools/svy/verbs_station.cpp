// svy station: chainages to station text ("1+234.57" with an interval of 1000 m) and back.
#include "row_io.h"
#include "verbs.h"

#include "svymath/formats/station_text.h"

#include <CLI/CLI.hpp>

#include <cctype>
#include <climits>
#include <cmath>
#include <memory>
#include <string>
#include <vector>

namespace {

// Chainages to 0.1 mm, like the other lengths of the tool.
constexpr int kChainageDecimals = 4;

// The station texts a file may hold: metres ("1234.5") or a count of intervals and metres ("1+234.5"), each
// part with an optional sign ("-1+-234.5") and the metres with a decimal point or comma, then at most a
// unit word ("2+3 m"). The library's reader ignores whatever follows the last number, which suits text
// typed into a host's field; in a file a tail of digits or separators is rather a typing error or a
// thousands separator ("1,234.5" would read as 1.234 m), so it is refused here instead of giving a wrong
// chainage.
bool isStationText(const std::string& text) {
  std::size_t i = 0;
  const auto skipSign = [&] {
    if (i < text.size() && (text[i] == '+' || text[i] == '-')) ++i;
  };
  const auto countDigits = [&] {
    const std::size_t start = i;
    while (i < text.size() && std::isdigit(static_cast<unsigned char>(text[i]))) ++i;
    return i - start;
  };
  skipSign();
  std::size_t wholeDigits = countDigits();
  if (i < text.size() && text[i] == '+') {
    if (wholeDigits == 0) return false;
    ++i;
    skipSign();
    wholeDigits = countDigits();
  }
  std::size_t fractionDigits = 0;
  if (i < text.size() && (text[i] == '.' || text[i] == ',')) {
    ++i;
    fractionDigits = countDigits();
  }
  while (i < text.size() && text[i] == ' ') ++i;
  while (i < text.size() && std::isalpha(static_cast<unsigned char>(text[i]))) ++i;
  return i == text.size() && wholeDigits + fractionDigits > 0;
}

// The station interval option: metres per station unit, e.g. 1000 or 100.
void addIntervalOption(CLI::App& verb, double& interval) {
  svy_tool::requireNumberText(verb.add_option("--interval", interval, "Metres per station unit (e.g. 1000 or 100)"))
      ->required()
      ->check(CLI::PositiveNumber);
}

void addFormat(CLI::App& family) {
  CLI::App* verb = family.add_subcommand("format", "Chainages to station text: one chainage per row");
  auto interval = std::make_shared<double>(0.0);
  addIntervalOption(*verb, *interval);
  const std::shared_ptr<std::string> input = svy_tool::addInputArgument(*verb);
  verb->callback([verb, input, interval] {
    const svy_tool::RowFormat format{{"chainage"}, true, {{"chainage", kChainageDecimals}, {"text", 0}}};
    svy_tool::finishVerb(svy_tool::runRows(
        *input, format, svy_tool::outputOptionsFor(*verb),
        [interval](const svy_tool::InputRow& row, std::vector<svy_tool::Cell>& out, std::string& error) {
          const double chainage = row.numbers[0];
          // The count of intervals is a 32-bit int in the text; beyond it the text would be meaningless.
          if (!(std::fabs(std::trunc(chainage / *interval)) <= static_cast<double>(INT_MAX))) {
            error = "chainage too large for a station text at this interval";
            return false;
          }
          out = {chainage, StnToString(chainage, *interval).ToNarrow()};
          return true;
        }));
  });
}

void addParse(CLI::App& family) {
  CLI::App* verb = family.add_subcommand("parse", "Station texts to chainages: one text per row");
  auto interval = std::make_shared<double>(0.0);
  addIntervalOption(*verb, *interval);
  const std::shared_ptr<std::string> input = svy_tool::addInputArgument(*verb);
  verb->callback([verb, input, interval] {
    const svy_tool::RowFormat format{{"text"}, false, {{"text", 0}, {"chainage", kChainageDecimals}}};
    svy_tool::finishVerb(svy_tool::runRows(
        *input, format, svy_tool::outputOptionsFor(*verb),
        [interval](const svy_tool::InputRow& row, std::vector<svy_tool::Cell>& out, std::string& error) {
          const std::string& text = row.fields[0];
          double chainage = 0.0;
          if (!isStationText(text) || StnFromString(svy_text::CSvyString(text.c_str()), chainage, *interval) != 1 ||
              !std::isfinite(chainage)) {
            error = svy_tool::quoteForMessage(text) + " is not a station";
            return false;
          }
          out = {text, chainage};
          return true;
        }));
  });
}

}  // namespace

void registerStationVerbs(CLI::App& app) {
  CLI::App* family = app.add_subcommand("station", "Station (chainage) text");
  family->require_subcommand(1);
  addFormat(*family);
  addParse(*family);
}
