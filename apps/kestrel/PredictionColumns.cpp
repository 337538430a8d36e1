#include "apps/kestrel/PredictionColumns.h"

#include "apps/kestrel/TableWriter.h"
#include "kestrel/dictionary/CaseRecord.h"
#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/foundation/DateTimeValue.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/model/Results.h"
#include "kestrel/model/ScoreModel.h"

namespace kestrel_program {
namespace {

using namespace MCKestrel_800;

const ScoreValueLabelSet* LabelsOf(const ScoreDictVar& variable) {
  const ScoreValueLabelSet* labels = variable.GetValueLabels();
  return labels != nullptr && labels->Size() > 0 ? labels : nullptr;
}

/// Some value that the variable takes.
ScoreValue* AnyValueOf(const ScoreDictVar& variable) {
  const ScoreValueLabelSet* labels = LabelsOf(variable);
  if (labels != nullptr) {
    const ScoreValue* value = labels->GetAllValueLabels().front()->GetValue();
    if (value != nullptr) return value->Clone();
  }
  if (variable.GetVarType() == ScoreDictVar::STRING_VAR) return new StringValue("0");
  if (variable.GetVarType() == ScoreDictVar::kDATETIME_VAR)
    return new DateTimeValue(0.0, variable.GetDateTimeType());
  return new NumericValue(0.0);
}

}  // namespace

std::string TextOf(const ScoreValue& value) {
  if (value.GetType() != ScoreValue::kNumeric) return value.GetString();
  std::string text;
  AppendNumber(value.GetDouble(), text);
  return text;
}

void WriteValue(const ScoreValue& value, TableWriter& writer) {
  if (value.GetType() == ScoreValue::kNumeric) {
    writer.AddNumber(value.GetDouble());
  } else if (const auto* text = dynamic_cast<const StringValue*>(&value)) {
    writer.AddText(text->GetText());
  } else {
    writer.AddText(value.GetString());
  }
}

PredictionColumns::PredictionColumns(ScoreModel& model, ScoreResult* result)
    : result_(result),
      classification_(dynamic_cast<ScoreClsResult*>(result)),
      by_position_(dynamic_cast<const ClsResult*>(result)),
      names_{"prediction"} {
  if (classification_ == nullptr) return;
  names_.push_back("probability");
  if (model.SuppressCategoryProbabilities()) return;
  FindCategories(model);
  for (const std::unique_ptr<ScoreValue>& category : categories_)
    names_.push_back("probability_" + TextOf(*category));
  for (std::size_t i = 0; i < categories_.size(); ++i)
    positions_.push_back(i);
}

PredictionColumns::~PredictionColumns() = default;

void PredictionColumns::FindCategories(ScoreModel& model) {
  const ScoreDictVar* target = model.GetTargetVar();
  const ScoreValueLabelSet* labels = target == nullptr ? nullptr : LabelsOf(*target);
  if (labels == nullptr) return FindCategoriesByScoring(model);
  for (const ScoreValueLabel* label : labels->GetAllValueLabels()) {
    const ScoreValue* value = label->GetValue();
    // A value that the target counts as missing is nothing to predict.
    if (value != nullptr && !target->IsMissingValue(value)) categories_.emplace_back(value->Clone());
  }
}

// The header comes before the first case, so what the categories are cannot wait for it.
void PredictionColumns::FindCategoriesByScoring(ScoreModel& model) {
  if (by_position_ == nullptr) return;
  CaseRecord record;
  for (const ScoreDictVar* variable : model.GetPredictors())
    record.Add(variable->GetName(), AnyValueOf(*variable));
  if (!model.Score(&record, result_).IsError()) {
    for (std::size_t i = 0; i < by_position_->GetCategoryCount(); ++i)
      categories_.emplace_back(by_position_->GetCategory(i)->Clone());
  }
  result_->Reset();
}

void PredictionColumns::Write(TableWriter& writer) {
  const ScoreValue* prediction = result_->GetPrediction();
  if (prediction == nullptr || prediction->IsSystemMissingValue()) return WriteMissing(writer);
  WriteValue(*prediction, writer);
  if (classification_ == nullptr) return;
  writer.AddNumber(classification_->GetProbability());
  WriteCategories(writer);
}

void PredictionColumns::WriteCategories(TableWriter& writer) {
  const bool has_none = classification_->GetCategoryCount() == 0;
  for (std::size_t i = 0; i < categories_.size(); ++i) {
    if (has_none) {
      writer.AddMissing();
    } else {
      writer.AddNumber(FindProbability(i));
    }
  }
}

// A model gives its categories in the same order case after case, which need not be the target's.
double PredictionColumns::FindProbability(std::size_t category) {
  const ScoreValue& wanted = *categories_[category];
  if (by_position_ == nullptr) return classification_->GetCategoryProbability(&wanted);
  const ScoreValue* found = by_position_->GetCategory(positions_[category]);
  if (found != nullptr && *found == wanted) return by_position_->GetProbability(positions_[category]);
  for (std::size_t position = 0; position < by_position_->GetCategoryCount(); ++position) {
    if (*by_position_->GetCategory(position) == wanted) {
      positions_[category] = position;
      return by_position_->GetProbability(position);
    }
  }
  return 0.0;
}

void PredictionColumns::WriteMissing(TableWriter& writer) const {
  for (std::size_t i = 0; i < names_.size(); ++i)
    writer.AddMissing();
}

}  // namespace kestrel_program
