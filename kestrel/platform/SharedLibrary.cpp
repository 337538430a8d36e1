// The part of library loading that is the same on every system.

#include "kestrel/platform/SharedLibrary.h"

#include <cstring>

namespace MCKestrel_800 {
namespace {

/// Lower-cases ASCII letters alone: suffixes are ASCII, and the process locale has no say in file names.
char ToLower(char c) {
  return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c;
}

bool EndsWith(const std::string& name, const char* suffix, size_t length) {
  const size_t start = name.size() - length;
  for (size_t i = 0; i < length; ++i) {
    if (ToLower(name[start + i]) != suffix[i]) return false;
  }
  return true;
}

}  // namespace

SharedLibrary::SharedLibrary(const std::string& fileName) : file_name_(fileName) {}

SharedLibrary::~SharedLibrary() = default;

std::string SharedLibrary::WithSuffix(const std::string& name) {
  const char* suffix = GetSuffix();
  const size_t length = std::strlen(suffix);
  return name.size() > length && EndsWith(name, suffix, length) ? name : name + suffix;
}

}  // namespace MCKestrel_800
