// `kestrel check`: is this document good?

#ifndef KESTREL_APPS_KESTREL_CHECKCOMMAND_H
#define KESTREL_APPS_KESTREL_CHECKCOMMAND_H

#include <string>

#include "apps/kestrel/ExitCode.h"

namespace kestrel_program {

/// Reads the model, or the derived fields of a document without one, and says on the standard output that it
/// is good, with its kind and size. Errors: ProgramError that says what is wrong and where.
ExitCode Check(const std::string& model, const std::string& names_file);

}  // namespace kestrel_program

#endif  // KESTREL_APPS_KESTREL_CHECKCOMMAND_H
