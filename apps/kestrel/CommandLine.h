// The commands with their options.

#ifndef KESTREL_APPS_KESTREL_COMMANDLINE_H
#define KESTREL_APPS_KESTREL_COMMANDLINE_H

#include <string>
#include <vector>

#include "apps/kestrel/ExitCode.h"

namespace kestrel_program {

/// Does what the arguments say; the program's own name is not among them. Errors: ProgramError.
ExitCode RunCommandLine(const std::vector<std::string>& arguments);

}  // namespace kestrel_program

#endif  // KESTREL_APPS_KESTREL_COMMANDLINE_H
