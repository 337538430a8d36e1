// `kestrel describe`: what a model is and what it reads.

#ifndef KESTREL_APPS_KESTREL_DESCRIBECOMMAND_H
#define KESTREL_APPS_KESTREL_DESCRIBECOMMAND_H

#include <string>

#include "apps/kestrel/ExitCode.h"

namespace kestrel_program {

/// Writes the model's kind, version, target, inputs, derived and output fields to the standard output, as a
/// table for people or as one JSON object. A document without a model has derived fields alone, or in the
/// older format its dictionary; a model that it has all the same is told of on standard error. Errors:
/// ProgramError.
ExitCode Describe(const std::string& model, const std::string& names_file, bool as_json);

}  // namespace kestrel_program

#endif  // KESTREL_APPS_KESTREL_DESCRIBECOMMAND_H
