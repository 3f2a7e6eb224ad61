#pragma once
// Runs the built svy binary in tests, as a user would from a shell.
//
//   #include "svy_runner.h"
//
//   TEST(CogoInverse, WritesAzimuthAndDistance) {
//     const svy_test::SvyResult r = svy_test::runSvy({"cogo", "inverse"}, "0,0,3,4\n");
//     EXPECT_EQ(r.exitStatus, 0) << r.err;
//     EXPECT_EQ(r.lines().at(0), "azimuth_deg,azimuth_dms,distance");
//   }
//
// The arguments exclude the program name. The text is given on the program's standard input (an empty text
// gives an empty input). For file input pass a path, for example one written with writeTempFile() or one under
// svy_test::examplesPath(). The binary's path comes from the build (SVY_TOOL_PATH), so the test always runs the
// svy of its own build tree.

#include <initializer_list>
#include <nlohmann/json.hpp>
#include <string>
#include <vector>

namespace svy_test {

struct SvyResult {
  int exitStatus = -1;  // the process exit status; 128 + signal number when killed by a signal
  std::string out;      // everything written to stdout
  std::string err;      // everything written to stderr

  // stdout split into lines, without the line ends.
  std::vector<std::string> lines() const;
  // stderr split into lines.
  std::vector<std::string> errLines() const;
};

// Runs svy with the arguments and the standard input text and waits for it.
SvyResult runSvy(const std::vector<std::string>& args, const std::string& stdinText = std::string());

// Writes the text to a new file in the temporary directory and returns its path; the file is removed when the
// test program exits.
std::string writeTempFile(const std::string& text, const std::string& suffix = ".csv");

// Path of a file in the repository's examples/ folder.
std::string examplesPath(const std::string& name);

// Runs svy with --json --full-precision before the arguments, expects exit status 0 and parses its output.
nlohmann::json runJson(const std::vector<std::string>& args, const std::string& stdinText = std::string());

// One CSV input line of numbers written with 17 significant digits, ending in a newline.
std::string csvRow(std::initializer_list<double> values);

// Splits one CSV line at commas (no quoting), for checking output columns.
std::vector<std::string> splitCsvLine(const std::string& line);

}  // namespace svy_test
