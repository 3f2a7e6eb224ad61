// The whole svy command line: option parsing of every verb and the rows it then reads.
// Input: the argument words one per line, an empty line, then standard input. Words naming a path (with a
// '/') are dropped, so that the fuzzer cannot point the tool at /dev/zero or another endless file.
#include "fuzz_support.h"

#include "row_io.h"

#include <cstdlib>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size) {
  const std::string text(reinterpret_cast<const char*>(bytes), size);
  const std::size_t end = text.find("\n\n");
  std::vector<std::string> args;
  std::istringstream words(text.substr(0, end));
  for (std::string word; std::getline(words, word);) {
    if (word.find('/') == std::string::npos) args.push_back(word);
  }
  const std::string input = end == std::string::npos ? std::string() : text.substr(end + 2);
  const int status = svy_fuzz::runSvy(args, input);
  if (status != svy_tool::kExitOk && status != svy_tool::kExitBadRows && status != svy_tool::kExitUsage) {
    std::abort();  // an exit status outside the documented three
  }
  return 0;
}
