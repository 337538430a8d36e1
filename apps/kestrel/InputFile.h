// Where tables and documents come from: a file or the standard input.

#ifndef KESTREL_APPS_KESTREL_INPUTFILE_H
#define KESTREL_APPS_KESTREL_INPUTFILE_H

#include <cstddef>
#include <fstream>
#include <string>

namespace kestrel_program {

/// Whether the path stands for the standard input: "-".
bool IsStandardStream(const std::string& path);

/// Opens a file to be read as bytes. The path is UTF-8.
/// Errors: ProgramError kInputOutput with the path and the system's reason.
std::ifstream OpenForReading(const std::string& path);

/// Bytes in blocks. The file is closed with the object.
class InputFile {
 public:
  /// A UTF-8 path, or "-" for the standard input. Errors as in OpenForReading.
  explicit InputFile(const std::string& path);
  InputFile(const InputFile&) = delete;
  InputFile& operator=(const InputFile&) = delete;

  /// Fills the buffer as far as there are bytes; fewer than `size` only at the end, where it gives 0 from
  /// then on. Errors: ProgramError kInputOutput when the system cannot read.
  std::size_t Read(char* buffer, std::size_t size);

  /// What messages call it: the path, or "standard input".
  const std::string& GetName() const { return name_; }

 private:
  std::string name_;
  bool is_standard_;
  std::ifstream file_;
};

}  // namespace kestrel_program

#endif  // KESTREL_APPS_KESTREL_INPUTFILE_H
