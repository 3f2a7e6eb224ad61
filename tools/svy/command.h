#pragma once
// The whole svy command line: parses the arguments, runs the verb and returns the process exit status.
// main() only calls it; the command-line fuzz target calls it too, with standard input and output
// redirected to memory.

namespace svy_tool {

// argv[0] is the program name, as in main(). Never throws: usage errors give kExitUsage, bad rows
// kExitBadRows, both after a one-line message on stderr.
int runCommand(int argc, const char* const* argv);

}  // namespace svy_tool
