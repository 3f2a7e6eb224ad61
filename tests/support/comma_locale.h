#pragma once
// Switches the C runtime to an installed locale with a decimal comma for the life of the object, and back.
#include <clocale>
#include <string>

namespace svy_test {

class CDecimalCommaCLocale {
 public:
  CDecimalCommaCLocale() : previous_(std::setlocale(LC_ALL, nullptr)) {
    for (const char* name : {"de_DE.UTF-8", "de_DE.utf8", "fr_FR.UTF-8", "de_DE", "German_Germany.1252"}) {
      if (std::setlocale(LC_ALL, name) != nullptr && std::localeconv()->decimal_point[0] == ',') {
        active_ = true;
        return;
      }
    }
    std::setlocale(LC_ALL, previous_.c_str());
  }
  ~CDecimalCommaCLocale() { std::setlocale(LC_ALL, previous_.c_str()); }
  CDecimalCommaCLocale(const CDecimalCommaCLocale&) = delete;
  CDecimalCommaCLocale& operator=(const CDecimalCommaCLocale&) = delete;
  // False when no such locale is installed: the caller skips.
  bool active() const { return active_; }

 private:
  std::string previous_;
  bool active_ = false;
};

}  // namespace svy_test
