#include "unit_option.h"

#include <CLI/CLI.hpp>

#include <algorithm>

namespace svy_tool {

CLI::Option* addUnitOption(CLI::App& verb, const std::string& name, std::string& target,
                           const std::vector<std::string>& units, const std::string& description) {
  std::string list;
  for (const std::string& unit : units) list += (list.empty() ? "" : ", ") + unit;
  const CLI::Validator known(
      [units, list](std::string& value) -> std::string {
        if (std::find(units.begin(), units.end(), value) != units.end()) return {};
        return "unknown unit '" + value + "' (expected one of: " + list + ")";
      },
      "UNIT", "unit name");
  return verb.add_option(name, target, description + " (" + list + ")")->required()->check(known);
}

}  // namespace svy_tool
