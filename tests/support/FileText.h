// The bytes of a file as a text.

#ifndef KESTREL_TESTS_SUPPORT_FILETEXT_H
#define KESTREL_TESTS_SUPPORT_FILETEXT_H

#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>

namespace kestrel_tests {

/// The path is UTF-8. A file that cannot be opened fails the test.
inline std::string FileText(const std::string& path) {
  std::ifstream in(std::filesystem::u8path(path), std::ios::binary);
  EXPECT_TRUE(in.is_open()) << path;
  return std::string(std::istreambuf_iterator<char>(in), std::istreambuf_iterator<char>());
}

}  // namespace kestrel_tests

#endif  // KESTREL_TESTS_SUPPORT_FILETEXT_H
