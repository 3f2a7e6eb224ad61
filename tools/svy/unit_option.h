#pragma once
// A named-unit option of a verb ("--from ft-us"): the value must be one of a fixed list of names, and an
// unknown name is a one-line usage error that lists the accepted ones.
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

}  // namespace svy_tool
