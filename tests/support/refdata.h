#pragma once
// Where the tests find their data. The shared reference folder beside the project is optional: a test that
// needs it calls SVY_SKIP_WITHOUT_REFDATA first. The repository's own test data is always present.
#include <string>

namespace svy_test {

// Full path of a file below the shared reference folder ("geodetic/x.csv").
std::string refdataPath(const std::string& relative);
// True when the shared reference folder is present beside the project.
bool refdataAvailable();
// Full path of a file below tests/data.
std::string testdataPath(const std::string& relative);

}  // namespace svy_test

#define SVY_SKIP_WITHOUT_REFDATA()                                                  \
  do {                                                                              \
    if (!::svy_test::refdataAvailable()) GTEST_SKIP() << "reference data absent";   \
  } while (0)
