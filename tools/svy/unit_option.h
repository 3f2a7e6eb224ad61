#pragma once
// A named-unit option of a verb ("--from ft-us"): the value must be one of a fixed list of names, and an
// unknown name is a one-line usage error that lists the accepted ones.
#include <cstddef>
#include <string>
#include <vector>

namespace CLI {
class App;
class Option;
}  // namespace CLI

namespace svy_tool {

// Adds a required option `name` to the verb whose value must be one of `units`; the value goes to `target`,
// which must outlive the verb's callback.
CLI::Option* addUnitOption(CLI::App& verb, const std::string& name, std::string& target,
                           const std::vector<std::string>& units, const std::string& description);

// The names of a verb's unit table (entries with a `name` member), for addUnitOption().
template <class Unit, std::size_t N>
std::vector<std::string> unitNames(const Unit (&units)[N]) {
  std::vector<std::string> names;
  for (const Unit& unit : units) names.emplace_back(unit.name);
  return names;
}

// The entry of the table with that name; the first entry for another name, which cannot reach a callback
// because addUnitOption() checks names before any row is read.
template <class Unit, std::size_t N>
const Unit& unitNamed(const Unit (&units)[N], const std::string& name) {
  for (const Unit& unit : units) {
    if (name == unit.name) return unit;
  }
  return units[0];
}

}  // namespace svy_tool
