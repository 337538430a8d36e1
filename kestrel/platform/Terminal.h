// The edges of a command line program: its arguments, its standard streams, the files that it writes and the
// user's wish to stop.

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

/// Libraries are not looked for in the current folder any more, where anybody may have put some. For
/// programs; a library leaves that to its host. Nothing to do where the system does not look there anyway.
KESTREL_API void IgnoreLibrariesOfCurrentFolder();

/// Whether the path, in UTF-8, names a device that takes what is written, rather than a file that can be put
/// in another one's place.
KESTREL_API bool IsDevice(const std::string& path);

/// Opens a file for writing, byte for byte, in such a way that it can be removed while it is open. What is
/// there is cut off. The path is UTF-8. Null when that fails, with the reason in errno.
KESTREL_API std::FILE* OpenForWriting(const std::string& path);

/// From now on an interrupt or a request to end removes this one file, which OpenForWriting may have opened,
/// before the process ends; an empty path ends the watch. The path is UTF-8.
///
/// Threads: to be called from one thread.
KESTREL_API void RemoveWhenInterrupted(const std::string& path);

/// What an interrupt does to the file that is watched; called by the system's signal or console handler.
KESTREL_API void RemoveWatchedFile() noexcept;

}  // namespace MCKestrel_800

#endif  // KESTREL_PLATFORM_TERMINAL_H
