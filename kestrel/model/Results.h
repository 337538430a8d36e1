// The results that hosts and model libraries use: what a model writes for a case, held without allocating per
// case.

#ifndef KESTREL_MODEL_RESULTS_H
#define KESTREL_MODEL_RESULTS_H

#include <cstddef>
#include <memory>
#include <variant>
#include <vector>

#include "kestrel/foundation/DateTimeValue.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/model/ResultEntities.h"
#include "kestrel/model/ScoreClsResult.h"
#include "kestrel/model/ScoreRegResult.h"
#include "kestrel/platform/Export.h"
#include "kestrel/translate/ResultField.h"

namespace MCKestrel_800 {

/// A place for a copy of any value. A value of the class that was held before is written over it, so that a
/// result filled case after case allocates nothing: numbers and dates lie in the slot itself, and a text
/// keeps its room.
class KESTREL_API ResultValue {
 public:
  ResultValue();
  ~ResultValue();
  ResultValue(ResultValue&&) noexcept;
  ResultValue& operator=(ResultValue&&) noexcept;

  /// Copies the value.
  void Assign(const ScoreValue& value);
  /// Holds a number.
  void Assign(double number) {
    if (auto* held = std::get_if<NumericValue>(&held_)) {
      held->SetDoubleValue(number);
    } else {
      held_ = NumericValue(number);
    }
  }

  /// The value last assigned; null before the first one.
  const ScoreValue* Get() const;

 private:
  /// The last kind is for values of classes that are not the library's own.
  std::variant<std::monostate, NumericValue, StringValue, DateTimeValue, std::unique_ptr<ScoreValue>> held_;
};

/// The outcome of a classification: kind 0.
class KESTREL_API ClsResult : public ScoreClsResult {
 public:
  ClsResult();
  ~ClsResult() override;

  void SetPrediction(const ScoreValue* value) override;
  const ScoreValue* GetPrediction() const override;
  void Reset() override;
  void SetProbability(double probability) override;
  double GetProbability() const override;
  int GetResultKind() const override;

  void AddCategoryProbability(const ScoreValue* category, double probability) override;
  double GetCategoryProbability(const ScoreValue* category) const override;
  size_t GetCategoryCount() const override;

  /// The category at the position, in the order in which they were added; null past the end. Belongs to the
  /// result, valid until the result is filled again.
  const ScoreValue* GetCategory(size_t index) const;
  /// The probability at the position; 0.0 past the end.
  double GetProbability(size_t index) const;

  /// The parts of the model that led to this result. Belong to it.
  ResultEntities& GetEntities() { return entities_; }
  const ResultEntities& GetEntities() const { return entities_; }

  /// The output fields that the model's document declares; none when it declares none. Belong to the result.
  ResultField& GetOutputFields() { return output_fields_; }
  const ResultField& GetOutputFields() const { return output_fields_; }

 private:
  struct Entry {
    ResultValue category;
    double probability = 0.0;
  };

  ResultValue prediction_;
  bool has_prediction_ = false;
  double probability_ = 0.0;
  /// Entries past count_ are left from earlier cases, kept to be written over.
  std::vector<Entry> entries_;
  size_t count_ = 0;
  ResultEntities entities_;
  ResultField output_fields_;
};

/// The outcome of a regression: kind 1.
class KESTREL_API RegResult : public ScoreRegResult {
 public:
  RegResult();
  ~RegResult() override;

  void SetPrediction(const ScoreValue* value) override;
  const ScoreValue* GetPrediction() const override;
  void Reset() override;
  void SetProbability(double probability) override;
  double GetProbability() const override;
  int GetResultKind() const override;

  /// The same as SetPrediction with a number, without the value object: for models that score in tens of
  /// nanoseconds.
  void SetNumber(double prediction) {
    prediction_.Assign(prediction);
    has_prediction_ = true;
  }

  void SetStandardError(double error) override;
  double GetStandardError() const override;

  /// The parts of the model that led to this result. Belong to it.
  ResultEntities& GetEntities() { return entities_; }
  const ResultEntities& GetEntities() const { return entities_; }

  /// The output fields that the model's document declares; none when it declares none. Belong to the result.
  ResultField& GetOutputFields() { return output_fields_; }
  const ResultField& GetOutputFields() const { return output_fields_; }

 private:
  ResultValue prediction_;
  bool has_prediction_ = false;
  double probability_ = 0.0;
  double standard_error_;
  ResultEntities entities_;
  ResultField output_fields_;
};

/// The output fields of a result; null for null and for a result of a class that has none.
KESTREL_API ResultField* OutputFieldsOf(ScoreResult* result);

}  // namespace MCKestrel_800

#endif  // KESTREL_MODEL_RESULTS_H
