// What the model answers, as columns of the output.

#ifndef KESTREL_APPS_KESTREL_PREDICTIONCOLUMNS_H
#define KESTREL_APPS_KESTREL_PREDICTIONCOLUMNS_H

#include <cstddef>
#include <memory>
#include <string>
#include <vector>

namespace MCKestrel_800 {
class ClsResult;
class ScoreClsResult;
class ScoreModel;
class ScoreResult;
class ScoreValue;
}  // namespace MCKestrel_800

namespace kestrel_program {

class TableWriter;

/// The text of a value as the program writes it: numbers in their shortest form, dates and times in ISO 8601.
std::string TextOf(const MCKestrel_800::ScoreValue& value);

/// Writes a value that is there: a number as a number, others as their texts.
void WriteValue(const MCKestrel_800::ScoreValue& value, TableWriter& writer);

/// "prediction"; for classifications also "probability" and a "probability_" with the category's text for
/// each category of the target, in the order in which the target lists them. A target without a list has the
/// categories that the model gives for a case of zeros, and none when it cannot score that. A model that
/// keeps the categories' probabilities to itself has no columns for them.
class PredictionColumns {
 public:
  /// result  one that the model made, for its Score to fill. Both must outlive this object.
  PredictionColumns(MCKestrel_800::ScoreModel& model, MCKestrel_800::ScoreResult* result);
  ~PredictionColumns();
  PredictionColumns(const PredictionColumns&) = delete;
  PredictionColumns& operator=(const PredictionColumns&) = delete;

  const std::vector<std::string>& GetNames() const { return names_; }

  /// Writes the result as it is after Score; cells that it has nothing for are missing.
  void Write(TableWriter& writer);
  /// Writes missing cells.
  void WriteMissing(TableWriter& writer) const;

 private:
  void FindCategories(MCKestrel_800::ScoreModel& model);
  void FindCategoriesByScoring(MCKestrel_800::ScoreModel& model);
  void WriteCategories(TableWriter& writer);
  double FindProbability(std::size_t category);

  MCKestrel_800::ScoreResult* result_;
  MCKestrel_800::ScoreClsResult* classification_;  ///< the result, or null when it is no classification
  const MCKestrel_800::ClsResult* by_position_;  ///< the same, or null when its categories have no positions
  std::vector<std::unique_ptr<MCKestrel_800::ScoreValue>> categories_;
  std::vector<std::size_t> positions_;  ///< where the result of the last case had each category
  std::vector<std::string> names_;
};

}  // namespace kestrel_program

#endif  // KESTREL_APPS_KESTREL_PREDICTIONCOLUMNS_H
