// The edges of a command line program: its arguments, its standard streams and the user's wish to stop.

#ifndef KESTREL_PLATFORM_TERMINAL_H
#define KESTREL_PLATFORM_TERMINAL_H

#include <cstdio>
#include <string>
#include <vector>

#include "kestrel/platform/Export.h"

namespace MCKestrel_800 {

/// To be called once, first of all: bytes pass the standard streams unchanged, a console shows UTF-8, and
/// writing where nobody reads any more fails like any other write instead of ending the process without a
/// word.
KESTREL_API void PrepareStandardStreams();

/// The program's arguments in UTF-8, the program's own name left out.
KESTREL_API std::vector<std::string> GetUtf8Arguments(int argc, const char* const* argv);

/// Whether the stream shows on a terminal rather than going to a file or a pipe.
KESTREL_API bool IsTerminal(std::FILE* stream);

/// From now on an interrupt or a request to end removes this one file before the process ends; an empty path
/// ends the watch. The path is UTF-8. Where the system cannot remove a file that is open, WasInterrupted
/// turns true instead, and the process has two seconds to clean up and end by itself.
///
/// Threads: to be called from one thread.
KESTREL_API void RemoveWhenInterrupted(const std::string& path);
KESTREL_API bool WasInterrupted();

}  // namespace MCKestrel_800

#endif  // KESTREL_PLATFORM_TERMINAL_H
