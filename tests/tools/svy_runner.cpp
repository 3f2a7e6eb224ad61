#include "svy_runner.h"

#include <fcntl.h>
#include <gtest/gtest.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <sstream>
#include <stdexcept>

namespace svy_test {

namespace {

std::vector<std::string> splitLines(const std::string& text) {
  std::vector<std::string> lines;
  std::istringstream in(text);
  for (std::string line; std::getline(in, line);) lines.push_back(line);
  return lines;
}

std::string readWhole(const std::string& path) {
  std::ifstream in(path, std::ios::binary);
  std::ostringstream text;
  text << in.rdbuf();
  return text.str();
}

// A new file in the temporary directory holding the text.
std::string createTempFile(const std::string& text, const std::string& suffix) {
  const char* dir = std::getenv("TMPDIR");
  std::string pattern = std::string(dir && *dir ? dir : "/tmp") + "/svy_test_XXXXXX" + suffix;
  const int fd = mkstemps(pattern.data(), static_cast<int>(suffix.size()));
  if (fd < 0) throw std::runtime_error("cannot create a temporary file");
  ::close(fd);
  std::ofstream(pattern, std::ios::binary) << text;
  return pattern;
}

// Files handed out by writeTempFile(), removed when the test program exits.
struct TempFiles {
  std::vector<std::string> paths;
  ~TempFiles() {
    for (const std::string& path : paths) std::remove(path.c_str());
  }
};

}  // namespace

std::vector<std::string> SvyResult::lines() const { return splitLines(out); }
std::vector<std::string> SvyResult::errLines() const { return splitLines(err); }

std::string writeTempFile(const std::string& text, const std::string& suffix) {
  static TempFiles files;
  files.paths.push_back(createTempFile(text, suffix));
  return files.paths.back();
}

std::string examplesPath(const std::string& name) { return std::string(SVY_EXAMPLES_DIR) + "/" + name; }

std::vector<std::string> splitCsvLine(const std::string& line) {
  std::vector<std::string> fields;
  std::istringstream in(line);
  for (std::string field; std::getline(in, field, ',');) fields.push_back(field);
  if (!line.empty() && line.back() == ',') fields.emplace_back();
  return fields;
}

nlohmann::json runJson(const std::vector<std::string>& args, const std::string& stdinText) {
  std::vector<std::string> all = {"--json", "--full-precision"};
  all.insert(all.end(), args.begin(), args.end());
  const SvyResult r = runSvy(all, stdinText);
  EXPECT_EQ(r.exitStatus, 0) << r.err;
  return nlohmann::json::parse(r.out, nullptr, false);
}

std::string csvRow(std::initializer_list<double> values) {
  std::ostringstream row;
  row.precision(17);
  const char* separator = "";
  for (double v : values) {
    row << separator << v;
    separator = ",";
  }
  row << '\n';
  return row.str();
}

SvyResult runSvy(const std::vector<std::string>& args, const std::string& stdinText) {
  // The standard streams go through files: no pipe can fill up and block either side.
  const std::string paths[] = {createTempFile(stdinText, ".in"), createTempFile("", ".out"),
                               createTempFile("", ".err")};
  std::vector<std::string> argvText = {SVY_TOOL_PATH};
  argvText.insert(argvText.end(), args.begin(), args.end());
  std::vector<char*> argv;
  for (std::string& a : argvText) argv.push_back(a.data());
  argv.push_back(nullptr);

  SvyResult result;
  const pid_t pid = fork();
  if (pid == 0) {
    const int flags[] = {O_RDONLY, O_WRONLY | O_TRUNC, O_WRONLY | O_TRUNC};
    for (int stream = 0; stream < 3; ++stream) {
      const int fd = ::open(paths[stream].c_str(), flags[stream]);
      if (fd < 0 || ::dup2(fd, stream) < 0) _exit(127);  // stdin, stdout, stderr are 0, 1, 2
    }
    ::execv(argv[0], argv.data());
    _exit(127);
  }
  int status = 0;
  while (pid > 0 && ::waitpid(pid, &status, 0) < 0 && errno == EINTR) {
  }
  if (pid > 0 && WIFEXITED(status)) result.exitStatus = WEXITSTATUS(status);
  if (pid > 0 && WIFSIGNALED(status)) result.exitStatus = 128 + WTERMSIG(status);
  result.out = readWhole(paths[1]);
  result.err = readWhole(paths[2]);
  for (const std::string& path : paths) std::remove(path.c_str());
  return result;
}

}  // namespace svy_test
