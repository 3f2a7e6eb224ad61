#pragma once
// A reader for the comma-separated reference tables of the geodesy tests: one header line of column names,
// then rows of numbers, read column by column. Text cells read as NaN; an unreadable file gives no columns.
#include <cstdlib>
#include <fstream>
#include <limits>
#include <map>
#include <sstream>
#include <string>
#include <vector>

namespace svy_test {

using CsvColumns = std::map<std::string, std::vector<double>>;

inline CsvColumns readCsvColumns(const std::string& path) {
  std::ifstream in(path);
  std::vector<std::string> names;
  CsvColumns columns;
  std::string line, cell;
  for (bool header = true; std::getline(in, line); header = false) {
    if (!line.empty() && line.back() == '\r') line.pop_back();
    std::stringstream stream(line);
    for (std::size_t k = 0; std::getline(stream, cell, ','); ++k) {
      char* end = nullptr;
      const double value = std::strtod(cell.c_str(), &end);
      if (header)
        names.push_back(cell);
      else if (k < names.size())
        columns[names[k]].push_back(end != cell.c_str() && *end == '\0' ? value
                                                                        : std::numeric_limits<double>::quiet_NaN());
    }
  }
  return columns;
}

}  // namespace svy_test
