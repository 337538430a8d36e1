#include <windows.h>

#include <clocale>
#include <cstdlib>

#include "kestrel/platform/Environment.h"

namespace MCKestrel_800 {

// The C runtime's own copy of the environment is the one that getenv and setlocale read.
bool SetEnvironmentVariableText(const std::string& name, const std::string& value) {
  return _putenv((name + "=" + value).c_str()) == 0;
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
  return false;
}
long CodePageNumber() {
  return static_cast<long>(GetACP());
}
std::string CodePageName() {
  return "windows-" + std::to_string(GetACP());
}

}  // namespace MCKestrel_800
