// `kestrel check`: is this document good?

#ifndef KESTREL_APPS_KESTREL_CHECKCOMMAND_H
#define KESTREL_APPS_KESTREL_CHECKCOMMAND_H

#include <string>

#include "apps/kestrel/ExitCode.h"

namespace kestrel_program {

/// Reads the model, or the derived fields or the dictionary in the older format of a document without one,
/// and says on the standard output that it is good, with its kind and size. Errors: ProgramError that says
/// what is wrong and where; for a model that cannot be used beside a good dictionary in the older format,
/// after a line about that.
ExitCode Check(const std::string& model, const std::string& names_file);

}  // namespace kestrel_program

#endif  // KESTREL_APPS_KESTREL_CHECKCOMMAND_H
