#include "apps/kestrel/InputFile.h"

#include <cstdio>
#include <filesystem>

#include "apps/kestrel/ProgramError.h"
#include "apps/kestrel/SystemReason.h"

namespace kestrel_program {

bool IsStandardStream(const std::string& path) {
  return path == "-";
}

std::ifstream OpenForReading(const std::string& path) {
  const std::filesystem::path file_path = std::filesystem::u8path(path);
  std::error_code ignored;
  if (std::filesystem::is_directory(file_path, ignored)) {
    throw ProgramError(kInputOutput, path + ": this is a folder; a file is expected");
  }
  errno = 0;
  std::ifstream file(file_path, std::ios::binary);
  if (!file.is_open()) throw ProgramError(kInputOutput, path + ": cannot be opened" + SystemReason());
  return file;
}

InputFile::InputFile(const std::string& path)
    : name_(IsStandardStream(path) ? "standard input" : path), is_standard_(IsStandardStream(path)) {
  if (!is_standard_) file_ = OpenForReading(path);
}

std::size_t InputFile::Read(char* buffer, std::size_t size) {
  errno = 0;
  std::size_t got = 0;
  bool failed = false;
  if (is_standard_) {
    got = std::fread(buffer, 1, size, stdin);
    failed = std::ferror(stdin) != 0;
  } else {
    file_.read(buffer, static_cast<std::streamsize>(size));
    got = static_cast<std::size_t>(file_.gcount());
    failed = file_.bad();
  }
  if (failed) throw ProgramError(kInputOutput, name_ + ": cannot be read" + SystemReason());
  return got;
}

}  // namespace kestrel_program
