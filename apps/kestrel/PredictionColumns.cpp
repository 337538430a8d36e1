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

PredictionColumns::PredictionColumns(ScoreModel& model)
    : result_(model.MakeResult()),
      classification_(dynamic_cast<ScoreClsResult*>(result_.get())),
      names_{"prediction"} {
  if (classification_ == nullptr) return;
  names_.push_back("probability");
  if (model.SuppressCategoryProbabilities()) return;
  FindCategories(model);
  for (const std::unique_ptr<ScoreValue>& category : categories_)
    names_.push_back("probability_" + TextOf(*category));
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
  const auto* result = dynamic_cast<const ClsResult*>(result_.get());
  if (result == nullptr) return;
  CaseRecord record;
  for (const ScoreDictVar* variable : model.GetPredictors())
    record.Add(variable->GetName(), AnyValueOf(*variable));
  if (!model.Score(&record, result_.get()).IsError()) {
    for (std::size_t i = 0; i < result->GetCategoryCount(); ++i)
      categories_.emplace_back(result->GetCategory(i)->Clone());
  }
  result_->Reset();
}

void PredictionColumns::Write(TableWriter& writer) const {
  const ScoreValue* prediction = result_->GetPrediction();
  if (prediction == nullptr || prediction->IsSystemMissingValue()) return WriteMissing(writer);
  if (prediction->GetType() == ScoreValue::kNumeric) {
    writer.AddNumber(prediction->GetDouble());
  } else if (const auto* text = dynamic_cast<const StringValue*>(prediction)) {
    writer.AddText(text->GetText());
  } else {
    writer.AddText(prediction->GetString());
  }
  if (classification_ == nullptr) return;
  writer.AddNumber(classification_->GetProbability());
  WriteCategories(writer);
}

void PredictionColumns::WriteCategories(TableWriter& writer) const {
  if (classification_->GetCategoryCount() == 0) {
    for (std::size_t i = 0; i < categories_.size(); ++i)
      writer.AddMissing();
    return;
  }
  const auto* by_position = dynamic_cast<const ClsResult*>(classification_);
  for (std::size_t i = 0; i < categories_.size(); ++i) {
    // Results mostly hold the categories in the target's order; then none has to be searched for.
    const ScoreValue* at_position = by_position == nullptr ? nullptr : by_position->GetCategory(i);
    writer.AddNumber(at_position != nullptr && *at_position == *categories_[i]
                         ? by_position->GetProbability(i)
                         : classification_->GetCategoryProbability(categories_[i].get()));
  }
}

void PredictionColumns::WriteMissing(TableWriter& writer) const {
  for (std::size_t i = 0; i < names_.size(); ++i)
    writer.AddMissing();
}

}  // namespace kestrel_program
