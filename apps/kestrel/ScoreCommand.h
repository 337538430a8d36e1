// `kestrel score`: a table in, its predictions out.

#ifndef KESTREL_APPS_KESTREL_SCORECOMMAND_H
#define KESTREL_APPS_KESTREL_SCORECOMMAND_H

#include <string>

#include "apps/kestrel/ExitCode.h"
#include "apps/kestrel/TableRun.h"

namespace kestrel_program {

struct ScoreOptions {
  TableOptions table;
  std::string names_file;  ///< empty: the standard's model elements
  bool shows_all = false;  ///< predictions also where the document declares output fields
  bool explains = false;   ///< tells which parts of the model led to each prediction
};

/// Returns kDone, or kSomeCasesFailed when it goes on after faults and met some. Errors: ProgramError.
ExitCode Score(const ScoreOptions& options);

}  // namespace kestrel_program

#endif  // KESTREL_APPS_KESTREL_SCORECOMMAND_H
