#include "svy_runner.h"

#include <gtest/gtest.h>

#include <fcntl.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <memory>
#include <sstream>
#include <stdexcept>

namespace svy_test {

namespace {

std::vector<std::string> splitLines(const std::string& text) {
  std::vector<std::string> lines;
  std::istringstream in(text);
  std::string line;
  while (std::getline(in, line)) lines.push_back(line);
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
  std::size_t written = 0;
  while (written < text.size()) {
    const ssize_t n = ::write(fd, text.data() + written, text.size() - written);
    if (n <= 0) break;
    written += static_cast<std::size_t>(n);
  }
  ::close(fd);
  return pattern;
}

// Files handed out by writeTempFile(), removed when the test program exits.
class TempFiles {
 public:
  ~TempFiles() {
    for (const std::string& path : paths_) std::remove(path.c_str());
  }
  std::string create(const std::string& text, const std::string& suffix) {
    paths_.push_back(createTempFile(text, suffix));
    return paths_.back();
  }

 private:
  std::vector<std::string> paths_;
};

TempFiles& tempFiles() {
  static TempFiles files;
  return files;
}

}  // namespace

std::vector<std::string> SvyResult::lines() const { return splitLines(out); }
std::vector<std::string> SvyResult::errLines() const { return splitLines(err); }

std::string writeTempFile(const std::string& text, const std::string& suffix) {
  return tempFiles().create(text, suffix);
}

std::string examplesPath(const std::string& name) { return std::string(SVY_EXAMPLES_DIR) + "/" + name; }

std::vector<std::string> splitCsvLine(const std::string& line) {
  std::vector<std::string> fields;
  std::string field;
  std::istringstream in(line);
  while (std::getline(in, field, ',')) fields.push_back(field);
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
  const std::string inPath = createTempFile(stdinText, ".in");
  const std::string outPath = createTempFile("", ".out");
  const std::string errPath = createTempFile("", ".err");

  std::vector<std::string> argvText;
  argvText.emplace_back(SVY_TOOL_PATH);
  argvText.insert(argvText.end(), args.begin(), args.end());
  std::vector<char*> argv;
  for (std::string& a : argvText) argv.push_back(a.data());
  argv.push_back(nullptr);

  SvyResult result;
  const pid_t pid = fork();
  if (pid < 0) {
    for (const std::string* path : {&inPath, &outPath, &errPath}) std::remove(path->c_str());
    return result;
  }
  if (pid == 0) {
    const int in = ::open(inPath.c_str(), O_RDONLY);
    const int out = ::open(outPath.c_str(), O_WRONLY | O_TRUNC);
    const int err = ::open(errPath.c_str(), O_WRONLY | O_TRUNC);
    if (in < 0 || out < 0 || err < 0) _exit(127);
    ::dup2(in, STDIN_FILENO);
    ::dup2(out, STDOUT_FILENO);
    ::dup2(err, STDERR_FILENO);
    ::execv(argv[0], argv.data());
    _exit(127);
  }
  int status = 0;
  pid_t waited = -1;
  do {
    waited = ::waitpid(pid, &status, 0);
  } while (waited < 0 && errno == EINTR);
  if (WIFEXITED(status)) {
    result.exitStatus = WEXITSTATUS(status);
  } else if (WIFSIGNALED(status)) {
    result.exitStatus = 128 + WTERMSIG(status);
  }
  result.out = readWhole(outPath);
  result.err = readWhole(errPath);
  for (const std::string* path : {&inPath, &outPath, &errPath}) std::remove(path->c_str());
  return result;
}

}  // namespace svy_test
