// `kestrel derive`: a table in, its derived fields out.

#ifndef KESTREL_APPS_KESTREL_DERIVECOMMAND_H
#define KESTREL_APPS_KESTREL_DERIVECOMMAND_H

#include <string>
#include <vector>

#include "apps/kestrel/ExitCode.h"
#include "apps/kestrel/TableRun.h"

namespace kestrel_program {

struct DeriveOptions {
  TableOptions table;
  std::vector<std::string> fields;  ///< empty: all; several in one text, with commas
};

/// Returns kDone, or kSomeCasesFailed when it goes on after faults and met some. Errors: ProgramError.
ExitCode Derive(const DeriveOptions& options);

}  // namespace kestrel_program

#endif  // KESTREL_APPS_KESTREL_DERIVECOMMAND_H
