#pragma once
// Runs the svy binary of this build tree (SVY_TOOL_PATH) in tests, as a user would from a shell: the
// arguments exclude the program name, the text is given on standard input, and stdout and stderr come back
// through files, so that no pipe can fill up and block either side.
#include <gtest/gtest.h>
#include <sys/wait.h>

#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <initializer_list>
#include <nlohmann/json.hpp>
#include <sstream>
#include <string>
#include <vector>

namespace svy_test {

inline std::vector<std::string> split(const std::string& text, char separator = '\n') {
  std::vector<std::string> parts;
  std::istringstream in(text);
  for (std::string part; std::getline(in, part, separator);) parts.push_back(part);
  if (separator == ',' && !text.empty() && text.back() == ',') parts.emplace_back();
  return parts;
}

// Splits one CSV line at commas (no quoting), for checking output columns.
inline std::vector<std::string> splitCsvLine(const std::string& line) { return split(line, ','); }

struct SvyResult {
  int exitStatus = -1;  // 128 + signal number when killed by a signal
  std::string out, err;
  std::vector<std::string> lines() const { return split(out); }
  std::vector<std::string> errLines() const { return split(err); }
};

// Writes the text to a new file in the temporary directory; the file is removed when the test program exits.
inline std::string writeTempFile(const std::string& text, const std::string& suffix = ".csv") {
  static struct Files {
    std::vector<std::string> paths;
    ~Files() {
      for (const std::string& path : paths) std::remove(path.c_str());
    }
  } files;
  const char* dir = std::getenv("TMPDIR");
  std::string path = std::string(dir && *dir ? dir : "/tmp") + "/svy_test_XXXXXX" + suffix;
  const int fd = mkstemps(path.data(), static_cast<int>(suffix.size()));
  EXPECT_GE(fd, 0) << path;
  if (fd >= 0) std::fclose(fdopen(fd, "w"));
  std::ofstream(path, std::ios::binary) << text;
  files.paths.push_back(path);
  return path;
}

inline std::string readWhole(const std::string& path) {
  std::ostringstream text;
  text << std::ifstream(path, std::ios::binary).rdbuf();
  return text.str();
}

// Single-quoted for the shell.
inline std::string quoted(std::string word) {
  for (std::size_t k = 0; (k = word.find('\'', k)) != std::string::npos; k += 4) word.replace(k, 1, "'\\''");
  return "'" + word + "'";
}

inline SvyResult runSvy(const std::vector<std::string>& args, const std::string& stdinText = std::string()) {
  const std::string in = writeTempFile(stdinText, ".in"), out = writeTempFile("", ".out"),
                    err = writeTempFile("", ".err");
  std::string command = quoted(SVY_TOOL_PATH);
  for (const std::string& arg : args) command += " " + quoted(arg);
  const int status = std::system((command + " <" + quoted(in) + " >" + quoted(out) + " 2>" + quoted(err)).c_str());
  const SvyResult result{WIFEXITED(status) ? WEXITSTATUS(status) : -1, readWhole(out), readWhole(err)};
  for (const std::string& path : {in, out, err}) std::remove(path.c_str());
  return result;
}

// Path of a file in the repository's examples/ folder.
inline std::string examplesPath(const std::string& name) { return std::string(SVY_EXAMPLES_DIR) + "/" + name; }

// Runs svy with --json --full-precision before the arguments, expects exit status 0 and parses its output.
inline nlohmann::json runJson(std::vector<std::string> args, const std::string& stdinText = std::string()) {
  args.insert(args.begin(), {"--json", "--full-precision"});
  const SvyResult r = runSvy(args, stdinText);
  EXPECT_EQ(r.exitStatus, 0) << r.err;
  return nlohmann::json::parse(r.out, nullptr, false);
}

// One CSV input line of numbers written with 17 significant digits, ending in a newline.
inline std::string csvRow(std::initializer_list<double> values) {
  std::ostringstream row;
  row.precision(17);
  for (double v : values) row << (row.tellp() > 0 ? "," : "") << v;
  return row.str() + "\n";
}

}  // namespace svy_test
