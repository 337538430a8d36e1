#include <langinfo.h>

#include <clocale>
#include <cstdlib>

#include "kestrel/platform/Environment.h"

namespace MCKestrel_800 {

bool SetEnvironmentVariableText(const std::string& name, const std::string& value) {
  return setenv(name.c_str(), value.c_str(), 1) == 0;
}

bool SetLocaleFromEnvironment() {
  return std::setlocale(LC_ALL, "") != nullptr;
}
bool SetLocaleByName(const std::string& name) {
  return std::setlocale(LC_ALL, name.c_str()) != nullptr;
}

std::string CharacterLocaleName() {
  const char* name = std::setlocale(LC_CTYPE, nullptr);
  return name == nullptr ? std::string() : name;
}

bool NarrowTextIsUtf8ByDefault() {
  return true;
}
long CodePageNumber() {
  return 0;
}
std::string CodePageName() {
  return nl_langinfo(CODESET);
}

}  // namespace MCKestrel_800
