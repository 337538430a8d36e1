// `kestrel copy-table`: a table in, the same table out.

#ifndef KESTREL_APPS_KESTREL_COPYCOMMAND_H
#define KESTREL_APPS_KESTREL_COPYCOMMAND_H

#include <string>

#include "apps/kestrel/ExitCode.h"
#include "apps/kestrel/TableWriter.h"

namespace kestrel_program {

struct CopyOptions {
  std::string data = "-";
  std::string output = "-";
  char delimiter = 0;  ///< 0: found out from the header
  TableWriter::Format format = TableWriter::Format::kCsv;
};

/// Does with the table all that scoring does, but for the model: what a model costs is measured against it.
/// Rows must have as many cells as the header. Errors: ProgramError.
ExitCode CopyTable(const CopyOptions& options);

}  // namespace kestrel_program

#endif  // KESTREL_APPS_KESTREL_COPYCOMMAND_H
