// What systems have of special files.

#ifndef KESTREL_TESTS_SUPPORT_SYSTEMFILES_H
#define KESTREL_TESTS_SUPPORT_SYSTEMFILES_H

#include <filesystem>
#include <string>
#include <vector>

namespace kestrel_tests {

/// A device that takes whatever is written and holds nothing.
inline const char* NullDevice() {
#if defined(_WIN32)
  return "NUL";
#else
  return "/dev/null";
#endif
}

/// A device on which all writing fails, because it is full; empty where there is none.
inline const char* FullDevice() {
#if defined(_WIN32)
  return "";
#else
  return "/dev/full";
#endif
}

/// What the C library may say of a pipe that nobody reads from any more. Microsoft's knows the system's error
/// for it, that of Wine does not.
inline std::vector<std::string> BrokenPipeReasons() {
#if defined(_WIN32)
  return {"Broken pipe", "Invalid argument"};
#else
  return {"Broken pipe"};
#endif
}

/// Makes a link to a file. False where the system or the C++ library has no links.
inline bool MakeLink(const std::filesystem::path& target, const std::filesystem::path& link) {
#if defined(_WIN32)
  static_cast<void>(target);
  static_cast<void>(link);
  return false;
#else
  std::filesystem::create_symlink(target, link);
  return true;
#endif
}

/// Where a program looks for libraries: the variable and what stands between two folders.
#if defined(_WIN32)
constexpr char kLibraryPath[] = "PATH";
constexpr char kBetweenFolders = ';';
#else
constexpr char kLibraryPath[] = "LD_LIBRARY_PATH";
constexpr char kBetweenFolders = ':';
#endif

}  // namespace kestrel_tests

#endif  // KESTREL_TESTS_SUPPORT_SYSTEMFILES_H
