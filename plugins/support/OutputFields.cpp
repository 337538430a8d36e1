#include "plugins/support/OutputFields.h"

#include <xercesc/dom/DOMElement.hpp>

#include <algorithm>
#include <utility>

#include "kestrel/dictionary/BaseDictionary.h"
#include "kestrel/dictionary/ScoreCaseRecord.h"
#include "kestrel/dictionary/ScoreDictVar.h"
#include "kestrel/foundation/NumberText.h"
#include "kestrel/foundation/NumericValue.h"
#include "kestrel/foundation/StringValue.h"
#include "kestrel/model/ResultEntities.h"
#include "kestrel/model/Results.h"
#include "kestrel/translate/PMMLModelTags.h"
#include "kestrel/translate/ResultField.h"
#include "kestrel/translate/XmlText.h"
#include "plugins/support/OutputFieldReader.h"
#include "plugins/support/ScoringStatus.h"
#include "plugins/support/ValueRules.h"

namespace MCKestrel_800 {
namespace {

using Feature = ScoreResultField;
using RuleFeature = OutputField::RuleFeature;

bool NeedsTarget(const OutputField& field) {
  return field.feature == Feature::kPredictedDisplayValue || field.feature == Feature::kResidual;
}

bool TellsEntity(const OutputField& field) {
  switch (field.feature) {
    case Feature::kClusterId:
    case Feature::kClusterAffinity:
    case Feature::kEntityId:
    case Feature::kEntityAffinity:
    case Feature::kRuleValue:
      return true;
    default:
      return false;
  }
}

const std::string& DecidingId(const ScoreResult& result) {
  static const std::string none;
  const ResultEntities* entities = ResultEntities::Of(const_cast<ScoreResult*>(&result));
  return entities == nullptr ? none : entities->GetDecidingId();
}

/// Kind 0 is what a classification's result has; see VectorModel::MakeResult.
const ClsResult* AsClassification(const ScoreResult& result) {
  return result.GetResultKind() == 0 ? static_cast<const ClsResult*>(&result) : nullptr;
}

/// The probability of the prediction; missing when there is none. A regression has one where a model gives
/// its confidence.
double PredictionProbability(const ScoreResult& result) {
  const double probability = result.GetProbability();
  if (result.GetPrediction() == nullptr) return NumericValue::gSysmisValue;
  if (probability == 0.0 && AsClassification(result) == nullptr) return NumericValue::gSysmisValue;
  return probability;
}

}  // namespace

/// Where the value of an output field goes, which is missing until it is set.
class OutputFields::Cell {
 public:
  /// text  room for a text on its way
  Cell(ScoreValue& value, bool is_text, std::string& text) : value_(value), is_text_(is_text), text_(text) {}

  bool IsText() const { return is_text_; }

  void SetNumber(double number) {
    if (!is_text_) {
      static_cast<NumericValue&>(value_).SetDoubleValue(number);
    } else if (!NumericValue::IsSystemMissingValue(number)) {
      char digits[kShortestRoom];
      text_.assign(digits, FormatShortest(number, digits));
      SetText(text_);
    }
  }

  void SetText(const std::string& text) {
    if (is_text_) {
      static_cast<StringValue&>(value_).SetString(text);
      return;
    }
    double number = 0.0;
    if (ParseDouble(text.data(), text.data() + text.size(), number)) SetNumber(number);
  }

  void SetValue(const ScoreValue& value) {
    if (value.IsSystemMissingValue()) return;
    if (const auto* text = dynamic_cast<const StringValue*>(&value)) {
      SetText(text->GetText());
    } else if (is_text_ && value.GetType() != ScoreValue::kNumeric) {
      SetText(value.GetString());
    } else {
      SetNumber(value.GetDouble());
    }
  }

  /// A part of the model without identifier is called by its number behind a "#".
  void SetEntity(const std::string& id) {
    if (is_text_ || id.empty() || id.front() != '#') return SetText(id);
    text_.assign(id, 1, std::string::npos);
    SetText(text_);
  }

 private:
  ScoreValue& value_;
  bool is_text_;
  std::string& text_;
};

OutputFields::OutputFields() = default;
OutputFields::~OutputFields() = default;
OutputFields::OutputFields(OutputFields&&) noexcept = default;
OutputFields& OutputFields::operator=(OutputFields&&) noexcept = default;

OutputFields OutputFields::Read(const xercesc::DOMElement* model, const ScoreDictVar* target,
                                bool is_classification, std::unique_ptr<ScoreDictionary>& results) {
  OutputFields outputs;
  outputs.target_ = target;
  const OutputFieldReader reader(target, is_classification);
  auto dictionary = std::make_unique<BaseDictionary>();
  const xercesc::DOMElement* const output = FirstChild(model, PMMLTagText::XML_ELE_VAL_OUTPUT);
  for (const xercesc::DOMElement* child : ChildElements(output)) {
    if (ElementIs(child, u"OutputField") || ElementIs(child, PMMLTagText::XML_ELE_VAL_RESULTFIELD)) {
      outputs.fields_.push_back(reader.Read(child, *dictionary));
    }
  }
  results.reset();
  if (!outputs.IsEmpty()) results = std::move(dictionary);
  outputs.SetUpTarget();
  return outputs;
}

void OutputFields::SetUpTarget() {
  tell_entities_ = std::any_of(fields_.begin(), fields_.end(), TellsEntity);
  if (target_ == nullptr || std::none_of(fields_.begin(), fields_.end(), NeedsTarget)) return;
  target_rules_ = std::make_unique<ValueRules>(*target_);
  target_rules_->Seal();
  const ScoreValueLabelSet* labels = target_->GetValueLabels();
  if (labels == nullptr || target_->GetMLevel() == ScoreDictVar::kContinuous) return;
  labels_.resize(static_cast<std::size_t>(target_rules_->GetCodeCount()));
  for (const ScoreValueLabel* label : labels->GetAllValueLabels()) {
    const int code = target_rules_->FindCode(*label->GetValue());
    if (code != ValueRules::kUnknown) labels_[static_cast<std::size_t>(code)] = label->GetLabel();
  }
}

void OutputFields::Write(const ScoredCase& scored, ScoreResult& result) {
  ResultField* const values = OutputFieldsOf(&result);
  if (values == nullptr) return;
  if (result_stamp_ == 0 || values->GetLayoutStamp() != result_stamp_) Prepare(*values);
  for (std::size_t i = 0; i < fields_.size(); ++i) {
    WriteField(fields_[i], scored, result, Cell(*values_[i], fields_[i].is_text, text_));
  }
}

// New values, all missing: what is there may be another model's, of other classes.
void OutputFields::Prepare(ResultField& values) {
  ResultField::ValueMap map;
  values_.clear();
  for (const OutputField& field : fields_) {
    ScoreValue* value = field.is_text ? static_cast<ScoreValue*>(new StringValue)
                                      : static_cast<ScoreValue*>(new NumericValue);
    map.emplace(field.name, value);
    values_.push_back(value);
  }
  values.SetMapResultValue(map);
  result_stamp_ = values.GetLayoutStamp();
}

void OutputFields::WriteField(OutputField& field, const ScoredCase& scored, const ScoreResult& result,
                              Cell cell) {
  const ScoreValue* const prediction = result.GetPrediction();
  switch (field.feature) {
    case Feature::kPredictedValue:
      if (prediction != nullptr) cell.SetValue(*prediction);
      return;
    case Feature::kPredictedDisplayValue:
      if (prediction != nullptr) WriteDisplayValue(*prediction, cell);
      return;
    case Feature::kProbability:
      return cell.SetNumber(FindProbability(field, result));
    case Feature::kResidual:
      return cell.SetNumber(FindResidual(field, scored, result));
    case Feature::kStandardError:
      if (const auto* regression = dynamic_cast<const ScoreRegResult*>(&result)) {
        cell.SetNumber(regression->GetStandardError());
      }
      return;
    case Feature::kClusterId:
    case Feature::kEntityId:
      return cell.SetEntity(DecidingId(result));
    case Feature::kClusterAffinity:
    case Feature::kEntityAffinity:
      if (!DecidingId(result).empty()) cell.SetNumber(PredictionProbability(result));
      return;
    case Feature::kRuleValue:
      if (scored.is_decided_by_rule) WriteRuleValue(field, result, cell);
      return;
    case Feature::kWarning:
      return WriteWarning(scored, cell);
    case Feature::kStandardDeviation:
    case Feature::kNoFeature:
      return;
  }
}

void OutputFields::WriteDisplayValue(const ScoreValue& prediction, Cell cell) const {
  const int code = labels_.empty() ? ValueRules::kUnknown : target_rules_->FindCode(prediction);
  if (code == ValueRules::kUnknown || labels_[static_cast<std::size_t>(code)].empty()) {
    return cell.SetValue(prediction);
  }
  cell.SetText(labels_[static_cast<std::size_t>(code)]);
}

void OutputFields::WriteRuleValue(const OutputField& field, const ScoreResult& result, Cell cell) const {
  const std::string& id = DecidingId(result);
  const ScoreValue* const prediction = result.GetPrediction();
  if (id.empty() || prediction == nullptr) return;
  switch (field.rule_feature) {
    case RuleFeature::kConsequent:
      return cell.SetValue(*prediction);
    case RuleFeature::kId:
      return cell.SetEntity(id);
    case RuleFeature::kConfidence:
      return cell.SetNumber(PredictionProbability(result));
    case RuleFeature::kOther:
      return;
  }
}

void OutputFields::WriteWarning(const ScoredCase& scored, Cell cell) {
  using Basis = ScoredCase::Basis;
  if (scored.basis == Basis::kModel) return;
  if (!cell.IsText()) {
    return cell.SetNumber(
        static_cast<double>(scored.basis == Basis::kRefused ? kInvalidValueStatus : kNoPredictionStatus));
  }
  if (scored.basis == Basis::kRefused) {
    text_ = "invalid value";
    if (scored.refused_field != nullptr) text_.append(" of ").append(scored.refused_field->GetName());
  } else {
    text_ = scored.basis == Basis::kDefault ? "data are missing, the target's default is predicted"
                                            : "data are missing, nothing is predicted";
  }
  cell.SetText(text_);
}

// A model gives its categories in the same order case after case.
double OutputFields::FindProbability(OutputField& field, const ScoreResult& result) const {
  if (field.category == nullptr) return PredictionProbability(result);
  const ClsResult* const classification = AsClassification(result);
  if (classification == nullptr || classification->GetCategoryCount() == 0) return NumericValue::gSysmisValue;
  const ScoreValue* const found = classification->GetCategory(field.category_position);
  if (found != nullptr && *found == *field.category) {
    return classification->GetProbability(field.category_position);
  }
  for (std::size_t i = 0; i < classification->GetCategoryCount(); ++i) {
    if (*classification->GetCategory(i) == *field.category) {
      field.category_position = i;
      return classification->GetProbability(i);
    }
  }
  return 0.0;
}

double OutputFields::FindResidual(OutputField& field, const ScoredCase& scored, const ScoreResult& result) {
  const ScoreValue* const prediction = result.GetPrediction();
  if (prediction == nullptr || scored.record == nullptr || target_rules_ == nullptr) {
    return NumericValue::gSysmisValue;
  }
  const ScoreValue* const true_value = FindTrueValue(*scored.record);
  if (target_rules_->Judge(true_value) != ValueRules::kValid) return NumericValue::gSysmisValue;
  if (AsClassification(result) == nullptr) {
    if (prediction->GetType() == ScoreValue::kString) return NumericValue::gSysmisValue;
    return true_value->GetDouble() - prediction->GetDouble();
  }
  const double probability = FindProbability(field, result);
  if (NumericValue::IsSystemMissingValue(probability)) return probability;
  const bool is_category = *true_value == (field.category != nullptr ? *field.category : *prediction);
  return (is_category ? 1.0 : 0.0) - probability;
}

const ScoreValue* OutputFields::FindTrueValue(const ScoreCaseRecord& record) {
  const unsigned long long stamp = record.GetLayoutStamp();
  if (stamp == 0 || stamp != record_stamp_) {
    true_value_position_ = record.GetIndex(target_->GetName());
    record_stamp_ = stamp;
  }
  return true_value_position_ < 0 ? nullptr : record.Get(true_value_position_);
}

}  // namespace MCKestrel_800
