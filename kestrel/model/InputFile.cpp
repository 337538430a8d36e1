#include "kestrel/model/InputFile.h"

#include <filesystem>
#include <system_error>

namespace MCKestrel_800 {

std::ifstream OpenInputFile(const std::string& utf8Name) {
  std::ifstream in;
  if (utf8Name.find('\0') != std::string::npos) return in;
  try {
    in.open(std::filesystem::u8path(utf8Name), std::ios::in | std::ios::binary);
  } catch (const std::system_error&) {
    // The name cannot be turned into one of the system's; there is no such file then.
  }
  return in;
}

}  // namespace MCKestrel_800
