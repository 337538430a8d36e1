// The way of a table through a command: every row is read, gets columns added and is written.

#ifndef KESTREL_APPS_KESTREL_TABLERUN_H
#define KESTREL_APPS_KESTREL_TABLERUN_H

#include <memory>
#include <string>
#include <vector>

#include "apps/kestrel/CaseReader.h"
#include "apps/kestrel/ExitCode.h"
#include "apps/kestrel/InputFile.h"
#include "apps/kestrel/Progress.h"
#include "apps/kestrel/TableReader.h"
#include "apps/kestrel/TableWriter.h"

namespace kestrel_program {

class AddedColumns;
class OutputFile;

struct TableOptions {
  std::string document;
  std::string data = "-";
  std::string output = "-";
  char delimiter = 0;  ///< 0: found out from the header
  bool keep_all = false;
  std::vector<std::string> keep;     ///< columns to copy when not all are; several in one text, with commas
  std::vector<std::string> missing;  ///< what stands for a missing value beside the empty cell
  bool goes_on_after_faults = false;
  TableWriter::Format format = TableWriter::Format::kCsv;
  bool shows_statistics = false;
};

/// Refuses files that would be read twice or written over. To be called before anything is opened.
/// what  the document in messages: "the model".
/// Errors: ProgramError kUsage.
void RefuseClashes(const TableOptions& options, const char* what);

/// One run over a table.
class TableRun {
 public:
  /// Reads the table's header. Both arguments must outlive the run.
  /// Errors: ProgramError, for a table that cannot be read or lacks inputs.
  TableRun(const TableOptions& options, AddedColumns& added);
  ~TableRun();
  TableRun(const TableRun&) = delete;
  TableRun& operator=(const TableRun&) = delete;

  /// Reads and writes all rows. To be called once.
  /// Returns kDone, or kSomeCasesFailed when it goes on after faults and met some. Errors: ProgramError.
  ExitCode Run();

 private:
  void ChooseColumns();
  void BeginOutput(OutputFile& output);
  std::vector<std::size_t> ColumnsToRead() const;
  void HandleRow(const TableRow& row);
  void WriteKept(const TableRow& row);
  void HandleFault(const TableRow& row);
  ExitCode Report();

  const TableOptions& options_;
  AddedColumns& added_;
  InputFile input_;
  TableReader table_;
  CaseReader cases_;
  std::vector<std::size_t> kept_;
  std::vector<bool> kept_as_number_;
  std::unique_ptr<TableWriter> writer_;
  Progress progress_;
  CaseReader::Fault fault_;
};

}  // namespace kestrel_program

#endif  // KESTREL_APPS_KESTREL_TABLERUN_H
