// A folder for the files that a test writes, gone when the test is over.

#ifndef KESTREL_TESTS_SUPPORT_TEMPFOLDER_H
#define KESTREL_TESTS_SUPPORT_TEMPFOLDER_H

#include <gtest/gtest.h>

#include <atomic>
#include <chrono>
#include <filesystem>
#include <fstream>
#include <string>
#include <system_error>

namespace kestrel_tests {

/// Makes a new, empty folder. Tests that run at once, in one process or several, get different ones.
class TempFolder {
 public:
  TempFolder() {
    static std::atomic<unsigned> count{0};
    const auto now = std::chrono::steady_clock::now().time_since_epoch().count();
    path_ = std::filesystem::u8path(testing::TempDir()) /
            ("kestrel_" + std::to_string(now) + "_" + std::to_string(count.fetch_add(1)));
    std::filesystem::create_directories(path_);
  }
  ~TempFolder() {
    std::error_code ignored;
    std::filesystem::remove_all(path_, ignored);
  }
  TempFolder(const TempFolder&) = delete;
  TempFolder& operator=(const TempFolder&) = delete;

  const std::filesystem::path& GetPath() const { return path_; }

  /// The UTF-8 path of a file in the folder, which need not exist.
  std::string PathOf(const std::string& utf8Name) const {
    return (path_ / std::filesystem::u8path(utf8Name)).u8string();
  }

  /// Writes a file byte for byte and returns its UTF-8 path.
  std::string Write(const std::string& utf8Name, const std::string& content) const {
    std::ofstream out(path_ / std::filesystem::u8path(utf8Name), std::ios::binary);
    out << content;
    EXPECT_TRUE(out.flush().good()) << utf8Name;
    return PathOf(utf8Name);
  }

 private:
  std::filesystem::path path_;
};

}  // namespace kestrel_tests

#endif  // KESTREL_TESTS_SUPPORT_TEMPFOLDER_H
