#pragma once
// A small reader for the numeric reference tables: a header line of names, then rows of numbers. Fields
// that are not numbers (notes) read as NaN; a missing file gives an empty table, which the caller asserts on.
#include <cmath>
#include <cstdlib>
#include <fstream>
#include <sstream>
#include <string>
#include <vector>

namespace svy_test {

struct CsvTable {
  std::vector<std::string> names;
  std::vector<std::vector<double>> rows;

  // Index of a column by name; the size of names when absent (so a lookup error shows as a failed row).
  std::size_t column(const std::string& name) const {
    std::size_t i = 0;
    while (i < names.size() && names[i] != name) ++i;
    return i;
  }
};

inline CsvTable readCsvTable(const std::string& path) {
  CsvTable table;
  std::ifstream in(path);
  std::string line;
  const auto split = [](const std::string& text) {
    std::vector<std::string> fields;
    std::stringstream stream(text);
    std::string field;
    while (std::getline(stream, field, ',')) fields.push_back(field);
    return fields;
  };
  if (std::getline(in, line)) table.names = split(line);
  while (std::getline(in, line)) {
    if (line.empty()) continue;
    std::vector<double> row;
    for (const std::string& field : split(line)) {
      char* end = nullptr;
      const double value = std::strtod(field.c_str(), &end);
      row.push_back(end != field.c_str() ? value : std::nan(""));
    }
    table.rows.push_back(row);
  }
  return table;
}

}  // namespace svy_test
