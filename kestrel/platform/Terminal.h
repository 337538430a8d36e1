// The standard streams and the command line of a program.

#ifndef KESTREL_PLATFORM_TERMINAL_H
#define KESTREL_PLATFORM_TERMINAL_H

#include <string>
#include <vector>

#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

/// Whether a person sees the standard error stream.
KESTREL_API bool IsErrorStreamTerminal();

/// Makes standard input and output carry bytes as they are, line ends included.
KESTREL_API void UseBinaryStandardStreams();

/// The command line in UTF-8, whatever the system's own text is.
KESTREL_API std::vector<std::string> CommandLineArguments(int argc, const char* const* argv);

}  // namespace MCKestrel_800

#endif  // KESTREL_PLATFORM_TERMINAL_H
