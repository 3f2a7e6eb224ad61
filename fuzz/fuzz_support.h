#pragma once
// Helpers shared by the fuzz targets: raw doubles (NaN, infinities and denormals included) from the
// fuzzer's bytes, and the svy command run in memory with standard input, output and error redirected.
#include <fuzzer/FuzzedDataProvider.h>

#include <cstdint>
#include <cstring>
#include <iostream>
#include <sstream>
#include <streambuf>
#include <string>
#include <vector>

#include "command.h"

namespace svy_fuzz {

// Any bit pattern, so that NaN payloads, infinities and denormals all reach the code under test.
inline double rawDouble(FuzzedDataProvider& data) {
  const std::uint64_t bits = data.ConsumeIntegral<std::uint64_t>();
  double value = 0.0;
  std::memcpy(&value, &bits, sizeof value);
  return value;
}

// A stream buffer that accepts and forgets everything written to it.
class NullBuffer : public std::streambuf {
 protected:
  int_type overflow(int_type c) override { return traits_type::not_eof(c); }
  std::streamsize xsputn(const char*, std::streamsize count) override { return count; }
};

// Runs "svy <args>" with stdinText as standard input; what it writes is discarded. Returns the exit status.
inline int runSvy(const std::vector<std::string>& args, const std::string& stdinText) {
  NullBuffer sink;
  std::istringstream in(stdinText);
  std::streambuf* const oldIn = std::cin.rdbuf(in.rdbuf());
  std::streambuf* const oldOut = std::cout.rdbuf(&sink);
  std::streambuf* const oldErr = std::cerr.rdbuf(&sink);
  std::vector<const char*> argv{"svy"};
  for (const std::string& arg : args) argv.push_back(arg.c_str());
  const int status = svy_tool::runCommand(static_cast<int>(argv.size()), argv.data());
  std::cin.rdbuf(oldIn);
  std::cout.rdbuf(oldOut);
  std::cerr.rdbuf(oldErr);
  std::cin.clear();
  std::cout.clear();
  std::cerr.clear();
  return status;
}

}  // namespace svy_fuzz
