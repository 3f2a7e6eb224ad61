#pragma once
// A reader for the comma-separated reference tables of the geodesy tests: one header line of column names,
// then rows of numbers. Text cells read as NaN; an unreadable file gives a table without columns.
#include <cstdlib>
#include <fstream>
#include <limits>
#include <sstream>
#include <string>
#include <vector>

namespace svy_test {

struct CsvTable {
  std::vector<std::string> columns;
  std::vector<std::vector<double>> rows;
  std::size_t column(const std::string& name) const {
    std::size_t i = 0;
    while (i < columns.size() && columns[i] != name) ++i;
    return i;
  }
};

inline CsvTable readCsvTable(const std::string& path) {
  CsvTable table;
  std::ifstream in(path);
  std::string line, cell;
  for (bool header = true; std::getline(in, line); header = false) {
    if (!line.empty() && line.back() == '\r') line.pop_back();
    if (line.empty()) continue;
    std::stringstream stream(line);
    std::vector<double> row;
    while (std::getline(stream, cell, ',')) {
      if (header) table.columns.push_back(cell);
      char* end = nullptr;
      const double value = std::strtod(cell.c_str(), &end);
      row.push_back(end != cell.c_str() && *end == '\0' ? value : std::numeric_limits<double>::quiet_NaN());
    }
    row.resize(table.columns.size(), std::numeric_limits<double>::quiet_NaN());
    if (!header) table.rows.push_back(row);
  }
  return table;
}

}  // namespace svy_test
