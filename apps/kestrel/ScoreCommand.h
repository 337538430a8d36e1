// `kestrel score`: a table in, its predictions out.

#ifndef KESTREL_APPS_KESTREL_SCORECOMMAND_H
#define KESTREL_APPS_KESTREL_SCORECOMMAND_H

#include <string>
#include <vector>

#include "apps/kestrel/ExitCode.h"
#include "apps/kestrel/TableWriter.h"

namespace kestrel_program {

struct ScoreOptions {
  std::string model;
  std::string data = "-";
  std::string output = "-";
  std::string names_file;  ///< empty: the standard's model elements
  char delimiter = 0;      ///< 0: found out from the header
  bool keep_all = false;
  std::vector<std::string> keep;     ///< columns to copy when not all are; several in one text, with commas
  std::vector<std::string> missing;  ///< what stands for a missing value beside the empty cell
  bool goes_on_after_faults = false;
  TableWriter::Format format = TableWriter::Format::kCsv;
  bool explains = false;  ///< tells which parts of the model led to each prediction
  bool shows_statistics = false;
};

/// Returns kDone, or kSomeCasesFailed when it goes on after faults and met some. Errors: ProgramError.
ExitCode Score(const ScoreOptions& options);

}  // namespace kestrel_program

#endif  // KESTREL_APPS_KESTREL_SCORECOMMAND_H
