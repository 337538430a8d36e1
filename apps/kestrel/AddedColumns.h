// What a command puts beside the rows of a table.

#ifndef KESTREL_APPS_KESTREL_ADDEDCOLUMNS_H
#define KESTREL_APPS_KESTREL_ADDEDCOLUMNS_H

#include <string>
#include <vector>

#include "apps/kestrel/CaseReader.h"

namespace MCKestrel_800 {
class ScoreDictVar;
}  // namespace MCKestrel_800

namespace kestrel_program {

class Progress;
class TableWriter;

/// What messages call the columns and what they come from.
struct ColumnWords {
  const char* reader;     ///< what wants the inputs: "the model reads"
  const char* of_source;  ///< whose a column is: "the model's"
  const char* left_out;   ///< what a case that fails does without: "prediction"
  const char* they_lack;  ///< the same of several cases: "have no prediction"
};

/// Columns that are computed from the cases of a table, one case after the other.
class AddedColumns {
 public:
  AddedColumns() = default;
  AddedColumns(const AddedColumns&) = delete;
  AddedColumns& operator=(const AddedColumns&) = delete;
  virtual ~AddedColumns();

  virtual const ColumnWords& GetWords() const = 0;
  /// The variables that the table must have columns for. They stay these columns'.
  virtual const std::vector<const MCKestrel_800::ScoreDictVar*>& GetInputs() const = 0;
  /// A variable whose column is read when the table has it, behind the inputs; null for none.
  virtual const MCKestrel_800::ScoreDictVar* GetOptionalInput() const { return nullptr; }
  virtual const std::vector<std::string>& GetNames() const = 0;

  /// Called before a row is read; not every row can be.
  virtual void BeginCase() = 0;
  /// Computes the values of the case that was read from the row. False, with the reason, when there are none.
  virtual bool Compute(const CaseReader& cases, const TableRow& row, CaseReader::Fault& fault) = 0;
  /// Writes a cell for each column. `is_computed`: whether the case was read, and Compute gave true.
  /// `progress` is told what the user should know.
  virtual void Write(bool is_computed, TableWriter& writer, Progress& progress) = 0;
};

}  // namespace kestrel_program

#endif  // KESTREL_APPS_KESTREL_ADDEDCOLUMNS_H
