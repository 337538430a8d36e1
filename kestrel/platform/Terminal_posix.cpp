#include <unistd.h>

#include "kestrel/platform/Terminal.h"

namespace MCKestrel_800 {

bool IsErrorStreamTerminal() {
  return isatty(STDERR_FILENO) == 1;
}

void UseBinaryStandardStreams() {}

std::vector<std::string> CommandLineArguments(int argc, const char* const* argv) {
  return std::vector<std::string>(argv, argv + argc);
}

}  // namespace MCKestrel_800
