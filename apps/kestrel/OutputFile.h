// Where the answers go: a file that appears only when it is complete, or the standard output.

#ifndef KESTREL_APPS_KESTREL_OUTPUTFILE_H
#define KESTREL_APPS_KESTREL_OUTPUTFILE_H

#include <cstddef>
#include <cstdio>
#include <filesystem>
#include <string>

namespace kestrel_program {

/// Collects text and writes it in large blocks.
///
/// A file is written beside its place under another name and takes its place in Finish; until then a file
/// that is already there stays as it is. When the object goes without Finish, or the process is interrupted,
/// the unfinished file is removed. A link is followed. What is no regular file, such as a device or a named
/// pipe, is written directly.
class OutputFile {
 public:
  /// A UTF-8 path, or "-" for the standard output. Errors: ProgramError kInputOutput.
  explicit OutputFile(const std::string& path);
  ~OutputFile();
  OutputFile(const OutputFile&) = delete;
  OutputFile& operator=(const OutputFile&) = delete;

  /// The text that is still to be written; append to it, then call FlushIfFull.
  std::string& GetBuffer() { return buffer_; }
  void FlushIfFull() {
    if (buffer_.size() >= kBlock) Flush();
  }

  /// Writes what is left and puts the file into its place.
  /// Errors: ProgramError kInputOutput, also when an earlier block did not reach its goal.
  void Finish();

 private:
  static constexpr std::size_t kBlock = 256 * 1024;

  void Flush();
  void Open(const std::filesystem::path& path);
  /// Whether closing went well.
  bool Close() noexcept;
  void RemoveTemporary() noexcept;
  [[noreturn]] void FailToWrite() const;

  std::string name_;
  std::string buffer_;
  bool is_standard_;
  std::filesystem::path target_;
  std::filesystem::path temporary_;  ///< empty when the target is written directly
  std::FILE* file_ = nullptr;        ///< the standard output is the system's to close
};

}  // namespace kestrel_program

#endif  // KESTREL_APPS_KESTREL_OUTPUTFILE_H
