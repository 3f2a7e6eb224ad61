#pragma once
// A small reader for the comma-separated reference tables of the geodesy tests: one header line of column
// names, then rows of numbers. Text cells read as NaN.
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

  // Index of a named column; columns.size() when absent.
  std::size_t column(const std::string& name) const {
    for (std::size_t i = 0; i < columns.size(); ++i)
      if (columns[i] == name) return i;
    return columns.size();
  }
};

inline std::vector<std::string> splitCsvLine(const std::string& line) {
  std::vector<std::string> cells;
  std::stringstream stream(line);
  std::string cell;
  while (std::getline(stream, cell, ',')) {
    if (!cell.empty() && cell.back() == '\r') cell.pop_back();
    cells.push_back(cell);
  }
  return cells;
}

inline double csvNumber(const std::string& cell) {
  char* end = nullptr;
  const double value = std::strtod(cell.c_str(), &end);
  return (end != cell.c_str() && *end == '\0') ? value : std::numeric_limits<double>::quiet_NaN();
}

// Reads the file; an unreadable file gives a table without columns.
inline CsvTable readCsvTable(const std::string& path) {
  CsvTable table;
  std::ifstream in(path);
  std::string line;
  if (!std::getline(in, line)) return table;
  table.columns = splitCsvLine(line);
  while (std::getline(in, line)) {
    if (line.empty()) continue;
    std::vector<double> row;
    for (const std::string& cell : splitCsvLine(line)) row.push_back(csvNumber(cell));
    row.resize(table.columns.size(), std::numeric_limits<double>::quiet_NaN());
    table.rows.push_back(row);
  }
  return table;
}

}  // namespace svy_test
