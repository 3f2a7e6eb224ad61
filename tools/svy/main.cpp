// svy: surveying computations on rows of CSV, one verb family per subcommand.
#include "command.h"

int main(int argc, char** argv) { return svy_tool::runCommand(argc, argv); }
