#include "support/refdata.h"

#include <sys/stat.h>

namespace svy_test {

std::string refdataPath(const std::string& relative) { return std::string(SVY_REFDATA_DIR) + "/" + relative; }

bool refdataAvailable() {
  struct stat info {};
  return ::stat(SVY_REFDATA_DIR, &info) == 0 && S_ISDIR(info.st_mode);
}

std::string testdataPath(const std::string& relative) { return std::string(SVY_TESTDATA_DIR) + "/" + relative; }

}  // namespace svy_test
