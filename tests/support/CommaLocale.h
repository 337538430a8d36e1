// Sets the process and the C++ streams to a locale that writes a decimal comma and groups digits, for as long
// as it lives. Nothing that the library reads or writes may notice.

#ifndef KESTREL_TESTS_SUPPORT_COMMALOCALE_H
#define KESTREL_TESTS_SUPPORT_COMMALOCALE_H

#include <clocale>
#include <locale>
#include <string>

namespace kestrel_tests {

class CommaLocale {
 public:
  CommaLocale() : c_locale_(std::setlocale(LC_ALL, nullptr)) {
    before_ = std::locale::global(std::locale(std::locale::classic(), new Comma));
    // Where a real one is installed, the C library has it too.
    for (const char* name : {"de_DE.UTF-8", "de_DE", "fr_FR.UTF-8", "German"}) {
      if (std::setlocale(LC_ALL, name) != nullptr) break;
    }
  }
  ~CommaLocale() {
    std::locale::global(before_);
    std::setlocale(LC_ALL, c_locale_.c_str());
  }
  CommaLocale(const CommaLocale&) = delete;
  CommaLocale& operator=(const CommaLocale&) = delete;

 private:
  class Comma : public std::numpunct<char> {
    char do_decimal_point() const override { return ','; }
    char do_thousands_sep() const override { return '.'; }
    std::string do_grouping() const override { return "\3"; }
  };

  std::string c_locale_;
  std::locale before_;
};

}  // namespace kestrel_tests

#endif  // KESTREL_TESTS_SUPPORT_COMMALOCALE_H
