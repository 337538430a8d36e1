#include "apps/kestrel/OutputFile.h"

#include <cstdint>
#include <cstdio>
#include <random>
#include <utility>

#include "apps/kestrel/InputFile.h"
#include "apps/kestrel/ProgramError.h"
#include "apps/kestrel/SystemReason.h"
#include "kestrel/platform/Terminal.h"

namespace kestrel_program {
namespace fs = std::filesystem;
namespace {

/// A name beside the target that no other run uses.
fs::path TemporaryNameFor(const fs::path& target) {
  static const char kDigits[] = "0123456789abcdef";
  std::random_device random;
  fs::path name = target;
  std::string suffix = ".part-";
  for (int i = 0; i < 12; ++i)
    suffix += kDigits[random() % 16];
  name += suffix;
  return name;
}

}  // namespace

OutputFile::OutputFile(const std::string& path)
    : name_(IsStandardStream(path) ? "standard output" : path), is_standard_(IsStandardStream(path)) {
  buffer_.reserve(kBlock + kBlock / 4);
  if (is_standard_) {
    file_ = stdout;
    return;
  }
  target_ = fs::u8path(path);
  std::error_code failure;
  const fs::file_status status = fs::status(target_, failure);
  if (fs::is_directory(status)) {
    throw ProgramError(kInputOutput, name_ + ": this is a folder; the name of a file is expected");
  }
  if (MCKestrel_800::IsDevice(path)) {
    Open(target_);
    return;
  }
  if (fs::exists(status)) {
    // Through a link the file that it points to is replaced, not the link.
    const fs::path real = fs::canonical(target_, failure);
    if (!failure) target_ = real;
  }
  temporary_ = TemporaryNameFor(target_);
  MCKestrel_800::RemoveWhenInterrupted(temporary_.u8string());
  Open(temporary_);
  // Who may read the file that is replaced may read the new one, and nobody else.
  if (fs::exists(status)) fs::permissions(temporary_, status.permissions(), failure);
}

OutputFile::~OutputFile() {
  RemoveTemporary();
  Close();
}

void OutputFile::Open(const fs::path& path) {
  errno = 0;
  file_ = MCKestrel_800::OpenForWriting(path.u8string());
  if (file_ != nullptr) {
    // The text comes in large blocks already.
    std::setvbuf(file_, nullptr, _IONBF, 0);
    return;
  }
  const std::string reason = SystemReason();
  RemoveTemporary();
  throw ProgramError(kInputOutput, name_ + ": cannot be written" + reason);
}

bool OutputFile::Close() noexcept {
  if (is_standard_ || file_ == nullptr) return true;
  return std::fclose(std::exchange(file_, nullptr)) == 0;
}

void OutputFile::RemoveTemporary() noexcept {
  if (temporary_.empty()) return;
  Close();
  std::error_code ignored;
  fs::remove(temporary_, ignored);
  temporary_.clear();
  MCKestrel_800::RemoveWhenInterrupted(std::string());
}

void OutputFile::FailToWrite() const {
  throw ProgramError(kInputOutput, name_ + ": writing failed" + SystemReason());
}

void OutputFile::Flush() {
  errno = 0;
  if (std::fwrite(buffer_.data(), 1, buffer_.size(), file_) != buffer_.size()) FailToWrite();
  buffer_.clear();
}

void OutputFile::Finish() {
  Flush();
  if (is_standard_) {
    if (std::fflush(stdout) != 0) FailToWrite();
    return;
  }
  if (!Close()) FailToWrite();
  if (temporary_.empty()) return;
  std::error_code failure;
  fs::rename(temporary_, target_, failure);
  if (failure) throw ProgramError(kInputOutput, name_ + ": cannot be put in place: " + failure.message());
  temporary_.clear();
  MCKestrel_800::RemoveWhenInterrupted(std::string());
}

}  // namespace kestrel_program
