// What the model's document asks for by name, as columns of the output.

#ifndef KESTREL_APPS_KESTREL_OUTPUTCOLUMNS_H
#define KESTREL_APPS_KESTREL_OUTPUTCOLUMNS_H

#include <string>
#include <vector>

namespace MCKestrel_800 {
class ResultField;
class ScoreModel;
class ScoreResult;
class ScoreValue;
}  // namespace MCKestrel_800

namespace kestrel_program {

class TableWriter;

/// Whether an output field compares the prediction with the true value of the target, which the case then
/// needs.
bool ComparesWithTrueValue(const MCKestrel_800::ScoreModel& model);

/// A column for each output field that the model's document declares, in its order: numbers and texts; a
/// missing value and the empty text, which is what a text field without a value holds, are missing cells.
class OutputColumns {
 public:
  /// result  what the model's Score is to fill; it must outlive this object.
  OutputColumns(const MCKestrel_800::ScoreModel& model, MCKestrel_800::ScoreResult* result);
  ~OutputColumns();
  OutputColumns(const OutputColumns&) = delete;
  OutputColumns& operator=(const OutputColumns&) = delete;

  /// The fields' names; none when the document declares none, or the result has no place for them.
  const std::vector<std::string>& GetNames() const { return names_; }

  /// Forgets the case before: a row that cannot be read does not reach the model at all.
  void BeginCase();
  /// Writes what the model told since BeginCase, whether or not there is a prediction.
  void Write(TableWriter& writer);

 private:
  void FindValues();

  MCKestrel_800::ResultField* fields_;  ///< null when the result has none
  std::vector<std::string> names_;
  /// By column, found again when the result's stamp is another one; they stay the result's.
  std::vector<const MCKestrel_800::ScoreValue*> values_;
  unsigned long long layout_stamp_ = 0;
};

}  // namespace kestrel_program

#endif  // KESTREL_APPS_KESTREL_OUTPUTCOLUMNS_H
