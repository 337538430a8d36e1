// Runs a fuzz target over files, so that the targets are built and their corpora tested with every compiler.

#include <algorithm>
#include <cstdint>
#include <cstdio>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>
#include <vector>

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size);

namespace {

std::vector<std::filesystem::path> FilesOf(int count, char** arguments) {
  std::vector<std::filesystem::path> files;
  for (int i = 1; i < count; ++i) {
    const std::filesystem::path path = std::filesystem::u8path(arguments[i]);
    if (!std::filesystem::is_directory(path)) {
      files.push_back(path);
      continue;
    }
    for (const auto& entry : std::filesystem::directory_iterator(path))
      files.push_back(entry.path());
  }
  std::sort(files.begin(), files.end());
  return files;
}

}  // namespace

int main(int argc, char** argv) {
  const std::vector<std::filesystem::path> files = FilesOf(argc, argv);
  // An empty corpus is a wrong path, not a success.
  if (files.empty()) {
    std::fprintf(stderr, "usage: %s FILE_OR_FOLDER...\nThere is no file to run.\n", argv[0]);
    return 2;
  }
  for (const auto& path : files) {
    // Said before it runs, because a fault ends the process.
    std::printf("%s\n", path.u8string().c_str());
    std::fflush(stdout);
    std::ifstream in(path, std::ios::binary);
    if (!in) {
      std::fprintf(stderr, "cannot open %s\n", path.u8string().c_str());
      return 2;
    }
    const std::string bytes((std::istreambuf_iterator<char>(in)), std::istreambuf_iterator<char>());
    // A copy of just that size lets the address sanitizer see a read beyond the last byte.
    const std::vector<uint8_t> exact(bytes.begin(), bytes.end());
    LLVMFuzzerTestOneInput(exact.data(), exact.size());
  }
  return 0;
}
