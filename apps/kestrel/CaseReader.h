// From the rows of a table to the cases of a model, or of derived fields.

#ifndef KESTREL_APPS_KESTREL_CASEREADER_H
#define KESTREL_APPS_KESTREL_CASEREADER_H

#include <cstddef>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "apps/kestrel/TableReader.h"
#include "kestrel/dictionary/CaseRecord.h"
#include "kestrel/foundation/DateTimeType.h"

namespace MCKestrel_800 {
class ScoreDictVar;
class StringValue;
}  // namespace MCKestrel_800

namespace kestrel_program {

/// Knows which column feeds which input, and reads those cells, each by its field's type: a number, a date or
/// time in the field's form, or a text. Empty cells and those on the list of missing texts are missing
/// values. Reading a row allocates nothing once texts as long as its own were read.
class CaseReader {
 public:
  /// What is wrong with a row.
  struct Fault {
    static constexpr std::size_t kWholeRow = static_cast<std::size_t>(-1);
    std::size_t column = kWholeRow;  ///< the position in the header
    std::string text;
  };

  /// inputs         the variables that are read; they must outlive this object
  /// optional       another one, read when the table has its column; null for none
  /// missing_texts  what stands for a missing value beside the empty cell
  /// reader         who reads them, as messages put it: "the model reads"
  /// Errors: ProgramError kData that names the inputs without a column and the columns that are there.
  CaseReader(TableReader& table, const std::vector<const MCKestrel_800::ScoreDictVar*>& inputs,
             const MCKestrel_800::ScoreDictVar* optional, const std::vector<std::string>& missing_texts,
             const char* reader);
  ~CaseReader();
  CaseReader(const CaseReader&) = delete;
  CaseReader& operator=(const CaseReader&) = delete;

  /// Fills the record. False, with the first fault found, when the row has another number of cells than the
  /// header or a cell does not read as its field's type.
  bool Read(const TableRow& row, Fault& fault);

  const MCKestrel_800::CaseRecord& GetRecord() const { return record_; }

  /// The columns that feed inputs, in the inputs' order, and that of the optional one if there is one.
  const std::vector<std::size_t>& GetColumns() const { return columns_; }
  /// Whether a column feeds an input that is a number.
  bool IsNumber(std::size_t column) const { return is_number_[column]; }

 private:
  enum class Kind { kNumber, kText, kDateTimeText, kDateTimeNumber };
  struct Input {
    std::string name;
    Kind kind;
    MCKestrel_800::DateTimeType date_time_type;
    std::size_t column;
    /// Of a text whose slot is empty because the case has none: the value that comes back into the slot.
    std::unique_ptr<MCKestrel_800::StringValue> parked;
  };

  void AddInput(const MCKestrel_800::ScoreDictVar& variable, std::size_t column);
  static Input MakeInput(const MCKestrel_800::ScoreDictVar& variable, std::size_t column);
  static std::string WhatIsAccepted(const Input& input);
  void AddSlot(const Input& input);
  bool IsMissing(std::string_view cell) const;
  void SetMissing(Input& input, int slot);
  void SetText(Input& input, int slot, std::string_view cell);
  bool SetNumber(const Input& input, int slot, std::string_view cell);
  bool SetDateTime(const Input& input, int slot, std::string_view cell);

  std::vector<Input> inputs_;
  std::vector<std::size_t> columns_;
  std::vector<bool> is_number_;  ///< by column of the table
  std::vector<std::string> missing_texts_;
  MCKestrel_800::CaseRecord record_;
  std::string scratch_;
};

}  // namespace kestrel_program

#endif  // KESTREL_APPS_KESTREL_CASEREADER_H
