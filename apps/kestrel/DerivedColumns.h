// Derived fields as columns of the output.

#ifndef KESTREL_APPS_KESTREL_DERIVEDCOLUMNS_H
#define KESTREL_APPS_KESTREL_DERIVEDCOLUMNS_H

#include <string>
#include <vector>

#include "apps/kestrel/AddedColumns.h"
#include "apps/kestrel/LoadedModel.h"

namespace MCKestrel_800 {
class CaseRecord;
}  // namespace MCKestrel_800

namespace kestrel_program {

/// A column for each derived field: numbers, texts, and dates and times as tables have them: in ISO 8601, or
/// as numbers for the types that count days or seconds. What is missing is a missing cell.
class DerivedColumns : public AddedColumns {
 public:
  /// chosen  the fields to compute, in the columns' order; several in one text, with commas. Empty: all, in
  /// the
  ///         document's order.
  /// Errors: ProgramError kUsage for a name that is no derived field.
  DerivedColumns(LoadedFields fields, const std::vector<std::string>& chosen);
  ~DerivedColumns() override;

  const ColumnWords& GetWords() const override;
  const std::vector<const MCKestrel_800::ScoreDictVar*>& GetInputs() const override { return inputs_; }
  const std::vector<std::string>& GetNames() const override { return names_; }
  void BeginCase() override {}
  bool Compute(const CaseReader& cases, const TableRow& row, CaseReader::Fault& fault) override;
  void Write(bool is_computed, TableWriter& writer, Progress& progress) override;

 private:
  /// Where a column's value stands.
  struct Column {
    int slot;  ///< in the record of derived values
    MCKestrel_800::DateTimeType date_time_type;
  };

  static void WriteValue(const MCKestrel_800::ScoreValue& value, MCKestrel_800::DateTimeType type,
                         TableWriter& writer);

  LoadedFields fields_;
  std::vector<std::string> names_;
  std::vector<const MCKestrel_800::ScoreDictVar*> inputs_;
  std::vector<Column> columns_;
  const MCKestrel_800::CaseRecord* values_ = nullptr;  ///< of the case at hand
};

}  // namespace kestrel_program

#endif  // KESTREL_APPS_KESTREL_DERIVEDCOLUMNS_H
